// Runs scripts for real: in the shared shell, or in a process of their own.
#pragma once

#include <atomic>
#include <functional>
#include <mutex>
#include <optional>
#include <string>
#include <string_view>

#include "content/scripts/ScriptOutput.h"
#include "content/scripts/ScriptRunner.h"
#include "content/scripts/SharedShell.h"
#include "platform/ProcessLauncher.h"

namespace plume {

// Made by the composition root and kept for the application's life. Shell scripts share one shell and wait for each
// other; a script with a process of its own waits for nobody. A script that asks for bash has its own where the shared
// shell, which is /bin/sh, is another one. A script that runs into a limit is ended with everything
// it started, and delivers what it had written until then when the limit was its time. Its limits count from its start.
class ShellScriptRunner final : public ScriptRunner {
  public:
    // Tells the user, in one sentence that repeats nothing of the script, why a script was ended or could not run.
    // Called on the thread that runs the script.
    using Report = std::function<void(const std::string&)>;

    // The launcher is not owned and outlives the runner.
    ShellScriptRunner(ProcessLauncher& launcher, Report report, ScriptLimits limits = {});

    std::optional<std::u16string> run(std::u16string_view script, bool isAppleScript) override;
    bool canRunAppleScript() override;
    // The same as run(), with everything that the script wrote; nothing is reported.
    ScriptOutput outputOf(std::u16string_view script, bool isAppleScript);
    // Every script that was asked for has run to its end, and none said that it failed. From any thread.
    bool allSucceeded() const { return allSucceeded_; }
    // Ends what runs, within moments, and runs nothing from now on: for quitting while a script is at work on another
    // thread. From any thread.
    void stop() { stopped_ = true; }

  private:
    ScriptOutput runInSharedShell(std::string_view script);
    ScriptOutput runInOwnProcess(std::string_view script, bool isAppleScript);
    void reportEnd(const ScriptOutput& written) const;

    ProcessLauncher& launcher_;
    const Report report_;
    const ScriptLimits limits_;
    std::atomic<bool> stopped_ = false;
    std::atomic<bool> allSucceeded_ = true;
    std::atomic<bool> toldAboutAppleScript_ = false;
    std::mutex shellMutex_;
    SharedShell shell_;  // guarded by shellMutex_
};

}  // namespace plume
