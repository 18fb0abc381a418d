#include "testing/real/Player.h"

#include <algorithm>
#include <fstream>
#include <utility>

#include "testing/real/CopyWatch.h"
#include "testing/rig/Deadline.h"
#include "testing/rig/Screenshot.h"
#include "testing/rig/SelectionClients.h"

namespace plume::real {

namespace {

using rig::Key;
using rig::Milliseconds;

constexpr Milliseconds StartBound{40'000};
constexpr Milliseconds ReadyBound{20'000};
constexpr Milliseconds TextBound{3'000};
constexpr Milliseconds CharacterBound{10};  // for each of a long text
constexpr Milliseconds ClipboardBound{2'000};
constexpr Milliseconds AskAgain{20};
constexpr Milliseconds VisitBound{10'000};
constexpr Milliseconds EntryBound{1'000};
constexpr Milliseconds Proposing{500};
constexpr Milliseconds BetweenKeys{150};
constexpr Milliseconds BetweenFields{400};

// As the package system has noted it.
std::string versionOf(const std::string& package) {
    std::ifstream status("/var/lib/dpkg/status");
    const std::string version = "Version: ";
    bool isPackage = false;
    for (std::string line; std::getline(status, line);) {
        if (line.starts_with("Package: ")) isPackage = line == "Package: " + package;
        if (isPackage && line.starts_with(version)) return line.substr(version.size());
    }
    return {};
}

void replaceAll(std::string& text, const std::string& from, const std::string& to) {
    for (auto at = text.find(from); at != std::string::npos; at = text.find(from, at + to.size())) {
        text.replace(at, from.size(), to);
    }
}

// Ends of lines and spaces as they were typed: pages show a space at an end as one that does not break.
std::string plain(std::string text) {
    replaceAll(text, "\r\n", "\n");
    replaceAll(text, "\u00A0", " ");
    return text;
}

std::string fileNameOf(std::string text) {
    std::replace_if(
        text.begin(), text.end(), [](char c) { return c == ' ' || c == '/' || c == ',' || c == '+'; }, '-');
    return text;
}

bool contains(const std::vector<Needs>& offers, Needs need) {
    return std::find(offers.begin(), offers.end(), need) != offers.end();
}

}  // namespace

Player::Player(rig::DesktopRig& rig, std::filesystem::path pictures, Choice choice, Tell tell)
    : rig_(rig), pictures_(std::move(pictures)), choice_(std::move(choice)), tell_(std::move(tell)) {}

void Player::play(const RealProgram& program) {
    program_ = &program;
    version_ = versionOf(program.package);
    std::unique_ptr<rig::ChildProcess> process;  // still there for the picture of what went wrong
    try {
        process = start(program);
        window_ = awaitWindow(program, *process);
        rig_.client().activate(window_);
        if (program.isServed && !awaitTitle("[", ReadyBound)) throw rig::RigError("shows no page");
        for (const Place& place : program.places) playPlace(place);
    } catch (const rig::RigError& problem) {
        Outcome outcome{program.name, version_, "", "start", "", problem.what()};
        finish(outcome);
    }
    reader_.reset();
    server_.reset();
}

std::unique_ptr<rig::ChildProcess> Player::start(const RealProgram& program) {
    folder_ = rig_.directory() / fileNameOf(program.name);
    std::filesystem::create_directories(folder_);
    if (program.isServed) serve();
    for (const auto& [name, content] : program.files) {
        std::filesystem::create_directories((folder_ / name).parent_path());
        std::ofstream(folder_ / name) << filled(content);
    }
    std::vector<std::string> command{"env"};
    for (const auto& line : program.environment) command.push_back(filled(line));
    for (const auto& argument : program.command) command.push_back(filled(argument));
    return rig_.session().start(command, program.package);
}

void Player::serve() {
    server_ = rig_.session().start(
        {"python3", "-u", "-m", "http.server", "--bind", "127.0.0.1", "--directory", folder_, "0"}, "python3");
    const std::string word = " port ";
    const auto saysPort = [&] { return server_->logTail().find(word) != std::string::npos; };
    if (!rig::waitUntil(saysPort, ReadyBound)) throw rig::RigError("nothing is served: " + server_->logTail());
    const std::string said = server_->logTail();
    port_ = std::to_string(std::stoi(said.substr(said.find(word) + word.size())));
}

std::string Player::filled(std::string text) const {
    replaceAll(text, "{}", folder_);
    replaceAll(text, "{port}", port_);
    return text;
}

xcb_window_t Player::awaitWindow(const RealProgram& program, rig::ChildProcess& process) {
    xcb_window_t found = XCB_WINDOW_NONE;
    const bool shown = rig::waitUntil(
        [&] {
            for (const xcb_window_t window : rig_.client().managedWindows()) {
                const std::string names = rig_.client().property(window, "WM_CLASS");
                if (names.find(program.windowClass) != std::string::npos) found = window;
            }
            return found != XCB_WINDOW_NONE;
        },
        StartBound);
    std::string others;
    for (const xcb_window_t window : rig_.client().managedWindows()) {
        others += rig_.client().property(window, "WM_CLASS") + " ";
    }
    if (!shown) throw rig::RigError("shows no window, but there are " + others + process.logTail());
    return found;
}

void Player::playPlace(const Place& place) {
    const auto isPlayed = [&](const Story& story) { return isChosen(place, story); };
    if (std::none_of(stories().begin(), stories().end(), isPlayed)) return;
    enter(place);
    for (const Story& story : stories()) {
        if (!isPlayed(story)) continue;
        for (int i = 0; i < choice_.times; ++i) {
            Outcome outcome = playStory(place, story);
            finish(outcome);
        }
    }
}

bool Player::isChosen(const Place& place, const Story& story) const {
    if (!choice_.place.empty() && choice_.place != place.name) return false;
    if (!choice_.story.empty() && choice_.story != story.name) return false;
    for (const Needs need : {Needs::Password, Needs::Proposals}) {
        if (contains(place.offers, need)) return story.needs == need;
    }
    return story.needs == Needs::Nothing || contains(place.offers, story.needs);
}

void Player::enter(const Place& place) {
    if (place.enter) place.enter(rig_);
    if (contains(place.offers, Needs::Password)) awaitPasswordField(place);
    settle(place);
    reader_ = makeReader(place.reading, rig_, window_, folder_ / "text");
    awaitReady(place);
    if (contains(place.offers, Needs::Proposals)) awaitProposal(place);
}

// A page that is still coming does not follow its keys.
void Player::awaitPasswordField(const Place& place) {
    const rig::Deadline deadline(ReadyBound);
    while (!awaitTitle("*[", EntryBound)) {
        if (deadline.passed()) throw rig::RigError("does not go to its password field");
        place.enter(rig_);
    }
}

// In an address bar. Firefox gives up a page that has not come when somebody types another address.
void Player::visit(const Place& place) {
    const std::string address = filled(place.visited);
    const rig::Deadline deadline(ReadyBound);
    while (!deadline.passed()) {
        place.enter(rig_);
        rig::waitUntil([] { return false; }, Proposing);
        rig_.keyboard().type(address);
        rig_.keyboard().tap(Key::Return);
        rig_.keyboard().sync();
        if (awaitTitle("visited", VisitBound)) return keepBookmark();
    }
    throw rig::RigError("does not go to " + address);
}

// Firefox proposes what is often visited, and what is a bookmark.
void Player::keepBookmark() {
    rig_.keyboard().chord({Key::LeftControl}, U'd');
    rig::waitUntil([] { return false; }, 2 * Proposing);
    rig_.keyboard().tap(Key::Return);
    rig_.keyboard().sync();
}

bool Player::awaitTitle(const std::string& start, Milliseconds bound) {
    return rig::waitUntil([&] { return rig_.client().property(window_, "_NET_WM_NAME").starts_with(start); }, bound);
}

// Without one, what is played there would show nothing.
void Player::awaitProposal(const Place& place) {
    if (!place.visited.empty()) visit(place);
    const rig::Deadline deadline(ReadyBound);
    const std::string begun = "btw";
    while (!deadline.passed()) {
        if (place.enter) place.enter(rig_);
        rig::waitUntil([] { return false; }, Proposing);
        clear(place);
        rig_.keyboard().type(begun);
        rig::waitUntil([] { return false; }, Proposing);
        const std::string text = reader_->read();
        if (text.starts_with(begun + 'e') || text.starts_with("http://" + begun)) return;
    }
    throw rig::RigError("proposes nothing " + place.name + ", has " + reader_->read());
}

// A window that has the focus may not take keys yet: it does once one of them has become text.
void Player::awaitReady(const Place& place) {
    const rig::Deadline deadline(ReadyBound);
    while (true) {
        clear(place);
        rig_.keyboard().type("Q");
        if (awaitText("Q") == "Q") return;
        if (deadline.passed()) throw rig::RigError("takes no keys " + place.name + ", has " + reader_->read());
    }
}

void Player::clear(const Place& place) {
    if (place.clear) {
        place.clear(rig_);
    } else if (place.reading == Reading::Lines) {
        rig_.keyboard().chord({Key::LeftControl}, U'u');
    } else {
        rig_.keyboard().chord({Key::LeftControl}, U'a');
        settle(place);
        rig_.keyboard().tap(Key::Backspace);
        rig_.keyboard().sync();
    }
    settle(place);
}

void Player::settle(const Place& place) {
    rig::waitUntil([] { return false; }, place.settling);
}

void Player::type(const Place& place, const Story& story) {
    std::string pending;
    const auto flush = [&] {
        if (story.typing == Typing::RollingOver) {
            rig_.keyboard().typeRollingOver(pending);
        } else {
            rig_.keyboard().type(pending);
        }
        pending.clear();
    };
    for (const char c : story.typed) {
        if (c != LeftKey && c != FieldBefore) {
            pending += c;
            if (story.typing != Typing::Slowly) continue;
            flush();
            rig::waitUntil([] { return false; }, BetweenKeys);
            continue;
        }
        flush();
        if (c == LeftKey) {
            rig_.keyboard().tap(Key::Left);
            rig_.keyboard().sync();
            settle(place);
        } else {
            rig_.keyboard().chord({Key::LeftShift}, Key::Tab);
            rig::waitUntil([] { return false; }, BetweenFields);
        }
    }
    flush();
}

Outcome Player::playStory(const Place& place, const Story& story) {
    Outcome outcome{program_->name, version_, place.name, story.name, story.expected, {}};
    const auto own = place.expected.find(story.name);
    if (own != place.expected.end()) outcome.expected = own->second;
    clear(place);
    if (place.reading == Reading::Title || place.reading == Reading::File) awaitText("");
    const auto start = std::chrono::steady_clock::now();
    if (story.then == Then::ReadClipboard) {
        outcome.got = playClipboard(place, story);
    } else {
        type(place, story);
        if (story.then == Then::Undo) rig_.keyboard().chord({Key::LeftControl, Key::LeftAlt}, U'z');
        outcome.got = awaitText(outcome.expected);
    }
    outcome.milliseconds = std::chrono::duration<double, std::milli>(std::chrono::steady_clock::now() - start).count();
    return outcome;
}

// A program may still be at work at the first reading.
std::string Player::awaitText(const std::string& expected) {
    const rig::Deadline deadline(TextBound + CharacterBound * static_cast<int>(expected.size()));
    std::string text;
    do {
        text = plain(reader_->read());
        if (text == expected) return text;
        rig::waitUntil([] { return false; }, AskAgain);
    } while (reader_->leavesText() && !deadline.passed());
    return text;
}

std::string Player::playClipboard(const Place& place, const Story& story) {
    const std::string display = rig_.server().display();
    const rig::SelectionData data{"UTF8_STRING", 8, CopiedBefore};
    const rig::ForeignOwner owner(display, {{"UTF8_STRING", data}, {"STRING", data}});
    CopyWatch watch(display);
    type(place, story);
    if (!watch.awaitOwner(TextBound, [&](xcb_window_t window) { return window != owner.window(); })) {
        return "nothing was pasted";
    }
    rig::SelectionRequestor requestor(display);
    std::string text;
    rig::waitUntil(
        [&] {
            requestor.targets("CLIPBOARD");
            const auto got = requestor.request("CLIPBOARD", "UTF8_STRING");
            text = got ? got->bytes : "";
            return text == CopiedBefore;
        },
        ClipboardBound);
    return text;
}

void Player::finish(Outcome& outcome) {
    outcome.isRight = outcome.story != "start" && outcome.got == outcome.expected;
    if (!outcome.isRight) {
        std::filesystem::create_directories(pictures_);
        const std::string name = outcome.program + "-" + outcome.place + "-" + outcome.story + ".png";
        rig::writeScreenshot(rig_.client(), pictures_ / fileNameOf(name));
    }
    tell_(outcome);
}

}  // namespace plume::real
