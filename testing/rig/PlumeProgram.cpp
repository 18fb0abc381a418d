#include "testing/rig/PlumeProgram.h"

#include <poll.h>

#include <algorithm>
#include <fstream>
#include <utility>

#include "testing/rig/Deadline.h"

namespace plume::rig {

namespace {

using Seconds = std::chrono::duration<double>;

constexpr Milliseconds StartBound(20'000);

// Built next to the test program.
std::string builtPlume() {
    return std::filesystem::read_symlink("/proc/self/exe").parent_path() / "plume";
}

std::filesystem::path writeFile(const std::filesystem::path& file, const std::string& content) {
    std::ofstream(file) << content;
    return file;
}

std::u32string charactersOf(const std::string& utf8) {
    std::u32string characters;
    for (const char byte : utf8) {
        const auto bits = static_cast<unsigned char>(byte);
        if ((bits & 0xC0) == 0x80) {
            characters.back() = (characters.back() << 6) | (bits & 0x3F);
        } else {
            characters.push_back(bits < 0x80 ? bits : bits < 0xE0 ? bits & 0x1F : bits < 0xF0 ? bits & 0x0F : bits & 7);
        }
    }
    return characters;
}

// Follows a text through a target's changes.
void apply(const TextChange& change, std::u32string& text) {
    const auto position = std::min(static_cast<std::size_t>(change.position), text.size());
    text.replace(position, static_cast<std::size_t>(change.removed), charactersOf(change.inserted));
}

}  // namespace

PlumeProgram::PlumeProgram(DesktopRig& rig, const std::string& library, const std::string& settings,
                           Accessibility accessibility) {
    std::vector<std::string> arguments{"/usr/bin/env"};
    if (accessibility == Accessibility::Missing) {
        // The session's bus is also found in the folder of the session.
        const auto folder = rig.directory() / "run without a bus";
        std::filesystem::create_directory(folder);
        std::filesystem::permissions(folder, std::filesystem::perms::owner_all);
        arguments.insert(arguments.end(), {"-u", "DBUS_SESSION_BUS_ADDRESS", "XDG_RUNTIME_DIR=" + folder.string()});
    }
    arguments.insert(arguments.end(), {builtPlume(), "run"});
    if (!settings.empty()) {
        arguments.insert(arguments.end(), {"--settings", writeFile(rig.directory() / "settings.json", settings)});
    }
    if (!library.empty()) {
        arguments.insert(arguments.end(), {"--library", writeFile(rig.directory() / "library.json", library)});
    }
    start(rig, arguments, [this] { return process_->logTail().find("Plume is ready") != std::string::npos; });
}

std::unique_ptr<PlumeProgram> PlumeProgram::startApplication(DesktopRig& rig, const Environment& also) {
    std::vector<std::string> arguments{"/usr/bin/env"};
    arguments.insert(arguments.end(), also.begin(), also.end());
    arguments.push_back(builtPlume());
    std::unique_ptr<PlumeProgram> program(new PlumeProgram);
    program->start(rig, arguments, [&rig] { return runPlume(rig, {"status"}).status == 0; });
    return program;
}

void PlumeProgram::start(DesktopRig& rig, const std::vector<std::string>& arguments,
                         const std::function<bool()>& isReady) {
    const auto started = std::chrono::steady_clock::now();
    process_ = rig.session().start(arguments, "plume");
    const Deadline deadline(StartBound);
    while (!isReady()) {
        if (deadline.passed() || !process_->isRunning()) throw RigError("plume did not start: " + process_->logTail());
        poll(nullptr, 0, 1);
    }
    secondsToReady_ = Seconds(std::chrono::steady_clock::now() - started).count();
}

CommandOutcome runPlume(DesktopRig& rig, std::vector<std::string> arguments) {
    arguments.insert(arguments.begin(), builtPlume());
    const auto process = rig.session().start(arguments, "plume");
    const auto status = process->waitForExit(StartBound);
    if (!status) throw RigError("plume does not end: " + process->logTail());
    return {*status, process->logTail()};
}

bool becomes(DesktopRig& rig, TargetProgram& target, const std::string& typed, const std::string& expected,
             Milliseconds within) {
    target.clear();
    rig.keyboard().tap(Key::Home);  // what is typed next stands at the start, for Plume, too
    rig.keyboard().type(typed);
    return target.awaitText(expected, within) == expected;
}

bool soonBecomes(DesktopRig& rig, TargetProgram& target, const std::string& typed, const std::string& expected) {
    constexpr Milliseconds Once(2'000);
    return waitUntil([&] { return becomes(rig, target, typed, expected, Once); });
}

namespace {

// Follows the changes of a text until they have made the expected one.
Expansion follow(TargetProgram& target, std::u32string text, const std::string& expected,
                 std::chrono::steady_clock::time_point start) {
    const std::u32string awaited = charactersOf(expected);
    Expansion result;
    const Deadline deadline(Milliseconds(10'000));
    while (!deadline.passed() && !result.isRight) {
        const auto change = target.takeChange(Milliseconds(500));
        if (!change) continue;
        apply(*change, text);
        // Rich text is told of in larger pieces than what changed, so the target has the last word.
        const bool couldBeComplete = static_cast<std::size_t>(change->length) == awaited.size();
        result.isRight = text == awaited || (couldBeComplete && target.text() == expected);
        result.milliseconds = std::chrono::duration<double, std::milli>(change->time - start).count();
    }
    result.got = target.text();
    result.isRight = result.isRight && result.got == expected;
    return result;
}

}  // namespace

Expansion awaitExpansion(TargetProgram& target, const std::string& expected, const std::function<void()>& make) {
    target.clear();
    const auto start = std::chrono::steady_clock::now();
    make();
    return follow(target, {}, expected, start);
}

Expansion typeAndAwait(DesktopRig& rig, TargetProgram& target, const std::string& typed, const std::string& expected) {
    const std::string first = typed.substr(0, typed.size() - 1);
    awaitExpansion(target, first, [&] { rig.keyboard().type(first); });
    const auto pressed = std::chrono::steady_clock::now();
    rig.keyboard().type(typed.substr(typed.size() - 1));
    return follow(target, charactersOf(first), expected, pressed);
}

}  // namespace plume::rig
