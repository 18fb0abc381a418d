#include "ports/posix/PosixProcess.h"

#include <poll.h>
#include <sys/socket.h>
#include <sys/syscall.h>
#include <sys/wait.h>

#include <algorithm>
#include <cerrno>
#include <csignal>
#include <vector>

namespace plume {

namespace {

// For poll: rounded up, so that a wait never ends just before its deadline and is begun again for nothing.
int millisecondsUntil(Moment deadline) {
    const auto left = std::chrono::ceil<std::chrono::milliseconds>(deadline - Moment::clock::now()).count();
    return static_cast<int>(std::clamp<decltype(left)>(left, 0, 60'000));
}

// The C library's own function for this is missing in older versions and unusable from C++ in others.
FileDescriptor exitSignalOf(pid_t pid) {
    return FileDescriptor(static_cast<int>(::syscall(SYS_pidfd_open, pid, 0)));
}

}  // namespace

PosixProcess::PosixProcess(pid_t pid, FileDescriptor input, FileDescriptor output, FileDescriptor error)
    : pid_(pid),
      input_(std::move(input)),
      exitSignal_(exitSignalOf(pid)),
      output_(std::move(output)),
      error_(std::move(error)) {}

PosixProcess::~PosixProcess() {
    if (!exitStatus()) endGroup();
}

bool PosixProcess::write(std::string_view bytes, Moment deadline) {
    while (!bytes.empty()) {
        const ssize_t count = ::send(input_.get(), bytes.data(), bytes.size(), MSG_NOSIGNAL | MSG_DONTWAIT);
        if (count >= 0) {
            bytes.remove_prefix(static_cast<std::size_t>(count));
            continue;
        }
        if (errno == EINTR) continue;
        if (errno != EAGAIN && errno != EWOULDBLOCK) return false;
        if (Moment::clock::now() >= deadline) return false;
        pollfd writable{input_.get(), POLLOUT, 0};
        ::poll(&writable, 1, millisecondsUntil(deadline));
    }
    return true;
}

void PosixProcess::wait(std::span<ProcessStream* const> streams, Moment deadline) {
    std::vector<pollfd> descriptors;
    descriptors.reserve(streams.size() + 1);
    // Every stream of this launcher is a PosixStream.
    for (ProcessStream* stream : streams) {
        descriptors.push_back({static_cast<PosixStream*>(stream)->pollDescriptor(), POLLIN, 0});
    }
    descriptors.push_back({exitSignal_.get(), POLLIN, 0});
    if (::poll(descriptors.data(), descriptors.size(), millisecondsUntil(deadline)) <= 0) return;
    for (std::size_t i = 0; i < streams.size(); ++i) {
        const short events = descriptors[i].revents;
        if (events != 0 && (events & POLLIN) == 0) static_cast<PosixStream*>(streams[i])->setHungUp();
    }
}

void PosixProcess::reap(int options) {
    int status = 0;
    pid_t reaped = 0;
    do {
        reaped = ::waitpid(pid_, &status, options);
    } while (reaped < 0 && errno == EINTR);
    if (reaped == 0) return;
    // Where somebody else waited for the process its status is unknown.
    if (reaped < 0) status = 0;
    exitStatus_ = WIFSIGNALED(status) ? 128 + WTERMSIG(status) : WEXITSTATUS(status);
}

std::optional<int> PosixProcess::exitStatus() {
    if (!exitStatus_) reap(WNOHANG);
    return exitStatus_;
}

// The group is signalled before its leader is waited for: until then its number cannot belong to anybody else.
void PosixProcess::endGroup() {
    if (exitStatus_) return;
    ::kill(-pid_, SIGKILL);
    reap(0);
}

}  // namespace plume
