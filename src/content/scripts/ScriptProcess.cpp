#include "content/scripts/ScriptProcess.h"

#include <array>
#include <cstdlib>
#include <filesystem>
#include <system_error>

namespace plume {

namespace {

constexpr const char* DefaultInterpreter = "/bin/sh";

bool isFile(const std::string& path) {
    std::error_code problem;
    return path.find('\0') == std::string::npos && std::filesystem::is_regular_file(path, problem);
}

// The path that the text stands for when it names an existing file, else empty.
std::string existingFile(std::string_view text) {
    std::string path(text);
    const char* const home = std::getenv("HOME");
    if (home && (path == "~" || path.starts_with("~/"))) path.replace(0, 1, home);
    return isFile(path) ? path : std::string();
}

std::string_view trimmedSpaces(std::string_view text) {
    const auto first = text.find_first_not_of(" \t");
    if (first == std::string_view::npos) return {};
    return text.substr(first, text.find_last_not_of(" \t") - first + 1);
}

// The interpreter of a script file, with its one argument. It is looked for in the text that was given, which is the
// path here and hardly ever has such a line: the files of a library have always been run by the default one.
ProcessRequest requestForFile(const std::string& file, std::string_view text) {
    const auto lineEnd = text.find('\n');
    if (!text.starts_with("#!") || lineEnd == std::string_view::npos) return {DefaultInterpreter, {file}};
    const std::string_view line = trimmedSpaces(text.substr(2, lineEnd - 2));
    const auto space = line.find(' ');
    std::string program(line.substr(0, space));
    if (!isFile(program)) program = DefaultInterpreter;
    if (space == std::string_view::npos) return {std::move(program), {file}};
    return {std::move(program), {std::string(line.substr(space + 1)), file}};
}

std::string textForFile(std::string_view script, bool isAppleScript) {
    std::string text(script);
    if (isAppleScript) return text;
    if (!text.starts_with("#!")) return "#!/bin/sh\n" + text;
    if (!text.ends_with('\n')) text += '\n';
    return text;
}

}  // namespace

Result<ScriptProcess> newTaskForScript(std::string_view script, bool isAppleScript, ProcessLauncher& launcher) {
    if (const std::string path = existingFile(script); !path.empty()) {
        if (isAppleScript) return ScriptProcess{{AppleScriptRunner, {path}}, nullptr};
        return ScriptProcess{requestForFile(path, script), nullptr};
    }
    auto file = launcher.makeTemporaryFile("Plume", textForFile(script, isAppleScript), !isAppleScript);
    if (!file) return file.error();
    const std::string path = file.value()->path();
    if (isAppleScript) return ScriptProcess{{AppleScriptRunner, {path}}, std::move(file).value()};
    return ScriptProcess{{path, {}}, std::move(file).value()};
}

ScriptOutput runScriptProcess(const ScriptProcess& script, ProcessLauncher& launcher, const ScriptWatch& watch) {
    const auto started = launcher.start(script.request);
    if (!started) return ScriptOutput::notStarted(started.error());
    ScriptOutput written;
    RunningProcess& process = *started.value();
    const std::array<ProcessStream*, 2> streams{&process.output(), &process.error()};
    // Whether it has ended is asked before the streams are read, so that what it wrote last is read, too.
    while (!process.exitStatus()) {
        written.read(process.output(), process.error());
        if (const auto verdict = watch.verdict(written)) {
            process.endGroup();
            written.end = *verdict;
            break;
        }
        process.wait(streams, watch.nextLook());
    }
    written.failed = process.exitStatus().value_or(0) != 0;
    written.readRest(process.output(), process.error());
    return written;
}

}  // namespace plume
