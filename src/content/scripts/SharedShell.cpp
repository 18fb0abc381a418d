#include "content/scripts/SharedShell.h"

#include <algorithm>
#include <array>

#include "Foundation/Strings.h"
#include "Foundation/Uuid.h"

namespace plume {

namespace {

constexpr const char* ShellProgram = "/bin/sh";

std::string quoted(std::string_view text) {
    std::string result = "'";
    for (const char c : text) {
        if (c == '\'') {
            result += "'\\''";
        } else {
            result += c;
        }
    }
    return result + "'";
}

std::string without(std::string_view text, std::string_view pattern) {
    std::string result;
    result.reserve(text.size());
    std::size_t position = 0;
    for (auto at = text.find(pattern); at != std::string_view::npos; at = text.find(pattern, position)) {
        result.append(text.substr(position, at - position));
        position = at + pattern.size();
    }
    return result.append(text.substr(position));
}

}  // namespace

SharedShell::~SharedShell() {
    if (!shell_) return;
    constexpr auto Patience = std::chrono::milliseconds(200);
    const Moment deadline = Moment::clock::now() + Patience;
    shell_->closeInput();
    while (!shell_->exitStatus() && Moment::clock::now() < deadline) shell_->wait({}, deadline);
}

ScriptOutput SharedShell::run(std::string_view script, const ScriptWatch& watch) {
    auto prepared = prepare(script);
    if (!prepared) return ScriptOutput::notStarted(prepared.error());
    const Task& task = prepared.value();
    if (const auto sent = sendToShell(task, watch); !sent) return ScriptOutput::notStarted(sent.error());
    ScriptOutput written = follow(task, watch);
    // The shell's messages name the file, which the user has never seen.
    written.error = without(written.error, task.file->path() + ": ");
    return written;
}

Result<SharedShell::Task> SharedShell::prepare(std::string_view script) {
    std::string text(script);
    // No shell can do anything with this character; some refuse the whole file for it.
    std::erase(text, '\0');
    text += '\n';
    auto file = launcher_.makeTemporaryFile("Plume", text, false);
    if (!file) return file.error();
    auto output = launcher_.makeNamedStream();
    if (!output) return output.error();
    auto error = launcher_.makeNamedStream();
    if (!error) return error.error();
    return Task{std::move(file).value(), std::move(output).value(), std::move(error).value(),
                toUtf8(Uuid::random().toString()), toUtf8(Uuid::random().toString())};
}

// "command" keeps the shell alive when the script has a syntax error, which would otherwise end it. A function of that
// name would run in its place: "unset", which no function replaces, takes it away first. The backslashes guard against
// aliases. Everything is on one line, which the shell has read to its end before it runs any of it: what a script does
// keeps the end marker from being written only when it ends or stops the shell, or, where the shell is bash, makes such
// a function read-only. A script that no marker ends runs into its time limit, and the next one has a new shell.
Result<void> SharedShell::sendToShell(const Task& task, const ScriptWatch& watch) {
    const std::string command = "\\unset -f command; \\command ";
    const auto telling = [&command](const std::string& marker) {
        return command + "printf '%s\\n' " + quoted(marker) + ";; ";
    };
    const std::string line = command + ". " + quoted(task.file->path()) + " </dev/null >" +
                             quoted(task.output->path()) + " 2>" + quoted(task.error->path()) + "; case $? in 0) " +
                             telling(task.endMarker) + "*) " + telling(task.failureMarker) + "esac\n";
    if (shell_ && shell_->exitStatus()) shell_.reset();
    if (shell_ && shell_->write(line, watch.deadline())) return {};
    shell_.reset();
    if (auto started = startShell(); !started) return started;
    if (shell_->write(line, watch.deadline())) return {};
    shell_.reset();
    return Error{"the shell does not read its input"};
}

Result<void> SharedShell::startShell() {
    auto started = launcher_.start({ShellProgram, {}, true});
    if (!started) return started.error();
    shell_ = std::move(started).value();
    return {};
}

ScriptOutput SharedShell::follow(const Task& task, const ScriptWatch& watch) {
    ScriptOutput written;
    ScriptOutput shellsOwn;  // on the streams that scripts do not have
    const std::array<ProcessStream*, 4> streams{task.output.get(), task.error.get(), &shell_->output(),
                                                &shell_->error()};
    for (;;) {
        const bool hasExited = shell_->exitStatus().has_value();
        shellsOwn.read(shell_->output(), shell_->error());
        const bool hasFailed = shellsOwn.output.find(task.failureMarker) != std::string::npos;
        const bool hasFinished = hasFailed || shellsOwn.output.find(task.endMarker) != std::string::npos;
        if (hasExited || hasFinished) {
            written.readRest(*task.output, *task.error);
            if (!hasFinished) {
                // It wrote these while it exited, when the script's streams were its own no longer.
                shellsOwn.readRest(shell_->output(), shell_->error());
                written.output += shellsOwn.output;
                written.error += shellsOwn.error;
            }
            written.failed = hasFailed || (!hasFinished && shell_->exitStatus() != 0);
            if (hasExited) shell_.reset();
            return written;
        }
        written.read(*task.output, *task.error);
        auto verdict = watch.verdict(written);
        if (!verdict) verdict = watch.verdict(shellsOwn);
        if (verdict) {
            shell_->endGroup();
            shell_.reset();
            written.readRest(*task.output, *task.error);
            written.end = *verdict;
            return written;
        }
        shell_->wait(streams, watch.nextLook());
    }
}

}  // namespace plume
