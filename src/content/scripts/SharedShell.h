// The one shell that runs all shell scripts without an interpreter of their own.
//
// Scripts find what those before them left (working directory, variables, functions), as for a person typing them one
// after the other. The shell is started when it is first needed and again after it was lost: a script may exit it, and
// a script that is ended takes it along. Each script reads an empty input and writes to streams of its own, so that
// what an earlier one left running in the background cannot write into a later one's output.
//
// Used by one thread at a time.
#pragma once

#include <memory>
#include <string>
#include <string_view>

#include "content/scripts/ScriptOutput.h"
#include "platform/ProcessLauncher.h"

namespace plume {

class SharedShell {
  public:
    // The launcher is not owned and outlives the shell.
    explicit SharedShell(ProcessLauncher& launcher) : launcher_(launcher) {}
    // Ends the shell; what its scripts left running in the background goes on.
    ~SharedShell();
    SharedShell(const SharedShell&) = delete;
    SharedShell& operator=(const SharedShell&) = delete;

    // Runs a script, given as UTF-8, until it has ended or `watch` says that it must.
    ScriptOutput run(std::string_view script, const ScriptWatch& watch);

  private:
    // One script, with what the shell needs to run it.
    struct Task {
        std::unique_ptr<TemporaryFile> file;
        std::unique_ptr<NamedStream> output;
        std::unique_ptr<NamedStream> error;
        std::string endMarker;
        std::string failureMarker;  // written instead where the script failed
    };

    Result<Task> prepare(std::string_view script);
    Result<void> sendToShell(const Task& task, const ScriptWatch& watch);
    Result<void> startShell();
    ScriptOutput follow(const Task& task, const ScriptWatch& watch);

    ProcessLauncher& launcher_;
    std::unique_ptr<RunningProcess> shell_;  // null: not running
};

}  // namespace plume
