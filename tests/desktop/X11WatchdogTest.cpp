// A program that holds the keyboard goes wrong in every way: the keyboard works within a second, every time.

#include <gtest/gtest.h>

#include <chrono>
#include <csignal>
#include <cstdlib>
#include <fstream>
#include <iostream>
#include <sstream>
#include <string>

#include "ports/x11/watchdog/WatchdogSchedule.h"
#include "testing/rig/Deadline.h"
#include "testing/rig/DesktopRig.h"

namespace plume::rig {

namespace {

using std::chrono::steady_clock;

std::string contentOf(const std::filesystem::path& file) {
    std::ifstream stream(file);
    std::ostringstream content;
    content << stream.rdbuf();
    return content.str();
}

int timesIn(const std::string& text, const std::string& word) {
    int times = 0;
    for (auto at = text.find(word); at != std::string::npos; at = text.find(word, at + 1)) ++times;
    return times;
}

// Its state as the system has it; nothing for a process that is gone, or only waits to be noticed.
std::optional<char> stateOf(pid_t process) {
    const std::string content = contentOf("/proc/" + std::to_string(process) + "/stat");
    const auto end = content.rfind(") ");
    if (end == std::string::npos) return std::nullopt;
    const char state = content.at(end + 2);
    return state == 'Z' || state == 'X' ? std::nullopt : std::optional(state);
}

// PLUME_WATCHDOG_TRIES asks for more than one try of each, with longer hangs.
int tries() {
    const char* const value = std::getenv("PLUME_WATCHDOG_TRIES");
    return value ? std::atoi(value) : 1;
}

// Seconds: what is promised, and in the ordinary run of all tests what a loaded machine may add to it.
double bound() {
    return tries() > 1 ? 1.0 : 2.0;
}

class X11WatchdogTest : public testing::Test {
  protected:
    static void SetUpTestSuite() { rig_ = std::make_unique<DesktopRig>(); }
    static void TearDownTestSuite() { rig_.reset(); }

    void SetUp() override {
        target_ = rig_->startTarget(TargetKind::GtkTextView);
        startProgram();
    }
    void TearDown() override { rig_->keyboard().releaseAll(); }

    void startProgram() {
        report_ = rig_->directory() / ("report" + std::to_string(++programs_));
        const auto folder = std::filesystem::read_symlink("/proc/self/exe").parent_path();
        program_ = rig_->session().start({folder / "keyboard_program", report_, tries() > 1 ? "10" : "2"}, "plume");
        ASSERT_TRUE(waitUntil([&] { return timesIn(contentOf(report_), "\n") > 0 || !program_->isRunning(); }));
        std::istringstream line(contentOf(report_));
        std::string ready;
        line >> ready >> watchdog_;
        ASSERT_EQ(ready, "ready") << program_->logTail();
        awaitSwallowing();
    }

    // Until the program has the keyboard.
    void awaitSwallowing() {
        ASSERT_TRUE(waitUntil([&] {
            target_->clear();
            rig_->keyboard().type("sx");
            return target_->awaitText("x", Milliseconds(1'000)) == "x";
        }));
        target_->clear();
    }

    // Types until a key arrives; seconds from the first one.
    double typeUntilFreed() {
        const auto start = steady_clock::now();
        const bool freed = waitUntil([&] {
            rig_->keyboard().type("y");
            return target_->text().find('y') != std::string::npos;
        });
        const double seconds = std::chrono::duration<double>(steady_clock::now() - start).count();
        std::cout << "the keyboard worked after " << static_cast<int>(seconds * 1000) << " ms\n";
        return freed ? seconds : 1e9;
    }

    // Nothing is down for any program, so nothing repeats.
    void expectNoKeyDown() {
        EXPECT_TRUE(waitUntil([] { return rig_->client().keysDown().empty(); }))
            << testing::PrintToString(rig_->client().keysDown());
    }

    void holdX() {
        rig_->keyboard().press(rig_->keyboard().keycodeOf(U'x'));
        rig_->keyboard().sync();
        ASSERT_EQ(target_->takeChange(Milliseconds(10'000)).value_or(TextChange{}).inserted, "x");
    }

    void expectRecovered(int disabled) {
        EXPECT_TRUE(waitUntil([&] { return timesIn(contentOf(report_), "disabled") == disabled; }))
            << contentOf(report_);
        awaitSwallowing();
    }

    void expectEnded() {
        program_->end();
        EXPECT_TRUE(waitUntil([&] { return !stateOf(watchdog_); }));
        expectNoKeyDown();
    }

    static inline std::unique_ptr<DesktopRig> rig_;
    std::unique_ptr<TargetProgram> target_;
    std::unique_ptr<ChildProcess> program_;
    std::filesystem::path report_;
    pid_t watchdog_ = 0;
    static inline int programs_ = 0;
};

TEST_F(X11WatchdogTest, AStoppedProgramLosesTheKeyboardAndTakesItAgainWhenContinued) {
    for (int i = 1; i <= tries(); ++i) {
        holdX();
        program_->stop();
        rig_->keyboard().releaseAll();
        EXPECT_LT(typeUntilFreed(), bound());
        expectNoKeyDown();
        kill(program_->pid(), SIGCONT);
        expectRecovered(i);
    }
    expectEnded();
}

TEST_F(X11WatchdogTest, KeysTypedWhileItDoesNotAnswerArriveOnce) {
    const std::string text = "Never lost, in this order: 1234567890.";
    const auto expectOnce = [&](const std::string& typed) {
        EXPECT_EQ(target_->awaitText(typed), typed);
        kill(program_->pid(), SIGCONT);
        EXPECT_TRUE(waitUntil([&] { return timesIn(contentOf(report_), "disabled") > 0; }));
        EXPECT_EQ(target_->text(), typed);
        awaitSwallowing();
    };
    rig_->keyboard().type("x");
    EXPECT_EQ(target_->awaitText("x"), "x");
    program_->stop();
    rig_->keyboard().type(text);
    expectOnce("x" + text);
    expectEnded();
}

TEST_F(X11WatchdogTest, AHangingListenerLosesTheKeyboardAndTakesItAgain) {
    for (int i = 1; i <= tries(); ++i) {
        rig_->keyboard().press(Key::LeftShift);
        rig_->keyboard().release(Key::LeftShift);
        rig_->keyboard().type("h");
        EXPECT_LT(typeUntilFreed(), bound());
        expectNoKeyDown();
        ASSERT_TRUE(waitUntil([&] { return timesIn(contentOf(report_), "disabled") == i; }, Milliseconds(15'000)));
        expectRecovered(i);
    }
    expectEnded();
}

TEST_F(X11WatchdogTest, AProgramThatLoopsOrIsKilledLeavesNoKeyDownAndNoWatchdog) {
    for (int i = 0; i < 2 * tries(); ++i) {
        if (i > 0) startProgram();
        holdX();
        if (i % 2 == 0) {
            rig_->keyboard().type("l");
        } else {
            kill(program_->pid(), SIGKILL);
        }
        rig_->keyboard().releaseAll();
        EXPECT_LT(typeUntilFreed(), bound());
        expectNoKeyDown();
        kill(program_->pid(), SIGKILL);
        expectEnded();
    }
}

TEST_F(X11WatchdogTest, AWatchdogThatIsKilledIsReplaced) {
    kill(watchdog_, SIGKILL);
    // Its successor is the program's only child.
    const auto task = std::to_string(program_->pid());
    pid_t successor = 0;
    ASSERT_TRUE(waitUntil([&] {
        for (const auto& thread : std::filesystem::directory_iterator("/proc/" + task + "/task")) {
            std::istringstream(contentOf(thread.path() / "children")) >> successor;
            if (successor != 0 && successor != watchdog_) return true;
        }
        return false;
    }));
    watchdog_ = successor;
    rig_->keyboard().type("x");
    program_->stop();
    EXPECT_LT(typeUntilFreed(), bound() + 0.5);  // it may just be starting
    kill(program_->pid(), SIGCONT);
    expectRecovered(1);
    expectEnded();
}

TEST(WatchdogScheduleTest, AsksWhileKeysAreTypedAndNotOtherwise) {
    WatchdogSchedule schedule;
    EXPECT_EQ(schedule.next(100), WatchdogSchedule::Step::Wait);
    EXPECT_EQ(schedule.nextMoment(), WatchdogSchedule::Never);
    schedule.watch(true);
    EXPECT_EQ(schedule.next(100), WatchdogSchedule::Step::ListenAndAsk);
    EXPECT_EQ(schedule.next(100), WatchdogSchedule::Step::Wait);
    schedule.answered(schedule.question());
    EXPECT_EQ(schedule.nextMoment(), WatchdogSchedule::Never);

    ASSERT_TRUE(schedule.keyHeard(200));
    EXPECT_FALSE(schedule.keyHeard(200.1));
    int questions = 0;
    double now = 200;
    auto step = schedule.next(now);
    for (; step == WatchdogSchedule::Step::Ask && questions < 100; step = schedule.next(now)) {
        ++questions;
        schedule.answered(schedule.question());
        now = schedule.nextMoment();
    }
    // The last question covers what was typed before keys were listened to again.
    EXPECT_EQ(step, WatchdogSchedule::Step::ListenAndAsk);
    EXPECT_EQ(now, 210);
    EXPECT_EQ(questions, 40);
    schedule.answered(schedule.question());
    EXPECT_EQ(schedule.nextMoment(), WatchdogSchedule::Never);
}

TEST(WatchdogScheduleTest, GivesUpWhenTheAnswerToTheLatestQuestionIsMissing) {
    WatchdogSchedule schedule;
    schedule.watch(true);
    ASSERT_EQ(schedule.next(0), WatchdogSchedule::Step::ListenAndAsk);
    schedule.answered(schedule.question() - 1);
    EXPECT_EQ(schedule.next(0.5), WatchdogSchedule::Step::Wait);
    EXPECT_EQ(schedule.nextMoment(), WatchdogSchedule::AnswerTimeout);
    EXPECT_EQ(schedule.next(0.6), WatchdogSchedule::Step::GiveUp);
    EXPECT_EQ(schedule.next(0.7), WatchdogSchedule::Step::Wait);
    EXPECT_FALSE(schedule.keyHeard(0.8));
    EXPECT_EQ(schedule.nextMoment(), WatchdogSchedule::Never);
}

}  // namespace

}  // namespace plume::rig
