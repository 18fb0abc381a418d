#pragma once

#include <sys/types.h>

#include <csignal>
#include <filesystem>
#include <optional>
#include <string>
#include <vector>

#include "testing/rig/FileDescriptor.h"
#include "testing/rig/RigError.h"

namespace plume::rig {

// "NAME=value" lines, as a program gets them.
using Environment = std::vector<std::string>;

// A program in a process group of its own. It ends with this object and, through the parent-death signal, also when the
// test program dies without a chance to clean up. That signal is tied to the thread that starts the program: start
// programs from a thread that lives as long as the test does. One owner, one thread.
class ChildProcess {
  public:
    struct Start {
        std::vector<std::string> arguments;  // the first is the program's full path
        Environment environment;
        std::filesystem::path log;              // gets standard output and standard error
        std::vector<int> keptDescriptors = {};  // stay open in the program, under the same numbers
        int parentDeathSignal = SIGTERM;        // SIGKILL for a program that may not react
    };

    explicit ChildProcess(const Start& start);  // throws RigError when the program cannot be started
    ~ChildProcess();
    ChildProcess(const ChildProcess&) = delete;
    ChildProcess& operator=(const ChildProcess&) = delete;

    const std::string& name() const { return name_; }
    pid_t pid() const { return pid_; }
    bool isRunning();

    // The exit status (128 + signal when a signal ended it), or nothing when it still runs after `bound`.
    std::optional<int> waitForExit(Milliseconds bound);

    // As by SIGSTOP. When this returns, no thread of the program runs any more; SIGCONT lets it go on.
    void stop() const;

    // Asks the whole group to end, and kills what is still there after two seconds.
    void end();

    // What the program wrote so far, its last 4000 bytes: for the message of a failed test.
    std::string logTail() const;

  private:
    void reap();

    std::string name_;
    std::filesystem::path log_;
    pid_t pid_ = -1;
    FileDescriptor exitDescriptor_;  // a pidfd: readable once the program has ended
    std::optional<int> status_;
};

}  // namespace plume::rig
