#include "ports/simulated/SimulatedFiles.h"

#include <algorithm>
#include <utility>

namespace plume {

namespace {

using Path = Files::Path;

// Without "..", repeated slashes and one at the end, so that a file has one name.
Path plain(const Path& path) {
    const Path normal = path.lexically_normal();
    return normal.has_filename() || !normal.has_relative_path() ? normal : normal.parent_path();
}

bool isAtOrBelow(const Path& path, const Path& folder) {
    return std::mismatch(folder.begin(), folder.end(), path.begin(), path.end()).first == folder.end();
}

Error cannot(const char* verb, const Path& path, const char* reason) {
    return Error{path.string() + " cannot be " + verb + ": " + reason};
}

constexpr const char* NotThere = "No such file or directory";
constexpr const char* NotAllowed = "Permission denied";
constexpr const char* Folder = "Is a directory";
constexpr const char* NoFolder = "Not a directory";

}  // namespace

const SimulatedFiles::Node* SimulatedFiles::find(const Path& path) const {
    const auto found = nodes_.find(plain(path));
    return found == nodes_.end() ? nullptr : &found->second;
}

bool SimulatedFiles::isFolderAt(const Path& path) const {
    const Node* node = find(path);
    return node ? node->isFolder : plain(path) == path.root_path();
}

bool SimulatedFiles::exists(const Path& path) const {
    const std::lock_guard lock(mutex_);
    return find(path) || isFolderAt(path);
}

bool SimulatedFiles::isFolder(const Path& path) const {
    const std::lock_guard lock(mutex_);
    return isFolderAt(path);
}

Result<std::string> SimulatedFiles::read(const Path& path) const {
    const std::lock_guard lock(mutex_);
    const Node* node = find(path);
    if (isFolderAt(path)) return cannot("read", path, Folder);
    if (!node) return cannot("read", path, NotThere);
    if (node->unreadable) return cannot("read", path, NotAllowed);
    return node->bytes;
}

Result<void> SimulatedFiles::told(Result<void> result, const Path& path) const {
    if (result && listener_) listener_(plain(path));
    return result;
}

Result<void> SimulatedFiles::write(const Path& path, std::string_view bytes) {
    const auto write = [&]() -> Result<void> {
        const std::lock_guard lock(mutex_);
        if (isFolderAt(path)) return cannot("written", path, Folder);
        if (!isFolderAt(plain(path).parent_path())) return cannot("written", path, NotThere);
        if (freeBytes_ && *freeBytes_ < bytes.size()) return cannot("written", path, "No space left on device");
        if (freeBytes_) *freeBytes_ -= bytes.size();
        Node& node = nodes_[plain(path)];
        if (node.number == 0) node.number = ++lastNumber_;
        node.bytes = bytes;
        node.modified = currentDate();
        return {};
    };
    return told(write(), path);
}

Result<bool> SimulatedFiles::replace(const Path& path, const std::optional<std::string>& expected,
                                     std::string_view bytes) {
    if (const auto call = std::exchange(beforeReplace_, nullptr)) call();
    const auto there = exists(path) ? read(path) : Result<std::string>(std::string());
    if (!there) return there.error();
    if (exists(path) != expected.has_value() || there.value() != expected.value_or("")) return false;
    if (auto written = write(path, bytes); !written) return written.error();
    return true;
}

Result<void> SimulatedFiles::addFolders(const Path& path, std::vector<Path>& made) {
    if (isFolderAt(path)) return {};
    if (find(path)) return cannot("made a folder", path, NoFolder);
    if (auto above = addFolders(path.parent_path(), made); !above) return above;
    nodes_[path] = {.isFolder = true, .modified = currentDate(), .number = ++lastNumber_};
    made.push_back(path);
    return {};
}

Result<void> SimulatedFiles::createFolder(const Path& path) {
    std::vector<Path> made;
    const auto create = [&] {
        const std::lock_guard lock(mutex_);
        return addFolders(plain(path), made);
    };
    Result<void> created = create();
    for (const Path& folder : made) (void)told({}, folder);
    return created;
}

Result<std::vector<Files::Entry>> SimulatedFiles::list(const Path& folder) const {
    const std::lock_guard lock(mutex_);
    const Node* node = find(folder);
    if (!isFolderAt(folder)) return cannot("listed", folder, node ? NoFolder : NotThere);
    if (node && node->unreadable) return cannot("listed", folder, NotAllowed);
    std::vector<std::pair<std::uint64_t, Entry>> found;
    for (const auto& [path, inside] : nodes_) {
        if (path.parent_path() != plain(folder)) continue;
        found.emplace_back(inside.number, Entry{path.filename().string(), inside.isFolder, inside.modified});
    }
    std::sort(found.begin(), found.end(), [](const auto& a, const auto& b) { return a.first < b.first; });
    std::vector<Entry> entries;
    entries.reserve(found.size());
    for (auto& [number, entry] : found) entries.push_back(std::move(entry));
    return entries;
}

Result<void> SimulatedFiles::removeAt(const Path& path, const char* verb) {
    const auto found = nodes_.find(plain(path));
    if (found == nodes_.end()) return cannot(verb, path, NotThere);
    const auto below = std::next(found);
    if (below != nodes_.end() && isAtOrBelow(below->first, found->first)) {
        return cannot(verb, path, "Directory not empty");
    }
    nodes_.erase(found);
    return {};
}

Result<void> SimulatedFiles::remove(const Path& path) {
    const auto remove = [&] {
        const std::lock_guard lock(mutex_);
        return removeAt(path, "removed");
    };
    return told(remove(), path);
}

Result<void> SimulatedFiles::moveToTrash(const Path& path) {
    const auto move = [&]() -> Result<void> {
        const std::lock_guard lock(mutex_);
        const Node* node = find(path);
        TrashedFile trashed{path, node ? node->bytes : std::string()};
        Result<void> removed = removeAt(path, "moved to the trash");
        if (removed) trash_.push_back(std::move(trashed));
        return removed;
    };
    return told(move(), path);
}

void SimulatedFiles::setFreeBytes(std::optional<std::size_t> bytes) {
    const std::lock_guard lock(mutex_);
    freeBytes_ = bytes;
}

void SimulatedFiles::setUnreadable(const Path& path, bool unreadable) {
    const std::lock_guard lock(mutex_);
    if (const auto found = nodes_.find(plain(path)); found != nodes_.end()) found->second.unreadable = unreadable;
}

void SimulatedFiles::vanish(const Path& path) {
    {
        const std::lock_guard lock(mutex_);
        std::erase_if(nodes_, [&](const auto& node) { return isAtOrBelow(node.first, plain(path)); });
    }
    (void)told({}, path);
}

void SimulatedFiles::setModified(const Path& path, std::optional<Date> modified) {
    const std::lock_guard lock(mutex_);
    if (const auto found = nodes_.find(plain(path)); found != nodes_.end()) found->second.modified = modified;
}

std::vector<SimulatedFiles::TrashedFile> SimulatedFiles::trash() const {
    const std::lock_guard lock(mutex_);
    return trash_;
}

}  // namespace plume
