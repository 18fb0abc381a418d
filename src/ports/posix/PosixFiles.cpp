#include "ports/posix/PosixFiles.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstdio>
#include <cstring>
#include <system_error>

#include "ports/posix/FileDescriptor.h"
#include "ports/posix/Trash.h"

namespace plume {

namespace {

using Path = Files::Path;

Error cannot(const char* verb, const Path& path, const std::string& reason) {
    return Error{path.string() + " cannot be " + verb + ": " + reason};
}

Error cannot(const char* verb, const Path& path, int problem) {
    return cannot(verb, path, std::string(std::strerror(problem)));
}

// Where a link at the end of the path leads to, also when nothing is there yet; empty when links lead round in a
// circle.
Path followLinks(Path path) {
    constexpr int MostLinks = 40;
    std::error_code problem;
    for (int links = 0; links < MostLinks; ++links) {
        if (!std::filesystem::is_symlink(path, problem)) return path;
        path = path.parent_path() / std::filesystem::read_symlink(path, problem);
    }
    return {};
}

// False with errno set.
bool writeAll(int descriptor, std::string_view bytes) {
    while (!bytes.empty()) {
        const ssize_t written = write(descriptor, bytes.data(), bytes.size());
        if (written < 0 && errno == EINTR) continue;
        if (written < 0) return false;
        bytes.remove_prefix(static_cast<std::size_t>(written));
    }
    return true;
}

// A file of another name that goes unless it is put into its place.
class Draft {
  public:
    explicit Draft(const Path& folder)
        : name_((folder / ".plume-XXXXXX").string()), file_(mkostemp(name_.data(), O_CLOEXEC)) {}
    ~Draft() {
        if (file_.isOpen()) unlink(name_.c_str());
    }
    Draft(const Draft&) = delete;
    Draft& operator=(const Draft&) = delete;

    // All of these are false with errno set.
    bool isOpen() const { return file_.isOpen(); }
    bool fill(std::string_view bytes) { return writeAll(file_.get(), bytes) && fsync(file_.get()) == 0; }
    bool putInPlaceOf(const Path& path) {
        struct stat old {};
        constexpr mode_t Permissions = 07777;
        if (stat(path.c_str(), &old) == 0 && fchmod(file_.get(), old.st_mode & Permissions) != 0) return false;
        if (rename(name_.c_str(), path.c_str()) != 0) return false;
        file_.close();
        return true;
    }

  private:
    std::string name_;
    FileDescriptor file_;
};

// Some file systems cannot; then the file is there all the same.
void bringToDisk(const Path& folder) {
    const FileDescriptor opened(open(folder.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC));
    if (opened.isOpen()) (void)fsync(opened.get());
}

std::optional<Date> modificationOf(const Path& path) {
    struct stat status {};
    if (stat(path.c_str(), &status) != 0) return std::nullopt;
    return Date(std::chrono::duration_cast<Date::duration>(std::chrono::seconds(status.st_mtim.tv_sec) +
                                                           std::chrono::nanoseconds(status.st_mtim.tv_nsec)));
}

// Bytes as they come, until there are too many. False with errno set.
bool readAll(int descriptor, std::string& bytes) {
    std::string piece(std::size_t{64} * 1024, '\0');
    while (bytes.size() <= Files::LargestFile) {
        const ssize_t count = read(descriptor, piece.data(), piece.size());
        if (count < 0 && errno == EINTR) continue;
        if (count < 0) return false;
        if (count == 0) break;
        bytes.append(piece, 0, static_cast<std::size_t>(count));
    }
    return true;
}

}  // namespace

bool PosixFiles::exists(const Path& path) const {
    std::error_code problem;
    return std::filesystem::exists(path, problem);
}

bool PosixFiles::isFolder(const Path& path) const {
    std::error_code problem;
    return std::filesystem::is_directory(path, problem);
}

Result<std::string> PosixFiles::read(const Path& path) const {
    // A pipe is not waited for.
    const FileDescriptor file(open(path.c_str(), O_RDONLY | O_NONBLOCK | O_CLOEXEC));
    struct stat status {};
    if (!file.isOpen() || fstat(file.get(), &status) != 0) return cannot("read", path, errno);
    if (S_ISDIR(status.st_mode)) return cannot("read", path, EISDIR);
    if (!S_ISREG(status.st_mode)) return cannot("read", path, "it is no regular file");
    std::string bytes;
    if (!readAll(file.get(), bytes)) return cannot("read", path, errno);
    if (bytes.size() > LargestFile) return cannot("read", path, "it is larger than 256 MiB");
    return bytes;
}

Result<void> PosixFiles::write(const Path& path, std::string_view bytes) {
    const auto written = writeIf([] { return Result<bool>(true); }, path, bytes);
    return written ? Result<void>() : written.error();
}

Result<bool> PosixFiles::replace(const Path& path, const std::optional<std::string>& expected, std::string_view bytes) {
    const auto holdsExpected = [&]() -> Result<bool> {
        if (!exists(path)) return !expected;
        const auto there = read(path);
        if (!there) return there.error();
        return there.value() == expected;
    };
    return writeIf(holdsExpected, path, bytes);
}

Result<bool> PosixFiles::writeIf(const std::function<Result<bool>()>& wanted, const Path& path,
                                 std::string_view bytes) const {
    const Path place = followLinks(path);
    if (place.empty()) return cannot("written", path, ELOOP);
    if (isFolder(place)) return cannot("written", path, EISDIR);
    Draft draft(place.parent_path());
    if (!draft.isOpen() || !draft.fill(bytes)) return cannot("written", path, errno);
    if (auto still = wanted(); !still || !still.value()) return still;
    if (!draft.putInPlaceOf(place)) return cannot("written", path, errno);
    bringToDisk(place.parent_path());
    return true;
}

Result<void> PosixFiles::createFolder(const Path& path) {
    if (isFolder(path)) return {};
    if (path.has_relative_path() && path.parent_path() != path) {
        if (auto above = createFolder(path.parent_path()); !above) return above;
    }
    constexpr mode_t UsersAlone = 0700;
    if (mkdir(path.c_str(), UsersAlone) == 0) return {};
    const int problem = errno;
    if (isFolder(path)) return {};
    return cannot("made a folder", path, problem);
}

Result<std::vector<Files::Entry>> PosixFiles::list(const Path& folder) const {
    std::error_code problem;
    std::vector<Entry> entries;
    for (auto entry = std::filesystem::directory_iterator(folder, problem);
         !problem && entry != std::filesystem::directory_iterator(); entry.increment(problem)) {
        entries.push_back({entry->path().filename().string(), isFolder(entry->path()), modificationOf(entry->path())});
    }
    if (problem) return cannot("listed", folder, problem.message());
    return entries;
}

Result<void> PosixFiles::remove(const Path& path) {
    if (std::remove(path.c_str()) == 0) return {};
    return cannot("removed", path, errno);
}

Result<void> PosixFiles::moveToTrash(const Path& path) {
    const int problem = plume::moveToTrash(path);
    if (problem == 0) return {};
    return cannot("moved to the trash", path, problem);
}

}  // namespace plume
