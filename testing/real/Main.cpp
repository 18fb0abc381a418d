// Types into real programs of a desktop, with Plume beside them, and prints what came of it as a table; ends with 0
// only when all of it is as expected.
//   plume_real_programs [--pictures FOLDER] [--program NAME] [--place NAME] [--story NAME] [--times N]
//                       [--rows JSON] [--without-accessibility] [--list]
#include <exception>
#include <iomanip>
#include <iostream>
#include <map>
#include <optional>
#include <string>
#include <vector>

#include "ports/atspi/AtspiSession.h"
#include "testing/real/ClipboardHistory.h"
#include "testing/real/Player.h"
#include "testing/rig/Deadline.h"
#include "testing/rig/PlumeProgram.h"

namespace plume::real {

namespace {

struct Arguments {
    Choice choice;
    std::string pictures = "real-programs";
    std::string rows = "{}";  // of applications, as a user adds them
    bool withAccessibility = true;
    bool onlyLists = false;
};

std::optional<Arguments> parse(const std::vector<std::string>& words) {
    Arguments arguments;
    const std::map<std::string, std::string*> values = {{"--pictures", &arguments.pictures},
                                                        {"--rows", &arguments.rows},
                                                        {"--program", &arguments.choice.program},
                                                        {"--place", &arguments.choice.place},
                                                        {"--story", &arguments.choice.story}};
    for (std::size_t i = 0; i < words.size(); ++i) {
        const auto value = values.find(words[i]);
        if (words[i] == "--without-accessibility") {
            arguments.withAccessibility = false;
        } else if (words[i] == "--list") {
            arguments.onlyLists = true;
        } else if (i + 1 == words.size()) {
            return std::nullopt;
        } else if (value != values.end()) {
            *value->second = words[++i];
        } else if (words[i] == "--times") {
            arguments.choice.times = std::stoi(words[++i]);
        } else {
            return std::nullopt;
        }
    }
    return arguments;
}

// Left-aligned in a column, counting characters.
std::string column(const std::string& text, std::size_t width) {
    std::size_t characters = 0;
    for (const char byte : text) characters += (static_cast<unsigned char>(byte) & 0xC0) != 0x80 ? 1 : 0;
    return text + std::string(characters < width ? width - characters : 0, ' ') + "  ";
}

void print(const Outcome& outcome) {
    const std::string program = outcome.place.empty() ? outcome.program : outcome.program + ", " + outcome.place;
    std::cout << column(program, 30) << column(outcome.version.substr(0, 18), 18) << column(outcome.story, 24)
              << std::fixed << std::setprecision(0) << std::setw(6) << outcome.milliseconds << "  "
              << (outcome.isRight ? "as expected" : "WRONG") << '\n';
    if (!outcome.isRight) {
        std::cout << "    expected: " << outcome.expected << "\n    got:      " << outcome.got << '\n';
    }
    std::cout.flush();
}

// Chromium and Firefox look once, when they start, whether they are to tell of their fields.
void awaitAccessibility(rig::DesktopRig& rig) {
    constexpr rig::Milliseconds Bound{10'000};
    rig.session().join();
    const auto isOn = [] { return findAccessibilityBus().status == AccessibilityStatus::Working; };
    if (!rig::waitUntil(isOn, Bound)) throw rig::RigError("accessibility was not switched on");
}

int run(const Arguments& arguments) {
    using rig::PlumeProgram;
    rig::DesktopRig rig;
    const PlumeProgram plume(
        rig, library(), settings(arguments.rows),
        arguments.withAccessibility ? PlumeProgram::Accessibility::Found : PlumeProgram::Accessibility::Missing);
    if (arguments.withAccessibility) awaitAccessibility(rig);
    int right = 0;
    int wrong = 0;
    int programs = 0;
    const auto tell = [&](const Outcome& outcome) {
        ++(outcome.isRight ? right : wrong);
        print(outcome);
    };
    Player player(rig, arguments.pictures, arguments.choice, tell);
    for (const RealProgram& program : realPrograms()) {
        if (!arguments.choice.program.empty() && arguments.choice.program != program.name) continue;
        ++programs;
        player.play(program);
    }
    // Last: it stands by from then on.
    if (arguments.choice.program.empty() || arguments.choice.program == ClipboardManager) {
        ++programs;
        tell(playHistory(rig, arguments.choice.times));
    }
    std::cout << '\n' << right + wrong << " checks in " << programs << " programs: " << wrong << " wrong\n";
    return wrong == 0 ? 0 : 1;
}

}  // namespace

}  // namespace plume::real

int main(int argc, char** argv) {
    using namespace plume::real;
    try {
        const auto arguments = parse({argv + 1, argv + argc});
        if (!arguments) {
            std::cerr << "usage: plume_real_programs [--pictures FOLDER] [--program NAME] [--place NAME] "
                         "[--story NAME] [--times N] [--rows JSON] [--without-accessibility] [--list]\n";
            return 2;
        }
        if (!arguments->onlyLists) return run(*arguments);
        for (const RealProgram& program : realPrograms()) std::cout << program.name << '\n';
        std::cout << ClipboardManager << '\n';
        return 0;
    } catch (const std::exception& problem) {
        std::cerr << "real programs: " << problem.what() << '\n';
        return 1;
    }
}
