#include "ports/x11/watchdog/Watchdog.h"

#include <fcntl.h>
#include <poll.h>
#include <spawn.h>
#include <sys/socket.h>
#include <sys/syscall.h>
#include <sys/wait.h>

#include <cerrno>
#include <cmath>
#include <csignal>
#include <filesystem>
#include <system_error>
#include <utility>
#include <vector>

namespace plume {

namespace {

constexpr std::size_t MostStarts = 3;
constexpr double StartsPeriod = 60;
constexpr double LongestStart = 0.5;
// An ending process has the keyboard to free, which takes a few milliseconds.
constexpr int EndBoundInMilliseconds = 500;

std::string programBesideThisOne() {
    std::error_code error;
    const auto self = std::filesystem::read_symlink("/proc/self/exe", error);
    return (self.parent_path() / "plume-watchdog").string();
}

// How the child differs from Plume: its socket, a group of its own, so that what a terminal sends to Plume's group does
// not end it first, no signal blocked or ignored, no other descriptors but those that are shared.
int spawn(const std::string& program, const std::string& display, int socket, Watchdog::Shared shared, pid_t& process) {
    posix_spawn_file_actions_t actions;
    posix_spawn_file_actions_init(&actions);
    posix_spawn_file_actions_adddup2(&actions, socket, WatchdogSocket);
    posix_spawn_file_actions_addopen(&actions, STDOUT_FILENO, "/dev/null", O_WRONLY, 0);
    // A copy that lies where the other cannot be put over it.
    const FileDescriptor progress(fcntl(shared.tapProgress, F_DUPFD_CLOEXEC, WatchdogTapProgress + 1));
    const std::pair<int, int> inherited[] = {{shared.clipboard, WatchdogClipboard},
                                             {progress.get(), WatchdogTapProgress}};
    for (const auto& [from, to] : inherited) {
        if (from >= 0) {
            posix_spawn_file_actions_adddup2(&actions, from, to);
        } else {
            posix_spawn_file_actions_addclose(&actions, to);
        }
    }
    posix_spawn_file_actions_addclosefrom_np(&actions, WatchdogTapProgress + 1);
    posix_spawnattr_t attributes;
    posix_spawnattr_init(&attributes);
    sigset_t signals;
    sigemptyset(&signals);
    posix_spawnattr_setsigmask(&attributes, &signals);
    sigfillset(&signals);
    posix_spawnattr_setsigdefault(&attributes, &signals);
    posix_spawnattr_setpgroup(&attributes, 0);
    posix_spawnattr_setflags(&attributes, POSIX_SPAWN_SETPGROUP | POSIX_SPAWN_SETSIGMASK | POSIX_SPAWN_SETSIGDEF);
    std::string name = program;
    std::string argument = display;
    char* const words[] = {name.data(), argument.data(), nullptr};
    const int code = posix_spawn(&process, program.c_str(), &actions, &attributes, words, environ);
    posix_spawnattr_destroy(&attributes);
    posix_spawn_file_actions_destroy(&actions);
    return code;
}

}  // namespace

Watchdog::Watchdog(PollRunLoop& loop, std::string display, Shared shared)
    : loop_(loop), display_(std::move(display)), program_(programBesideThisOne()), shared_(shared) {}

Watchdog::~Watchdog() {
    source_.end();
    socket_.close();
    reap();
}

Result<void> Watchdog::start() {
    int ends[2];
    if (socketpair(AF_UNIX, SOCK_SEQPACKET | SOCK_CLOEXEC, 0, ends) != 0) {
        return Error{"no socket for the watchdog: " + std::generic_category().message(errno)};
    }
    FileDescriptor mine(ends[0]);
    const FileDescriptor theirs(ends[1]);
    starts_.push_back(loop_.now());
    heardWindow_ = 0;
    // It finds the window waiting, should Plume be stopped before it gets any further.
    sendWatchdogMessage(mine.get(), {WatchdogMessage::Type::TapWindow, tapWindow_});
    const int code = spawn(program_, display_, theirs.get(), shared_, process_);
    if (code != 0) {
        process_ = 0;
        return Error{"the watchdog " + program_ + " cannot be started: " + std::generic_category().message(code)};
    }
    socket_ = std::move(mine);
    source_ = loop_.addSource(socket_.get(), [this] { beat(); });
    return {};
}

void Watchdog::setTapWindow(std::uint32_t window) {
    tapWindow_ = window;
    if (socket_.isOpen()) sendWatchdogMessage(socket_.get(), {WatchdogMessage::Type::TapWindow, window});
}

void Watchdog::beat() {
    while (socket_.isOpen()) {
        const auto received = receiveWatchdogMessage(socket_.get());
        if (const auto* const message = std::get_if<WatchdogMessage>(&received)) {
            take(*message);
            continue;
        }
        if (std::get<WatchdogSilence>(received) == WatchdogSilence::NothingYet) return;
        source_.end();
        socket_.close();
        reap();
        replace();
    }
}

void Watchdog::take(const WatchdogMessage& message) {
    if (message.type == WatchdogMessage::Type::Listening) heardWindow_ = message.value;
    if (message.type != WatchdogMessage::Type::Ping) return;
    sendWatchdogMessage(socket_.get(), {WatchdogMessage::Type::Answer, message.value});
}

void Watchdog::awaitListening() {
    const double end = loop_.now() + LongestStart;
    while (socket_.isOpen() && heardWindow_ != tapWindow_) {
        const double left = end - loop_.now();
        pollfd entry{socket_.get(), POLLIN, 0};
        if (left <= 0 || poll(&entry, 1, static_cast<int>(std::ceil(left * 1000))) == 0) return;
        beat();
    }
}

void Watchdog::replace() {
    const double now = loop_.now();
    while (!starts_.empty() && starts_.front() <= now - StartsPeriod) starts_.pop_front();
    if (starts_.size() < MostStarts && start()) return;
    const double delay = starts_.size() < MostStarts ? StartsPeriod : starts_.front() + StartsPeriod - now;
    laterStart_ = loop_.performAfterDelay(delay, [this] { replace(); });
}

void Watchdog::reap() {
    if (process_ == 0) return;
    const FileDescriptor exit(static_cast<int>(syscall(SYS_pidfd_open, process_, 0)));
    pollfd entry{exit.get(), POLLIN, 0};
    if (!exit.isOpen() || poll(&entry, 1, EndBoundInMilliseconds) <= 0) kill(process_, SIGKILL);
    while (waitpid(process_, nullptr, 0) < 0 && errno == EINTR) {
    }
    process_ = 0;
}

}  // namespace plume
