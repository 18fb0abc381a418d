// Scripts that run in a process of their own: AppleScript, and shell scripts that name another interpreter.
//
// Used on the thread that runs the script.
#pragma once

#include <memory>
#include <string>
#include <string_view>

#include "content/scripts/ScriptOutput.h"
#include "platform/ProcessLauncher.h"

namespace plume {

// What runs AppleScript, where there is such a thing.
inline constexpr const char* AppleScriptRunner = "/usr/bin/osascript";

// A script ready to be started. Its file, when it was made for this, is removed with it.
struct ScriptProcess {
    ProcessRequest request;
    std::unique_ptr<TemporaryFile> file;
};

// `script` is the script's text, or the path of an existing file ("~" stands for the user's home folder).
Result<ScriptProcess> newTaskForScript(std::string_view script, bool isAppleScript, ProcessLauncher& launcher);

// Runs it until its program has ended; what the program leaves running in the background is not waited for.
ScriptOutput runScriptProcess(const ScriptProcess& script, ProcessLauncher& launcher, const ScriptWatch& watch);

}  // namespace plume
