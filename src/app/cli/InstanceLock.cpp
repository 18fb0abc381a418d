#include "app/cli/InstanceLock.h"

#include <fcntl.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <cstdlib>
#include <cstring>
#include <utility>

namespace plume {

namespace {

std::string environment(const char* name) {
    const char* const value = std::getenv(name);
    return value ? value : "";
}

// A folder that only this user can enter.
bool isPrivate(const std::string& folder) {
    struct stat status {};
    if (lstat(folder.c_str(), &status) != 0) return false;
    constexpr mode_t Others = 077;
    return S_ISDIR(status.st_mode) && status.st_uid == getuid() && (status.st_mode & Others) == 0;
}

Result<std::string> folder() {
    const std::string runtime = environment("XDG_RUNTIME_DIR");
    if (!runtime.empty() && isPrivate(runtime)) return runtime;
    const std::string temporary = environment("TMPDIR");
    const std::string own = (temporary.empty() ? "/tmp" : temporary) + "/plume-" + std::to_string(getuid());
    if (mkdir(own.c_str(), 0700) != 0 && errno != EEXIST) {
        return Error{"The folder " + own + " cannot be made: " + std::strerror(errno) + "."};
    }
    if (!isPrivate(own)) return Error{"The folder " + own + " is not yours alone; remove it."};
    return own;
}

// "unix:0.1", ":0.0" and ":0" are one display.
std::string keyOf(std::string display) {
    const std::size_t colon = display.rfind(':');
    if (colon != std::string::npos) {
        display.resize(std::min(display.find('.', colon), display.size()));
        if (display.starts_with("unix:")) display.erase(0, 4);
    }
    for (char& c : display) {
        const bool plain = (c >= '0' && c <= '9') || (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || c == ':';
        if (!plain) c = '_';
    }
    return display;
}

std::string holderOf(int file) {
    std::array<char, 32> text{};
    const ssize_t length = pread(file, text.data(), text.size() - 1, 0);
    const long process = length > 0 ? std::strtol(text.data(), nullptr, 10) : 0;
    return process > 0 ? " (process " + std::to_string(process) + ")" : "";
}

Result<std::string> pathWithEnding(const std::string& display, const char* ending) {
    Result<std::string> where = folder();
    if (!where) return where;
    return where.value() + "/plume-" + keyOf(display.empty() ? environment("DISPLAY") : display) + ending;
}

}  // namespace

Result<std::string> InstanceLock::pathFor(const std::string& display) {
    return pathWithEnding(display, ".lock");
}

Result<std::string> InstanceLock::socketPathFor(const std::string& display) {
    return pathWithEnding(display, ".socket");
}

Result<InstanceLock> InstanceLock::take(const std::string& display) {
    const Result<std::string> path = pathFor(display);
    if (!path) return path.error();
    FileDescriptor file(open(path.value().c_str(), O_RDWR | O_CREAT | O_CLOEXEC | O_NOFOLLOW, 0600));
    if (!file.isOpen()) return Error{"The file " + path.value() + " cannot be opened: " + std::strerror(errno) + "."};
    if (flock(file.get(), LOCK_EX | LOCK_NB) != 0) {
        return Error{"Plume is already running on this display" + holderOf(file.get()) + "."};
    }
    const std::string process = std::to_string(getpid()) + "\n";
    // The number is only for the message above.
    if (ftruncate(file.get(), 0) == 0) (void)!pwrite(file.get(), process.data(), process.size(), 0);
    return InstanceLock(std::move(file));
}

bool InstanceLock::isTaken(const std::string& display) {
    const Result<std::string> path = pathFor(display);
    if (!path) return false;
    const FileDescriptor file(open(path.value().c_str(), O_RDONLY | O_CLOEXEC | O_NOFOLLOW));
    return file.isOpen() && flock(file.get(), LOCK_SH | LOCK_NB) != 0;
}

}  // namespace plume
