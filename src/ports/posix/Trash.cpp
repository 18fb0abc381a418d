#include "ports/posix/Trash.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <ctime>
#include <optional>
#include <string>

#include "Foundation/Date.h"
#include "ports/posix/FileDescriptor.h"

namespace plume {

namespace {

using Path = std::filesystem::path;

constexpr mode_t UsersAlone = 0700;
constexpr int MostNames = 1000;

// Of one disk.
struct TrashFolder {
    Path folder;
    // What paths are written relative to; empty for absolute ones.
    Path top;
};

// Letters, digits and what needs no escape in a path; all else as %XX.
std::string escaped(const Path& path) {
    std::string text;
    for (const char c : path.string()) {
        const bool plain = (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || (c >= '0' && c <= '9') ||
                           std::string_view("-_.~/").find(c) != std::string_view::npos;
        if (plain) {
            text += c;
        } else {
            std::array<char, 4> code{};
            (void)std::snprintf(code.data(), code.size(), "%%%02X",
                                static_cast<unsigned>(static_cast<unsigned char>(c)));
            text += code.data();
        }
    }
    return text;
}

std::string infoText(const Path& path, const TrashFolder& trash) {
    const std::time_t now = std::chrono::system_clock::to_time_t(currentDate());
    std::tm local{};
    localtime_r(&now, &local);
    std::array<char, 32> date{};
    (void)std::strftime(date.data(), date.size(), "%Y-%m-%dT%H:%M:%S", &local);
    const Path written = trash.top.empty() ? path : path.lexically_relative(trash.top);
    return "[Trash Info]\nPath=" + escaped(written) + "\nDeletionDate=" + date.data() + "\n";
}

// "name", "name 2", …
std::string numbered(const std::string& name, int number) {
    return number == 1 ? name : name + " " + std::to_string(number);
}

int makeFolder(const Path& path) {
    std::error_code problem;
    if (!std::filesystem::is_directory(path.parent_path(), problem)) {
        if (const int failed = makeFolder(path.parent_path()); failed != 0) return failed;
    }
    return mkdir(path.c_str(), UsersAlone) == 0 || errno == EEXIST ? 0 : errno;
}

int renameToNew(const Path& from, const Path& to) {
    return renameat2(AT_FDCWD, from.c_str(), AT_FDCWD, to.c_str(), RENAME_NOREPLACE) == 0 ? 0 : errno;
}

// The info file comes first: who makes it has the name.
int moveAs(const std::string& name, const Path& path, const TrashFolder& trash) {
    const Path info = trash.folder / "info" / (name + ".trashinfo");
    const FileDescriptor file(open(info.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, 0600));
    if (!file.isOpen()) return errno;
    const std::string text = infoText(path, trash);
    int problem = write(file.get(), text.data(), text.size()) == static_cast<ssize_t>(text.size()) ? 0 : ENOSPC;
    if (problem == 0) problem = renameToNew(path, trash.folder / "files" / name);
    if (problem != 0) unlink(info.c_str());
    return problem;
}

int moveInto(const TrashFolder& trash, const Path& path) {
    for (const char* part : {"info", "files"}) {
        if (const int problem = makeFolder(trash.folder / part); problem != 0) return problem;
    }
    for (int number = 1; number <= MostNames; ++number) {
        const int problem = moveAs(numbered(path.filename().string(), number), path, trash);
        if (problem != EEXIST) return problem;
    }
    return EEXIST;
}

std::optional<TrashFolder> homeTrash() {
    const char* const data = std::getenv("XDG_DATA_HOME");
    if (data && *data == '/') return TrashFolder{Path(data) / "Trash", {}};
    const char* const home = std::getenv("HOME");
    if (!home || *home != '/') return std::nullopt;
    return TrashFolder{Path(home) / ".local/share/Trash", {}};
}

// Where the file's disk begins.
Path topOf(const Path& path) {
    struct stat status {};
    Path top = path.parent_path();
    if (stat(top.c_str(), &status) != 0) return top;
    const dev_t disk = status.st_dev;
    while (top != top.parent_path() && stat(top.parent_path().c_str(), &status) == 0 && status.st_dev == disk) {
        top = top.parent_path();
    }
    return top;
}

TrashFolder diskTrash(const Path& path) {
    const Path top = topOf(path);
    const std::string user = std::to_string(getuid());
    const Path shared = top / ".Trash";
    struct stat status {};
    const bool usable = lstat(shared.c_str(), &status) == 0 && S_ISDIR(status.st_mode) && (status.st_mode & S_ISVTX);
    return {usable ? shared / user : top / (".Trash-" + user), top};
}

int renameBeside(const Path& path) {
    for (int number = 1; number <= MostNames; ++number) {
        const int problem =
            renameToNew(path, path.parent_path() / numbered(path.filename().string() + ".trash", number));
        if (problem != EEXIST) return problem;
    }
    return EEXIST;
}

}  // namespace

int moveToTrash(const Path& path) {
    struct stat status {};
    if (lstat(path.c_str(), &status) != 0) return errno;
    if (const auto home = homeTrash(); home && moveInto(*home, path) == 0) return 0;
    if (moveInto(diskTrash(path), path) == 0) return 0;
    return renameBeside(path);
}

}  // namespace plume
