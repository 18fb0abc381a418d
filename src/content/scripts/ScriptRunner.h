// Who runs scripts for PLScript: the shared shell, and processes of their own for scripts with another interpreter.
#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace plume {

class ScriptRunner {
  public:
    virtual ~ScriptRunner() = default;
    // Runs the script to its end, or to the time limit, and returns its whole output (standard error when standard
    // output stayed empty) without one trailing line feed; nothing when there was none. Blocks; where scripts share a
    // shell, one at a time has it and the others wait. From any thread.
    virtual std::optional<std::u16string> run(std::u16string_view script, bool isAppleScript) = 0;
    // False where nothing here runs AppleScript; the user is told so the first time. From any thread.
    virtual bool canRunAppleScript() = 0;
};

}  // namespace plume
