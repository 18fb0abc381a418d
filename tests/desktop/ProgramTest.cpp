// The whole program on a whole desktop: started as a user starts it, with abbreviations typed on the keyboard.
#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <string>

#include "testing/rig/Deadline.h"
#include "testing/rig/DesktopRig.h"

namespace plume::rig {

namespace {

std::string plumeProgram() {
    return (std::filesystem::read_symlink("/proc/self/exe").parent_path() / "plume").string();
}

// What people keep in a library, in short.
constexpr const char* Library = R"json([
  { "name": "At once", "abbreviationPrefix": ";", "expandAfter": 2, "expandTrigger": 0, "items": [
      { "abbreviation": "sig", "content": "Kind regards, Jo" },
      { "abbreviation": "cut", "content": "1234567890123456789😀x" },
      { "abbreviation": "uni", "content": "naïve Ünïcödé — 日本語 【】 😀" },
      { "abbreviation": "tag", "content": "<b>【|】</b>" },
      { "abbreviation": "run", "contentType": 3, "content": "echo out$((6*7))" },
      { "abbreviation": "mark", "contentType": 3, "content": "echo mark >> \"$HOME/marks\"" },
      { "abbreviation": "in", "content": "[【snippet:;run】]" },
      { "abbreviation": "ask", "content": "Dear 【field:Name】" } ] },
  { "name": "Words", "expandTrigger": 1, "items": [
      { "abbreviation": "btw", "caseSensitivity": 2, "content": "by the way" } ] }
])json";

constexpr Milliseconds Bound(10'000);

class Program : public testing::Test {
  protected:
    static void SetUpTestSuite() { rig_ = std::make_unique<DesktopRig>(); }
    static void TearDownTestSuite() { rig_.reset(); }

    void SetUp() override {
        library_ = rig_->directory() / "library.json";
        std::ofstream(library_) << Library;
        settings_ = rig_->directory() / "settings.json";
        std::ofstream(settings_) << R"({ "PlayFeedbackSound": false })";
        plume_ = start();
        ASSERT_TRUE(awaitLog(*plume_, "Plume is ready")) << plume_->logTail();
    }

    std::unique_ptr<ChildProcess> start() {
        return rig_->session().start(
            {plumeProgram(), "run", "--library", library_.string(), "--settings", settings_.string()}, "plume");
    }

    static bool awaitLog(const ChildProcess& program, const std::string& text) {
        return waitUntil([&] { return program.logTail().find(text) != std::string::npos; }, Bound);
    }

    static inline std::unique_ptr<DesktopRig> rig_;
    std::filesystem::path library_;
    std::filesystem::path settings_;
    std::unique_ptr<ChildProcess> plume_;
};

class ProgramInTarget : public Program, public testing::WithParamInterface<TargetKind> {};

TEST_P(ProgramInTarget, ExpandsWhatIsTyped) {
    const auto target = rig_->startTarget(GetParam());
    const auto typeAndExpect = [&](const std::string& typed, const std::string& expected) {
        target->clear();
        rig_->keyboard().tap(Key::Home);  // what is typed next stands at the start, for Plume, too
        rig_->keyboard().type(typed);
        EXPECT_EQ(target->awaitText(expected), expected) << plume_->logTail();
    };
    typeAndExpect("x ;sig", "x Kind regards, Jo");
    typeAndExpect("btw, Btw BTW ", "by the way, By the way BY THE WAY ");
    typeAndExpect("x ;uni.", "x naïve Ünïcödé — 日本語 【】 😀.");
    typeAndExpect("x ;tagbold", "x <b>bold</b>");
    typeAndExpect("x ;cut", "x 1234567890123456789😀x");
    typeAndExpect("no abbreviation at all", "no abbreviation at all");
}

TEST_P(ProgramInTarget, RunsScripts) {
    const auto target = rig_->startTarget(GetParam());
    rig_->keyboard().type("x ;run");
    EXPECT_EQ(target->awaitText("x out42"), "x out42") << plume_->logTail();
    target->clear();
    rig_->keyboard().type("x ;in");
    EXPECT_EQ(target->awaitText("x [out42]"), "x [out42]") << plume_->logTail();
}

// A snippet that leaves a mark elsewhere tells whether Plume listened: what a password field holds is nobody's
// business.
// A terminal does not tell that a password is typed into it.
class ProgramInPasswordField : public ProgramInTarget {};

TEST_P(ProgramInPasswordField, DoesNotListen) {
    const auto target = rig_->startTarget(GetParam());
    const auto marks = rig_->directory() / "home" / "marks";
    const auto listens = [&] {
        std::filesystem::remove(marks);
        rig_->keyboard().type(";mark");
        return waitUntil([&] { return std::filesystem::exists(marks); }, Milliseconds(400));
    };
    EXPECT_TRUE(waitUntil(listens, Bound)) << plume_->logTail();
    target->showPassword(true);
    EXPECT_TRUE(waitUntil([&] { return !listens(); }, Bound));
    EXPECT_FALSE(listens());
    target->showPassword(false);
    EXPECT_TRUE(waitUntil(listens, Bound)) << plume_->logTail();
}

INSTANTIATE_TEST_SUITE_P(Targets, ProgramInPasswordField,
                         testing::Values(TargetKind::GtkTextView, TargetKind::QtTextEdit));

INSTANTIATE_TEST_SUITE_P(Targets, ProgramInTarget,
                         testing::Values(TargetKind::GtkTextView, TargetKind::QtTextEdit, TargetKind::Xterm));

TEST_F(Program, SaysThatASnippetNeedsAForm) {
    const auto target = rig_->startTarget(TargetKind::GtkTextView);
    rig_->keyboard().type("x ;ask");
    EXPECT_EQ(target->awaitText("x "), "x ");
    EXPECT_TRUE(awaitLog(*plume_, "form")) << plume_->logTail();
}

TEST_F(Program, EndsWhenAskedToAndGivesTheKeyboardBack) {
    const auto target = rig_->startTarget(TargetKind::GtkTextView);
    for (const int signal : {SIGINT, SIGTERM}) {
        target->clear();
        rig_->keyboard().type(";sig");
        EXPECT_EQ(target->awaitText("Kind regards, Jo"), "Kind regards, Jo");
        ASSERT_EQ(kill(plume_->pid(), signal), 0);
        EXPECT_EQ(plume_->waitForExit(Bound), 0) << plume_->logTail();
        target->clear();
        rig_->keyboard().type(";sig");
        EXPECT_EQ(target->awaitText(";sig"), ";sig");
        plume_ = start();
        ASSERT_TRUE(awaitLog(*plume_, "Plume is ready")) << plume_->logTail();
    }
}

TEST_F(Program, EndsInTheMiddleOfAScript) {
    const auto target = rig_->startTarget(TargetKind::GtkTextView);
    std::ofstream(library_) << R"([{"expandTrigger": 0, "items": [
        {"abbreviation": "slow", "contentType": 3, "content": "echo $$ >)" +
                                   (rig_->directory() / "pid").string() + R"(; sleep 30"}]}])";
    plume_.reset();
    plume_ = start();
    ASSERT_TRUE(awaitLog(*plume_, "Plume is ready")) << plume_->logTail();
    rig_->keyboard().type("slow");
    ASSERT_TRUE(waitUntil([&] { return std::filesystem::exists(rig_->directory() / "pid"); }, Bound));
    ASSERT_EQ(kill(plume_->pid(), SIGTERM), 0);
    EXPECT_EQ(plume_->waitForExit(Bound), 0) << plume_->logTail();
}

TEST_F(Program, RunsOncePerDisplay) {
    const auto second = start();
    EXPECT_EQ(second->waitForExit(Bound), 1);
    EXPECT_NE(second->logTail().find("already running"), std::string::npos) << second->logTail();
    EXPECT_NE(second->logTail().find(std::to_string(plume_->pid())), std::string::npos) << second->logTail();
    EXPECT_TRUE(plume_->isRunning());
}

TEST_F(Program, DoctorFindsAllThatIsNeededHere) {
    const auto doctor = rig_->session().start({plumeProgram(), "doctor"}, "doctor");
    EXPECT_EQ(doctor->waitForExit(Milliseconds(5'000)), 0) << doctor->logTail();
    EXPECT_EQ(doctor->logTail().find("MISSING"), std::string::npos) << doctor->logTail();
    EXPECT_NE(doctor->logTail().find("already running"), std::string::npos) << doctor->logTail();
}

}  // namespace

}  // namespace plume::rig
