#include "content/scripts/ShellScriptRunner.h"

#include <cmath>
#include <filesystem>
#include <system_error>

#include "Foundation/Strings.h"
#include "content/scripts/ScriptProcess.h"

namespace plume {

namespace {

constexpr std::string_view BashLine = "#!/bin/bash";

// A bash that is not there cannot run anything: its scripts are tried with what is.
bool shUnderstandsBash() {
    static const bool understands = [] {
        std::error_code problem;
        return std::filesystem::equivalent("/bin/sh", "/bin/bash", problem) || problem;
    }();
    return understands;
}

bool asksForBash(std::string_view script) {
    if (!script.starts_with(BashLine)) return false;
    const std::string_view rest = script.substr(BashLine.size());
    return rest.empty() || rest.find_first_of(" \t\n") == 0;
}

bool belongsToSharedShell(std::string_view script) {
    if (asksForBash(script)) return shUnderstandsBash();
    return !script.starts_with("#!") || script.starts_with("#!/bin/sh") || script.starts_with(BashLine);
}

std::string secondsInWords(double seconds) {
    const long long whole = std::llround(seconds);
    return whole == 1 ? "1 second" : std::to_string(whole) + " seconds";
}

bool existsAppleScriptRunner() {
    std::error_code problem;
    return std::filesystem::exists(AppleScriptRunner, problem);
}

ScriptOutput stoppedBeforeStart() {
    ScriptOutput nothing;
    nothing.end = ScriptEnd::Stopped;
    return nothing;
}

}  // namespace

ShellScriptRunner::ShellScriptRunner(ProcessLauncher& launcher, Report report, ScriptLimits limits)
    : launcher_(launcher), report_(std::move(report)), limits_(limits), shell_(launcher) {}

std::optional<std::u16string> ShellScriptRunner::run(std::u16string_view script, bool isAppleScript) {
    if (isAppleScript && !canRunAppleScript()) {
        allSucceeded_ = false;
        return std::nullopt;
    }
    const ScriptOutput written = outputOf(script, isAppleScript);
    reportEnd(written);
    return written.delivered();
}

ScriptOutput ShellScriptRunner::outputOf(std::u16string_view script, bool isAppleScript) {
    const std::string text = toUtf8(script);
    ScriptOutput written =
        !isAppleScript && belongsToSharedShell(text) ? runInSharedShell(text) : runInOwnProcess(text, isAppleScript);
    if (written.failed || written.end != ScriptEnd::Finished) allSucceeded_ = false;
    return written;
}

ScriptOutput ShellScriptRunner::runInSharedShell(std::string_view script) {
    const std::lock_guard lock(shellMutex_);
    if (stopped_) return stoppedBeforeStart();
    return shell_.run(script, ScriptWatch(limits_, stopped_));
}

ScriptOutput ShellScriptRunner::runInOwnProcess(std::string_view script, bool isAppleScript) {
    if (stopped_) return stoppedBeforeStart();
    if (isAppleScript && !existsAppleScriptRunner())
        return ScriptOutput::notStarted(Error{std::string("there is no ") + AppleScriptRunner});
    const auto prepared = newTaskForScript(script, isAppleScript, launcher_);
    if (!prepared) return ScriptOutput::notStarted(prepared.error());
    return runScriptProcess(prepared.value(), launcher_, ScriptWatch(limits_, stopped_));
}

bool ShellScriptRunner::canRunAppleScript() {
    if (existsAppleScriptRunner()) return true;
    if (!toldAboutAppleScript_.exchange(true)) {
        report_(std::string("AppleScript snippets cannot run on this system: there is no ") + AppleScriptRunner + ".");
    }
    return false;
}

void ShellScriptRunner::reportEnd(const ScriptOutput& written) const {
    switch (written.end) {
        case ScriptEnd::Finished:
        case ScriptEnd::Stopped:
            return;
        case ScriptEnd::TimeLimit:
            return report_("A script was ended because it ran longer than " + secondsInWords(limits_.time) + ".");
        case ScriptEnd::OutputLimit:
            return report_("A script was ended because it wrote more than " +
                           std::to_string(limits_.output / 1'000'000) + " million characters.");
        case ScriptEnd::NotStarted:
            return report_("A script could not be run: " + written.problem + ".");
    }
}

}  // namespace plume
