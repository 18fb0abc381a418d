#include "testing/real/ClipboardHistory.h"

#include <memory>
#include <utility>
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
constexpr Milliseconds Answering{30};
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
        requestor.targets("CLIPBOARD");
        const auto got = requestor.request("CLIPBOARD", "UTF8_STRING");
        return got && got->bytes == text;
    };
    if (!rig::waitUntil(isBack, GivenBackBound)) throw rig::RigError("\"" + text + "\" does not come back");
}

// A program that takes its time, with content in several forms: the manager reads one after the other.
std::unique_ptr<rig::ForeignOwner> copy(rig::DesktopRig& rig, const std::string& text) {
    rig::SelectionOffer offer;
    for (const char* form : {"text/html", "UTF8_STRING", "text/plain;charset=utf-8", "text/plain", "STRING"}) {
        offer.push_back({form, {form, 8, text}});
    }
    rig::ForeignOwner::Options options;
    options.beforeAnswer = [](const std::string&) { pause(Answering); };
    return std::make_unique<rig::ForeignOwner>(rig.server().display(), std::move(offer), std::move(options));
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
        owner = copy(rig, text);
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
