#include "testing/rig/ChildProcess.h"

#include <fcntl.h>
#include <sys/prctl.h>
#include <sys/syscall.h>
#include <sys/wait.h>

#include <array>
#include <cerrno>
#include <cstring>
#include <fstream>

#include "testing/rig/Deadline.h"

namespace plume::rig {

namespace {

std::vector<char*> pointersOf(const std::vector<std::string>& strings) {
    std::vector<char*> pointers;
    pointers.reserve(strings.size() + 1);
    for (const auto& string : strings) pointers.push_back(const_cast<char*>(string.c_str()));
    pointers.push_back(nullptr);
    return pointers;
}

// Everything the new process needs, prepared before fork: between fork and exec nothing may allocate.
struct Prepared {
    std::vector<char*> arguments;
    std::vector<char*> environment;
    const std::vector<int>* keptDescriptors;
    pid_t parent;
    int parentDeathSignal;
    int input;
    int output;
    int errorPipe;
};

[[noreturn]] void becomeProgram(const Prepared& prepared) {
    prctl(PR_SET_PDEATHSIG, prepared.parentDeathSignal);
    if (getppid() != prepared.parent) _exit(127);  // the parent died before the signal was set
    setpgid(0, 0);
    sigset_t none;
    sigemptyset(&none);
    sigprocmask(SIG_SETMASK, &none, nullptr);
    dup2(prepared.input, STDIN_FILENO);
    dup2(prepared.output, STDOUT_FILENO);
    dup2(prepared.output, STDERR_FILENO);
    for (int fd : *prepared.keptDescriptors) fcntl(fd, F_SETFD, 0);
    execve(prepared.arguments.front(), prepared.arguments.data(), prepared.environment.data());
    const int reason = errno;
    [[maybe_unused]] const auto written = write(prepared.errorPipe, &reason, sizeof reason);
    _exit(127);
}

}  // namespace

ChildProcess::ChildProcess(const Start& start)
    : name_(std::filesystem::path(start.arguments.at(0)).filename().string()), log_(start.log) {
    const FileDescriptor input(open("/dev/null", O_RDONLY | O_CLOEXEC));
    const FileDescriptor output(open(log_.c_str(), O_WRONLY | O_CREAT | O_APPEND | O_CLOEXEC, 0600));
    std::array<int, 2> ends{};
    if (!input || !output || pipe2(ends.data(), O_CLOEXEC) != 0) throw RigError("cannot prepare to start " + name_);
    const FileDescriptor errorReader(ends[0]);
    FileDescriptor errorWriter(ends[1]);
    const Prepared prepared{pointersOf(start.arguments),
                            pointersOf(start.environment),
                            &start.keptDescriptors,
                            getpid(),
                            start.parentDeathSignal,
                            input.get(),
                            output.get(),
                            errorWriter.get()};
    pid_ = fork();
    if (pid_ == 0) becomeProgram(prepared);
    if (pid_ < 0) throw RigError("cannot start " + name_ + ": " + std::strerror(errno));
    setpgid(pid_, pid_);  // also here, so that the group exists whichever of the two runs first
    exitDescriptor_ = FileDescriptor(static_cast<int>(syscall(SYS_pidfd_open, pid_, 0)));
    errorWriter.close();
    int reason = 0;
    if (read(errorReader.get(), &reason, sizeof reason) == sizeof reason) {
        reap();
        throw RigError("cannot start " + start.arguments.front() + ": " + std::strerror(reason));
    }
}

ChildProcess::~ChildProcess() {
    end();
}

bool ChildProcess::isRunning() {
    return !waitForExit(Milliseconds(0)).has_value();
}

std::optional<int> ChildProcess::waitForExit(Milliseconds bound) {
    if (!status_ && Deadline(bound).waitReadable(exitDescriptor_.get())) reap();
    return status_;
}

void ChildProcess::stop() const {
    kill(pid_, SIGSTOP);
    siginfo_t stopped{};
    while (waitid(P_PID, static_cast<id_t>(pid_), &stopped, WSTOPPED | WEXITED | WNOWAIT) < 0 && errno == EINTR) {
    }
}

void ChildProcess::end() {
    if (status_) return;
    kill(-pid_, SIGTERM);
    Deadline(Milliseconds(2000)).waitReadable(exitDescriptor_.get());
    reap();
}

// Until the leader has been waited for, its process group cannot be anybody else's: the moment to end what is left in
// it.
void ChildProcess::reap() {
    kill(-pid_, SIGKILL);
    int status = 0;
    while (waitpid(pid_, &status, 0) < 0 && errno == EINTR) {
    }
    status_ = WIFEXITED(status) ? WEXITSTATUS(status) : 128 + WTERMSIG(status);
}

std::string ChildProcess::logTail() const {
    std::ifstream file(log_, std::ios::binary);
    std::string text{std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
    constexpr std::size_t Longest = 4000;
    if (text.size() > Longest) text.erase(0, text.size() - Longest);
    return text;
}

}  // namespace plume::rig
