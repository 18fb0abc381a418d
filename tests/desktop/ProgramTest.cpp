// The whole program on a whole desktop: started as a user starts it, with abbreviations typed on the keyboard.
#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <string>

#include "Foundation/Strings.h"
#include "ports/atspi/AtspiSession.h"
#include "testing/rig/Deadline.h"
#include "testing/rig/NoticeBoard.h"
#include "testing/rig/PlumeProgram.h"

namespace plume::rig {

namespace {

// What people keep in a library, in short.
constexpr const char* Library = R"json([
  { "name": "At once", "abbreviationPrefix": ";", "expandAfter": 2, "expandTrigger": 0, "items": [
      { "abbreviation": "sig", "content": "Kind regards, Jo" },
      { "abbreviation": "cut", "content": "1234567890123456789😀x" },
      { "abbreviation": "uni", "content": "naïve Ünïcödé — 日本語 【】 😀" },
      { "abbreviation": "two", "content": "a\n  b" },
      { "abbreviation": "tag", "content": "<b>【|】</b>" },
      { "abbreviation": "run", "contentType": 3, "content": "echo out$((6*7))" },
      { "abbreviation": "late", "contentType": 3, "content": "sleep 0.6; echo late" },
      { "abbreviation": "mark", "contentType": 3, "content": "echo mark >> \"$HOME/marks\"" },
      { "abbreviation": "in", "content": "[【snippet:;run】]" },
      { "abbreviation": "who", "content": "Jo" },
      { "abbreviation": "who", "content": "Ada" },
      { "abbreviation": "ask", "content": "Dear 【field:Name】" } ] },
  { "name": "Words", "expandTrigger": 1, "items": [
      { "abbreviation": "btw", "caseSensitivity": 2, "content": "by the way" } ] }
])json";

constexpr Milliseconds Bound(10'000);

class Program : public testing::Test {
  protected:
    static void SetUpTestSuite() { rig_ = std::make_unique<DesktopRig>(); }
    static void TearDownTestSuite() { rig_.reset(); }

    void SetUp() override { start(Library); }

    void start(const std::string& library, const std::string& settings = R"({ "PlayFeedbackSound": false })") {
        plume_.reset();
        plume_ = std::make_unique<PlumeProgram>(*rig_, library, settings);
    }
    std::string log() { return plume_->process().logTail(); }

    static bool becomes(TargetProgram& target, const std::string& typed, const std::string& expected,
                        Milliseconds within = Bound) {
        return rig::becomes(*rig_, target, typed, expected, within);
    }
    static bool soonBecomes(TargetProgram& target, const std::string& typed, const std::string& expected) {
        return rig::soonBecomes(*rig_, target, typed, expected);
    }

    static inline std::unique_ptr<DesktopRig> rig_;
    std::unique_ptr<PlumeProgram> plume_;
};

class ProgramInTarget : public Program, public testing::WithParamInterface<TargetKind> {};

TEST_P(ProgramInTarget, ExpandsWhatIsTyped) {
    const auto target = rig_->startTarget(GetParam());
    ASSERT_TRUE(soonBecomes(*target, "x ;sig", "x Kind regards, Jo")) << log();
    const auto typeAndExpect = [&](const std::string& typed, const std::string& expected) {
        EXPECT_TRUE(becomes(*target, typed, expected)) << "not " << expected << "\n" << log();
    };
    typeAndExpect("btw, Btw BTW ", "by the way, By the way BY THE WAY ");
    typeAndExpect("x ;uni.", "x naïve Ünïcödé — 日本語 【】 😀.");
    typeAndExpect("x ;two", "x a\n  b");
    typeAndExpect("x ;tagbold", "x <b>bold</b>");
    typeAndExpect("x ;cut", "x 1234567890123456789😀x");
    typeAndExpect("x ;run", "x out42");
    typeAndExpect("x ;in", "x [out42]");
    typeAndExpect("no abbreviation at all", "no abbreviation at all");
}

// A snippet that leaves a mark elsewhere tells whether Plume listened: what a password field holds is nobody's
// business.
class ProgramInPasswordField : public ProgramInTarget {};

TEST_P(ProgramInPasswordField, DoesNotListen) {
    const auto target = rig_->startTarget(GetParam());
    const auto marks = rig_->directory() / "home" / "marks";
    const auto listens = [&] {
        std::filesystem::remove(marks);
        rig_->keyboard().type(";mark");
        return waitUntil([&] { return std::filesystem::exists(marks); }, Milliseconds(400));
    };
    EXPECT_TRUE(waitUntil(listens, Bound)) << log();
    target->showPassword(true);
    EXPECT_TRUE(waitUntil([&] { return !listens(); }, Bound));
    EXPECT_FALSE(listens());
    target->showPassword(false);
    EXPECT_TRUE(waitUntil(listens, Bound)) << log();
}

TEST_F(Program, DoesNotListenToWhatAPromptInATerminalHides) {
    const auto home = rig_->directory() / "home";
    const xcb_window_t before = rig_->client().activeWindow();
    const auto terminal = rig_->session().start(
        {"xterm", "-e", "sh", "-c",
         "cd; read a; stty -echo; >hidden; read b; stty echo; >shown; read c; echo \"$a|$b|$c\" >all; mv all read"},
        "xterm");
    ASSERT_TRUE(waitUntil([&] { return rig_->client().activeWindow() != before; }, Bound));
    for (const char* next : {"hidden", "shown", "read"}) {
        rig_->keyboard().type(";sig");
        rig_->keyboard().tap(Key::Return);
        ASSERT_TRUE(waitUntil([&] { return std::filesystem::exists(home / next); }, Bound)) << next << log();
    }
    std::string read;
    std::getline(std::ifstream(home / "read"), read);
    EXPECT_EQ(read, "Kind regards, Jo|;sig|Kind regards, Jo");
}

// More new characters at once than there are spare key codes.
TEST_F(Program, TypesAllOfATextWhereNoKeyPastes) {
    std::u16string text = u"|";
    for (char16_t c = 0x4E00; c < 0x4E64; ++c) text += c;
    start(R"([{"items": [{"abbreviation": "cjk", "content": ")" + toUtf8(text) + R"("}]}])",
          R"({"PlayFeedbackSound": false, "CustomApplicationSettings": {"gtk_*": {"pasteKeys": "none"}}})");
    const auto target = rig_->startTarget(TargetKind::GtkTextView);
    const auto types = [&] {
        target->clear();
        rig_->keyboard().type("cjk");
        return target->awaitText(toUtf8(text)) == toUtf8(text);
    };
    EXPECT_TRUE(waitUntil(types, 2 * Bound)) << log();
}

INSTANTIATE_TEST_SUITE_P(Targets, ProgramInPasswordField,
                         testing::Values(TargetKind::GtkTextView, TargetKind::QtTextEdit));

INSTANTIATE_TEST_SUITE_P(Targets, ProgramInTarget,
                         testing::Values(TargetKind::GtkTextView, TargetKind::QtTextEdit, TargetKind::Xterm));

TEST_F(Program, AsksOnceWhetherProgramsMayTellAboutPasswordFields) {
    plume_.reset();
    rig_->session().join();
    NoticeBoard board;
    const auto isAsked = [&] { return board.body("Password fields in browsers").has_value(); };
    start(Library, R"({ "LetProgramsTellPasswordFields": false })");
    start("", "");
    ASSERT_TRUE(waitUntil(isAsked, Bound)) << log();
    board.press("Password fields in browsers", "Not now");
    const auto isKept = [&] {
        const auto setting = runPlume(*rig_, {"settings", "LetProgramsTellPasswordFields"});
        return setting.status == 0 && setting.said.find("false") != std::string::npos;
    };
    EXPECT_TRUE(waitUntil(isKept, Bound)) << log();
    start(Library, "{}");
    ASSERT_TRUE(waitUntil(isAsked, Bound)) << log();
    EXPECT_EQ(findAccessibilityBus().status, AccessibilityStatus::SwitchedOff);
    board.press("Password fields in browsers", "Switch on");
    EXPECT_TRUE(waitUntil([] { return findAccessibilityBus().status == AccessibilityStatus::Working; }, Bound));
    start(Library, "{}");
    EXPECT_FALSE(waitUntil(isAsked, Milliseconds(700)));
}

TEST_F(Program, OffersToListenAgainWhenTheKeyboardWasLostTooOften) {
    plume_.reset();
    rig_->session().join();
    NoticeBoard board;
    start(Library);
    const auto target = rig_->startTarget(TargetKind::GtkTextView);
    const auto expands = [&] {
        target->clear();
        rig_->keyboard().type(" ;sig");
        return target->awaitText(" Kind regards, Jo", Milliseconds(500)) == " Kind regards, Jo";
    };
    for (int times = 0; times < 3; ++times) {
        ASSERT_TRUE(waitUntil(expands, Bound)) << log();
        plume_->process().stop();
        rig_->keyboard().type("x");
        EXPECT_EQ(target->awaitText(" Kind regards, Jox"), " Kind regards, Jox");
        ASSERT_EQ(kill(plume_->process().pid(), SIGCONT), 0);
    }
    const char* title = "Plume does not listen";
    ASSERT_TRUE(waitUntil([&] { return board.body(title).has_value(); }, Bound)) << log();
    EXPECT_FALSE(expands());
    board.press(title, "Listen now");
    EXPECT_TRUE(waitUntil(expands, Bound)) << log();
}

TEST_F(Program, SaysThatASnippetNeedsAFormOrAChoiceAndErasesNothing) {
    const auto target = rig_->startTarget(TargetKind::GtkTextView);
    const auto isSaid = [&] {  // Plume may not know yet that another program has come to the front
        target->clear();
        rig_->keyboard().type("x ;ask ;who");
        EXPECT_EQ(target->awaitText("x ;ask ;who"), "x ;ask ;who");
        const std::string said = log();
        return said.find("there is no form here") != std::string::npos &&
               said.find("there is no list here") != std::string::npos;
    };
    EXPECT_TRUE(waitUntil(isSaid, Bound)) << log();
}

TEST_F(Program, EndsWhenAskedToAndGivesTheKeyboardBack) {
    const auto target = rig_->startTarget(TargetKind::GtkTextView);
    for (const int signal : {SIGINT, SIGTERM}) {
        ASSERT_TRUE(soonBecomes(*target, ";sig", "Kind regards, Jo")) << log();
        ASSERT_EQ(kill(plume_->process().pid(), signal), 0);
        EXPECT_EQ(plume_->process().waitForExit(Bound), 0) << log();
        target->clear();
        rig_->keyboard().type(";sig");
        EXPECT_EQ(target->awaitText(";sig"), ";sig");
        start(Library);
    }
}

TEST_F(Program, LetsWhatIsTypedWhileAScriptRunsFollowItsOutput) {
    const auto target = rig_->startTarget(TargetKind::GtkTextView);
    // A busy machine may be slower than keys wait for it.
    EXPECT_TRUE(soonBecomes(*target, "x ;run and on", "x out42 and on")) << log();
    // Keys do not wait for this one, but what they typed can be asked for.
    EXPECT_TRUE(soonBecomes(*target, "x ;late and on", "x late and on")) << log();
}

TEST_F(Program, EndsInTheMiddleOfAScript) {
    const auto target = rig_->startTarget(TargetKind::GtkTextView);
    start(R"([{"expandTrigger": 0, "items": [
        {"abbreviation": "slow", "contentType": 3, "content": "echo $$ >)" +
          (rig_->directory() / "pid").string() + R"(; sleep 30"}]}])");
    rig_->keyboard().type("slow");
    ASSERT_TRUE(waitUntil([&] { return std::filesystem::exists(rig_->directory() / "pid"); }, Bound));
    ASSERT_EQ(kill(plume_->process().pid(), SIGTERM), 0);
    EXPECT_EQ(plume_->process().waitForExit(Bound), 0) << log();
}

TEST_F(Program, RunsOncePerDisplay) {
    const auto second = runPlume(*rig_, {"run"});
    EXPECT_EQ(second.status, 1);
    EXPECT_NE(second.said.find("already running"), std::string::npos) << second.said;
    EXPECT_NE(second.said.find(std::to_string(plume_->process().pid())), std::string::npos) << second.said;
    EXPECT_TRUE(plume_->process().isRunning());
}

TEST_F(Program, FollowsTheFileOfItsLibrary) {
    const auto target = rig_->startTarget(TargetKind::GtkTextView);
    const auto write = [&](const std::string& content) {
        std::ofstream(rig_->directory() / "library.json") << content;
    };
    write(
        R"([{"abbreviationPrefix": ";", "expandAfter": 2, "items": [{"abbreviation": "sig", "content": "changed"}]}])");
    EXPECT_TRUE(soonBecomes(*target, "x ;sig", "x changed")) << log();
    write("[\n{\"items\": 5}]");
    EXPECT_TRUE(
        waitUntil([&] { return log().find("line 2, at $[0].items: expected a list") != std::string::npos; }, Bound))
        << log();
    EXPECT_TRUE(becomes(*target, "x ;sig", "x changed")) << log();
}

TEST_F(Program, TakesOverWhatOthersChangeInTheUsersLibrary) {
    start("");
    const auto target = rig_->startTarget(TargetKind::GtkTextView);
    const auto add = runPlume(*rig_, {"add", "omw;", "on my way"});
    ASSERT_EQ(add.status, 0) << add.said;
    EXPECT_TRUE(soonBecomes(*target, "x omw;", "x on my way")) << log();
}

TEST_F(Program, StaysSwitchedOffWhateverElseIsSet) {
    const auto set = [&](const std::string& key, const std::string& value) {
        const auto command = runPlume(*rig_, {"settings", key, value});
        ASSERT_EQ(command.status, 0) << command.said;
    };
    const auto target = rig_->startTarget(TargetKind::GtkTextView);
    set("switchHotKey", "120");  // F2
    start("", "");
    ASSERT_TRUE(soonBecomes(*target, "x btw ", "x by the way ")) << log();
    rig_->keyboard().tap(Key::F2);
    EXPECT_TRUE(becomes(*target, "x btw ", "x btw ")) << log();
    set("LongTextLength", "90");
    const auto listens = [&] { return becomes(*target, "x btw ", "x by the way ", Milliseconds(1'000)); };
    EXPECT_FALSE(waitUntil(listens, Milliseconds(2'000))) << log();
    set("IsEnabled", "true");
    EXPECT_TRUE(soonBecomes(*target, "x btw ", "x by the way ")) << log();
}

TEST_F(Program, DoctorFindsAllThatIsNeededHere) {
    const auto doctor = runPlume(*rig_, {"doctor"});
    EXPECT_EQ(doctor.status, 0) << doctor.said;
    EXPECT_EQ(doctor.said.find("MISSING"), std::string::npos) << doctor.said;
    EXPECT_NE(doctor.said.find("already running"), std::string::npos) << doctor.said;
}

TEST_F(Program, DoctorNamesProgramsThatTellNothingOfTheirPasswordFields) {
    const auto target = rig_->startTarget(TargetKind::GtkTextView);
    const auto doctorSays = [&](const std::string& words) {
        return runPlume(*rig_, {"doctor"}).said.find(words) != std::string::npos;
    };
    EXPECT_TRUE(waitUntil([&] { return doctorSays("every program that has a window"); }, Bound));
    // The window passes for one of this program, which is on no bus.
    XClient& client = rig_->client();
    const auto process = static_cast<std::uint32_t>(getpid());
    xcb_change_property(client.connection(), XCB_PROP_MODE_REPLACE, target->window(), client.atom("_NET_WM_PID"),
                        XCB_ATOM_CARDINAL, 32, 1, &process);
    xcb_flush(client.connection());
    EXPECT_TRUE(waitUntil([&] { return doctorSays("do not tell about them: program_test"); }, Bound));
}

}  // namespace

}  // namespace plume::rig
