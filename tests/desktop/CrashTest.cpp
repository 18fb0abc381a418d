// The whole program when something goes wrong: it is killed or stopped, the program in front hangs, the X server is
// gone. The keyboard belongs to the user again within a second.
#include "testing/rig/KeyWitness.h"
#include "tests/desktop/Robustness.h"

namespace plume::rig {

namespace {

constexpr Milliseconds Bound(10'000);
// A second is promised; a loaded machine may add another.
constexpr Milliseconds Freed(2'000);

// Waits until the expansion is on the clipboard, which had no owner before.
void awaitOffer(DesktopRig& rig) {
    rig.client().await("the expansion on the clipboard", Milliseconds(5'000),
                       [&] { return rig.client().selectionOwner("CLIPBOARD") != 0; });
}

class Crash : public Robustness {
  protected:
    static pid_t plumePid() { return plume_->process().pid(); }

    // Taps a key until programs get it; the first taps may have gone down with who held the keyboard. The server is
    // asked, because a program may be busy with the text that it got before.
    static bool isKeyboardUsable(Milliseconds bound) {
        const int key = rig_->keyboard().keycodeOf(U'y');
        const Deadline deadline(bound);
        bool usable = false;
        while (!usable && !deadline.passed()) {
            rig_->keyboard().press(key);
            rig_->keyboard().sync();
            usable =
                waitUntil([&] { return std::ranges::count(rig_->client().keysDown(), key) > 0; }, Milliseconds(20));
            rig_->keyboard().release(key);
            rig_->keyboard().sync();
        }
        return usable;
    }

    static void expectKeyboardAtRest(TargetProgram& target) {
        EXPECT_TRUE(waitUntil([] { return isKeyboardAtRest(); }, Bound));
        // Behind what else is still on its way, but for keys that went down with Plume: the watchdog passes those on
        // when it comes to run.
        rig_->keyboard().type("usable, Again");
        const auto isThere = [&] { return target.text().find("usable, Again") != std::string::npos; };
        EXPECT_TRUE(waitUntil(isThere, Bound)) << target.text();
        target.clear();
    }

    static void expectExpands(TargetProgram& target, const Sample& sample) {
        const Expansion expansion = typeAndAwait(*rig_, target, sample.abbreviation, sample.content);
        EXPECT_TRUE(expansion.isRight) << expansion.got << '\n' << log();
    }

    static bool expandsWithin(TargetProgram& target, const Sample& sample, Milliseconds bound) {
        target.clear();
        rig_->keyboard().type(sample.abbreviation);
        return target.awaitText(sample.content, bound) == sample.content;
    }

    // Sets a long expansion off with Shift held, which is put aside while it is typed. Both keys stay down.
    static void startExpansionWithShift(TargetProgram& target) {
        target.clear();
        rig_->keyboard().type(HugeShifted.abbreviation.substr(0, 2));
        rig_->keyboard().press(Key::LeftShift);
        rig_->keyboard().press(rig_->keyboard().keycodeOf(static_cast<char32_t>(HugeShifted.abbreviation.back())));
        rig_->keyboard().sync();
    }
};

TEST_F(Crash, KilledInTheMiddleOfAnExpansion) {
    const auto target = rig_->startTarget(TargetKind::Xterm);
    for (const Way way : {Way::Typed, Way::Pasted}) {
        for (const int delay : {0, 1, 3, 10, 30}) {
            SCOPED_TRACE(std::to_string(delay) + " ms" + (way == Way::Pasted ? ", pasted" : ""));
            startPlume(way);
            startExpansionWithShift(*target);
            poll(nullptr, 0, delay);
            ASSERT_EQ(kill(plumePid(), SIGKILL), 0);
            EXPECT_EQ(plume_->process().waitForExit(Bound), 128 + SIGKILL);
            rig_->keyboard().releaseAll();
            EXPECT_TRUE(isKeyboardUsable(Freed));
            expectKeyboardAtRest(*target);
        }
        startPlume(way);
        expectExpands(*target, ShortMixed);
    }
}

TEST_F(Crash, KilledWhileAProgramHasNotTakenThePaste) {
    const auto target = rig_->startTarget(TargetKind::GtkTextView);
    startPlume(Way::Pasted);
    rig_->client().emptySelection("CLIPBOARD");
    ASSERT_EQ(kill(target->pid(), SIGSTOP), 0);
    rig_->keyboard().type(LongAscii.abbreviation);
    awaitOffer(*rig_);
    ASSERT_EQ(kill(plumePid(), SIGKILL), 0);
    EXPECT_EQ(plume_->process().waitForExit(Bound), 128 + SIGKILL);
    ASSERT_EQ(kill(target->pid(), SIGCONT), 0);
    EXPECT_TRUE(isKeyboardUsable(Freed));
    expectKeyboardAtRest(*target);
    startPlume(Way::Pasted);
    expectExpands(*target, LongAscii);
}

TEST_F(Crash, StoppedForFiveSeconds) {
    const auto target = rig_->startTarget(TargetKind::GtkTextView);
    startPlume(Way::Typed);
    startExpansionWithShift(*target);
    EXPECT_TRUE(waitUntil([&] { return target->text().starts_with("naïve"); }, Bound));
    const Deadline stopped(Milliseconds(5'000));
    plume_->process().stop();  // with more of the text to come, which must not come later
    EXPECT_TRUE(isKeyboardUsable(Freed));
    rig_->keyboard().releaseAll();
    expectKeyboardAtRest(*target);
    while (!stopped.passed()) stopped.waitReadable(-1);
    ASSERT_EQ(kill(plumePid(), SIGCONT), 0);
    EXPECT_TRUE(waitUntil([] { return log().find("Event tap was disabled by timeout") != std::string::npos; }, Bound))
        << log();
    expectKeyboardAtRest(*target);
    // The keyboard is taken a while after the message.
    EXPECT_TRUE(waitUntil([&] { return expandsWithin(*target, ShortMixed, Milliseconds(500)); }, Bound)) << log();
    expectExpands(*target, LongMixed);
    expectExpands(*target, ShortMixed);
}

// The program in front hangs, with the keystroke that pastes the expansion waiting for it.
class HungTarget : public Crash {
  protected:
    void SetUp() override {
        startPlume(Way::Pasted);
        other_ = rig_->startTarget(TargetKind::QtTextEdit);
        hung_ = rig_->startTarget(TargetKind::GtkTextView);
        ASSERT_EQ(kill(hung_->pid(), SIGSTOP), 0);
        KeyWitness witness(rig_->server().display());
        rig_->keyboard().type(LongMixed.abbreviation);
        witness.awaitPress(rig_->keyboard().keycodeOf(U'v'), Bound);
    }

    // Goes to the other program, and types into it what becomes the expected text.
    void expectOtherUsable(const std::string& typed, const std::string& expected) {
        other_->activate();
        rig_->keyboard().type(typed);
        // Plume waits a second for the paste to be taken, and holds keys for two at most.
        EXPECT_EQ(other_->awaitText(expected, Milliseconds(5'000)), expected) << log();
    }

    void wake() { ASSERT_EQ(kill(hung_->pid(), SIGCONT), 0); }

    std::unique_ptr<TargetProgram> other_;
    std::unique_ptr<TargetProgram> hung_;
};

TEST_F(HungTarget, LeavesTheKeyboardUsableAndGetsItsPasteLater) {
    expectOtherUsable("usable", "usable");
    wake();
    EXPECT_EQ(hung_->awaitText(LongMixed.content), LongMixed.content) << log();
}

TEST_F(HungTarget, LeavesExpandingToTheOthers) {
    expectOtherUsable("usable " + LongAscii.abbreviation + "behind", "usable " + LongAscii.content + "behind");
    wake();
    expectExpands(*other_, ShortMixed);
}

// Each on a desktop of its own, which does not outlive its X server.
void expectEndsWithTheServer(DesktopRig& rig, PlumeProgram& plume) {
    rig.server().crash();
    EXPECT_EQ(plume.process().waitForExit(Milliseconds(5'000)), 1) << plume.process().logTail();
    EXPECT_NE(plume.process().logTail().find("The X server is gone"), std::string::npos) << plume.process().logTail();
}

TEST(ServerGone, EndsPlumeAtRest) {
    DesktopRig rig;
    PlumeProgram plume(rig, sampleLibrary(), settingsFor(Way::Typed));
    expectEndsWithTheServer(rig, plume);
}

TEST(ServerGone, EndsPlumeInTheMiddleOfAnExpansion) {
    DesktopRig rig;
    PlumeProgram plume(rig, sampleLibrary(), settingsFor(Way::Pasted));
    const auto target = rig.startTarget(TargetKind::GtkTextView);
    ASSERT_EQ(kill(target->pid(), SIGSTOP), 0);
    rig.keyboard().type(HugeShifted.abbreviation);
    awaitOffer(rig);
    expectEndsWithTheServer(rig, plume);
    kill(target->pid(), SIGCONT);  // to end, too
}

}  // namespace

}  // namespace plume::rig
