#include "ports/posix/PosixProcessLauncher.h"

#include <fcntl.h>
#include <poll.h>
#include <spawn.h>
#include <sys/socket.h>
#include <sys/stat.h>

#include <cerrno>
#include <csignal>
#include <cstdlib>
#include <system_error>
#include <utility>
#include <vector>

#include "ports/posix/FileDescriptor.h"
#include "ports/posix/PosixProcess.h"
#include "ports/posix/PosixStream.h"

namespace plume {

namespace {

Error systemError(const std::string& what, int code) {
    return Error{what + ": " + std::generic_category().message(code)};
}

class PosixTemporaryFile final : public TemporaryFile {
  public:
    explicit PosixTemporaryFile(std::string path) : path_(std::move(path)) {}
    ~PosixTemporaryFile() override { ::unlink(path_.c_str()); }
    PosixTemporaryFile(const PosixTemporaryFile&) = delete;
    PosixTemporaryFile& operator=(const PosixTemporaryFile&) = delete;

    const std::string& path() const override { return path_; }

  private:
    std::string path_;
};

bool writeAll(const FileDescriptor& file, std::string_view bytes) {
    while (!bytes.empty()) {
        const ssize_t count = ::write(file.get(), bytes.data(), bytes.size());
        if (count < 0 && errno == EINTR) continue;
        if (count < 0) return false;
        bytes.remove_prefix(static_cast<std::size_t>(count));
    }
    return true;
}

// ---- Starting ----

// Both ends of the streams of a child; nothing else that is started meanwhile inherits them.
struct StandardStreams {
    FileDescriptor input, output, error;
    FileDescriptor childInput, childOutput, childError;

    bool open(bool takesInput);
};

bool openPipe(FileDescriptor& readingEnd, FileDescriptor& writingEnd) {
    int ends[2];
    if (::pipe2(ends, O_CLOEXEC) != 0) return false;
    readingEnd = FileDescriptor(ends[0]);
    writingEnd = FileDescriptor(ends[1]);
    return ::fcntl(ends[0], F_SETFL, O_NONBLOCK) == 0;
}

bool openSockets(FileDescriptor& mine, FileDescriptor& child) {
    int ends[2];
    if (::socketpair(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0, ends) != 0) return false;
    mine = FileDescriptor(ends[0]);
    child = FileDescriptor(ends[1]);
    return true;
}

// Where Plume itself runs without standard streams, a new descriptor may get one of their numbers, and handing it to
// the child would overwrite it.
bool keepClearOfStandardStreams(FileDescriptor& descriptor) {
    if (descriptor.get() > STDERR_FILENO) return true;
    descriptor = FileDescriptor(::fcntl(descriptor.get(), F_DUPFD_CLOEXEC, STDERR_FILENO + 1));
    return descriptor.isOpen();
}

bool StandardStreams::open(bool takesInput) {
    if (!openPipe(output, childOutput) || !openPipe(error, childError)) return false;
    if (takesInput) {
        if (!openSockets(input, childInput)) return false;
    } else {
        childInput = FileDescriptor(::open("/dev/null", O_RDONLY | O_CLOEXEC));
        if (!childInput.isOpen()) return false;
    }
    return keepClearOfStandardStreams(childInput) && keepClearOfStandardStreams(childOutput) &&
           keepClearOfStandardStreams(childError);
}

// How the child differs from Plume: its streams, a group of its own, no signal blocked or ignored, no other descriptor.
class SpawnSettings {
  public:
    explicit SpawnSettings(const StandardStreams& streams) {
        posix_spawn_file_actions_init(&actions_);
        posix_spawn_file_actions_adddup2(&actions_, streams.childInput.get(), STDIN_FILENO);
        posix_spawn_file_actions_adddup2(&actions_, streams.childOutput.get(), STDOUT_FILENO);
        posix_spawn_file_actions_adddup2(&actions_, streams.childError.get(), STDERR_FILENO);
        posix_spawn_file_actions_addclosefrom_np(&actions_, STDERR_FILENO + 1);
        posix_spawnattr_init(&attributes_);
        sigset_t signals;
        sigemptyset(&signals);
        posix_spawnattr_setsigmask(&attributes_, &signals);
        sigfillset(&signals);
        posix_spawnattr_setsigdefault(&attributes_, &signals);
        posix_spawnattr_setpgroup(&attributes_, 0);
        posix_spawnattr_setflags(&attributes_, POSIX_SPAWN_SETPGROUP | POSIX_SPAWN_SETSIGMASK | POSIX_SPAWN_SETSIGDEF);
    }
    ~SpawnSettings() {
        posix_spawn_file_actions_destroy(&actions_);
        posix_spawnattr_destroy(&attributes_);
    }
    SpawnSettings(const SpawnSettings&) = delete;
    SpawnSettings& operator=(const SpawnSettings&) = delete;

    int spawn(const ProcessRequest& request, pid_t& pid) const;

  private:
    posix_spawn_file_actions_t actions_;
    posix_spawnattr_t attributes_;
};

int SpawnSettings::spawn(const ProcessRequest& request, pid_t& pid) const {
    std::vector<std::string> words{request.program};
    words.insert(words.end(), request.arguments.begin(), request.arguments.end());
    std::vector<char*> pointers;
    pointers.reserve(words.size() + 1);
    for (std::string& word : words) pointers.push_back(word.data());
    pointers.push_back(nullptr);
    // A file just written is "busy" for as long as another thread's new child, made while it was open, has not got as
    // far as its own program.
    constexpr int Attempts = 200;
    constexpr int PauseInMilliseconds = 5;
    int code = 0;
    for (int attempt = 0; attempt < Attempts; ++attempt) {
        code = ::posix_spawn(&pid, request.program.c_str(), &actions_, &attributes_, pointers.data(), environ);
        if (code != ETXTBSY) break;
        ::poll(nullptr, 0, PauseInMilliseconds);
    }
    return code;
}

}  // namespace

PosixProcessLauncher::~PosixProcessLauncher() {
    if (!folder_.empty()) ::rmdir(folder_.c_str());
}

Result<std::unique_ptr<RunningProcess>> PosixProcessLauncher::start(const ProcessRequest& request) {
    StandardStreams streams;
    if (!streams.open(request.takesInput)) return systemError("no streams for a program", errno);
    pid_t pid = 0;
    const int code = SpawnSettings(streams).spawn(request, pid);
    if (code != 0) return systemError("the program cannot be started", code);
    return {std::make_unique<PosixProcess>(pid, std::move(streams.input), std::move(streams.output),
                                           std::move(streams.error))};
}

Result<std::unique_ptr<TemporaryFile>> PosixProcessLauncher::makeTemporaryFile(std::string_view prefix,
                                                                               std::string_view bytes,
                                                                               bool executable) {
    auto path = newPath(prefix);
    if (!path) return path.error();
    const mode_t mode = executable ? 0700 : 0600;
    const FileDescriptor descriptor(
        ::open(path.value().c_str(), O_WRONLY | O_CREAT | O_EXCL | O_NOFOLLOW | O_CLOEXEC, mode));
    if (!descriptor.isOpen()) return systemError("a temporary file cannot be made", errno);
    auto file = std::make_unique<PosixTemporaryFile>(std::move(path).value());
    if (!writeAll(descriptor, bytes)) return systemError("a temporary file cannot be written", errno);
    return {std::move(file)};
}

Result<std::unique_ptr<NamedStream>> PosixProcessLauncher::makeNamedStream() {
    auto path = newPath("Stream");
    if (!path) return path.error();
    if (::mkfifo(path.value().c_str(), 0600) != 0) return systemError("a pipe cannot be made", errno);
    auto file = std::make_unique<PosixTemporaryFile>(std::move(path).value());
    FileDescriptor descriptor(::open(file->path().c_str(), O_RDONLY | O_NONBLOCK | O_CLOEXEC));
    if (!descriptor.isOpen()) return systemError("a pipe cannot be opened", errno);
    return {std::make_unique<PosixStream>(std::move(descriptor), std::move(file))};
}

// The folder is looked at every time: cleaners of temporary directories remove what has lain there for some days.
Result<std::string> PosixProcessLauncher::newPath(std::string_view prefix) {
    const std::lock_guard lock(mutex_);
    if (folder_.empty() || ::access(folder_.c_str(), X_OK) != 0) {
        const char* const configured = std::getenv("TMPDIR");
        std::string pattern = configured && *configured == '/' ? configured : "/tmp";
        pattern += "/Plume-XXXXXX";
        if (!::mkdtemp(pattern.data())) return systemError("no temporary folder can be made", errno);
        folder_ = pattern;
    }
    return folder_ + "/" + std::string(prefix) + std::to_string(++lastNumber_);
}

}  // namespace plume
