#include "testing/real/ClipboardHistory.h"

#include <algorithm>
#include <memory>
#include <vector>

#include "testing/rig/Deadline.h"
#include "testing/rig/SelectionClients.h"

namespace plume::real {

const std::string ClipboardManager = "CopyQ";

namespace {

using rig::Milliseconds;

constexpr Milliseconds ManagerBound{20'000};
constexpr Milliseconds GivenBackBound{5'000};
// The manager reads what it sees a while later, and tells nobody when it has.
constexpr Milliseconds Noticing{1'500};
constexpr Milliseconds Gap{100};  // from a copy to the paste: none, one, two and so on
constexpr int Gaps = 10;

void pause(Milliseconds time) {
    rig::waitUntil([] { return false; }, time);
}

// What a command of the manager prints.
std::string ask(rig::DesktopRig& rig, const std::vector<std::string>& command) {
    const auto process = rig.session().start(command, "copyq");
    process->waitForExit(ManagerBound);
    return process->logTail();
}

void awaitManager(rig::DesktopRig& rig) {
    const auto runs = [&] { return ask(rig, {"copyq", "eval", "print('runs')"}).find("runs") != std::string::npos; };
    if (!rig::waitUntil(runs, ManagerBound)) throw rig::RigError("the clipboard manager does not start");
    pause(Noticing);
}

void awaitClipboard(rig::DesktopRig& rig, const std::string& text) {
    rig::SelectionRequestor requestor(rig.server().display());
    const auto isBack = [&] {
        const auto got = requestor.request("CLIPBOARD", "UTF8_STRING");
        return got && got->bytes == text;
    };
    if (!rig::waitUntil(isBack, GivenBackBound)) throw rig::RigError("\"" + text + "\" does not come back");
}

}  // namespace

Outcome playHistory(rig::DesktopRig& rig, int rounds) {
    Outcome outcome{ClipboardManager, "", "", "pastes soon after copies", "", ""};
    const auto manager = rig.session().start({"copyq"}, "copyq");
    awaitManager(rig);
    const auto target = rig.startTarget(rig::TargetKind::GtkTextView);
    std::unique_ptr<rig::ForeignOwner> owner;
    for (int round = 0; round < rounds * Gaps; ++round) {
        const std::string text = "copied " + std::to_string(round);
        owner = std::make_unique<rig::ForeignOwner>(rig.server().display(),
                                                    rig::SelectionOffer{{"UTF8_STRING", {"UTF8_STRING", 8, text}}});
        pause(Gap * (round % Gaps));
        target->clear();
        rig.keyboard().type(";rich and on");
        target->awaitText("bold and plain and on");
        awaitClipboard(rig, text);
        pause(Noticing);
        outcome.expected = text + "\n" + outcome.expected;
    }
    outcome.got =
        ask(rig, {"copyq", "eval", "for (i = 0; i < size(); ++i) print(str(read(i)) + String.fromCharCode(10))"});
    outcome.isRight = outcome.got == outcome.expected;
    return outcome;
}

}  // namespace plume::real
