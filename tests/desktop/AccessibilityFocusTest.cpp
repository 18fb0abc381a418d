// How Plume finds out what has the focus, and that the programs which are asked stay as quick as they are without it.

#include <gtest/gtest.h>
#include <unistd.h>

#include <chrono>
#include <csignal>
#include <cstddef>

#include "input/AXUtils.h"
#include "ports/atspi/AtspiSession.h"
#include "testing/rig/BusMonitor.h"
#include "testing/rig/ListedProgram.h"
#include "tests/desktop/AccessibilityDesktop.h"

namespace plume::rig {

namespace {

using std::chrono::steady_clock;

constexpr BusAddress Registry{"org.a11y.atspi.Registry", "/org/a11y/atspi/registry", "org.a11y.atspi.Registry"};

// Another program on the accessibility bus.
class BusClient {
  public:
    explicit BusClient(const std::string& address) : connection_(openBus(address)) {
        if (!connection_) throw RigError("no bus at " + address);
    }

    BusAnswer call(const BusAddress& to, const char* method, std::initializer_list<BusValue> arguments = {}) {
        const BusMessage message = newCall(to, method, arguments);
        return BusAnswer(
            BusMessage(dbus_connection_send_with_reply_and_block(connection_.get(), message.get(), 10'000, nullptr)));
    }

    // How many kinds of events somebody listens for.
    int registeredEvents() {
        const BusAnswer answer = call(Registry, "GetRegisteredEvents");
        if (!answer) throw RigError("the registry does not answer");
        int count = 0;
        for (BusReader list = answer.values().inside(); !list.isAtEnd(); list.inside()) ++count;
        return count;
    }

  private:
    BusConnection connection_;
};

class AccessibilityFocusTest : public AccessibilityDesktop {
  protected:
    static const std::string& address() {
        static const std::string found = findAccessibilityBus().address;
        return found;
    }

    // From here on nothing makes for looks but keys: those that follow a move of the focus are over.
    static void awaitEndOfLooks() {
        for (int i = 0; i < 4; ++i) {
            BusMonitor states(address(), {"GetState"});
            accessibility_->focusMayHaveMoved();
            const Deadline deadline(Milliseconds(3'000));
            while (states.count() < 4 && !deadline.passed()) deadline.waitReadable(-1, Milliseconds(5));
            if (states.count() >= 4) return;
            // A program that is too busy to answer is left alone for a second.
        }
        FAIL() << "the program does not answer in time";
    }
};

// ---- What asking costs the program that is asked ----

TEST_F(AccessibilityFocusTest, AProgramDoesNotWaitForTheBusWithEveryKey) {
    const auto target = startFocused(TargetKind::GtkTextView);
    EXPECT_TRUE(waitUntil([] { return AXUtils::getTextBeforeCaretWithMaxLength(*accessibility_, 3).has_value(); }));
    BusClient client(address());
    EXPECT_EQ(client.registeredEvents(), 0);

    BusMonitor told(address(), {"NotifyListenersSync", "NotifyListenersAsync"});
    std::string typed;
    for (int i = 0; i < 20; ++i) {
        rig_->keyboard().type("abcdefghij");
        typed += "abcdefghij";
        accessibility_->userTypes();
        EXPECT_EQ(target->awaitText(typed), typed);
    }
    EXPECT_EQ(told.count(), 0);

    // With somebody who listens it does, or this test sees nothing.
    ASSERT_TRUE(client.call(Registry, "RegisterEvent", {"object:state-changed:focused"}));
    EXPECT_TRUE(waitUntil([&] {
        rig_->keyboard().type("k");
        return told.count() > 0;
    }));
}

TEST_F(AccessibilityFocusTest, TypingAsksFewQuestions) {
    const auto target = startFocused(TargetKind::GtkTextView);
    awaitEndOfLooks();
    BusMonitor states(address(), {"GetState"});
    const auto begin = steady_clock::now();
    ASSERT_TRUE(waitUntil([&] {
        for (int i = 0; i < 1'000; ++i) accessibility_->userTypes();
        return states.count() >= 3;
    }));
    EXPECT_GE(steady_clock::now() - begin, std::chrono::milliseconds(450));  // two pauses between three looks
}

TEST_F(AccessibilityFocusTest, WhatAnExpansionWantsToKnowIsAskedAtOnce) {
    const auto target = startFocused(TargetKind::GtkTextView);
    awaitEndOfLooks();
    BusMonitor roles(address(), {"GetRole"});
    const auto focused = AXUtils::getFocusedUIElement(*accessibility_);
    ASSERT_TRUE(focused);
    EXPECT_FALSE(focused->stringAttribute("AXSubrole"));
    EXPECT_EQ(AXUtils::getSelectedTextLength(*accessibility_), 0);
    EXPECT_EQ(roles.count(), 0);
    rig_->keyboard().type("abc");
    rig_->keyboard().chord({Key::LeftShift}, Key::Left);
    EXPECT_TRUE(waitUntil([] { return AXUtils::getSelectedTextLength(*accessibility_) == 1; }));
}

TEST_F(AccessibilityFocusTest, AProgramThatTellsNothingIsAskedEverMoreRarely) {
    const auto background = rig_->startTarget(TargetKind::GtkTextView);
    const auto terminal = rig_->startTarget(TargetKind::Xterm);
    BusMonitor lists(address(), {"GetChildren"});
    accessibility_->setFrontProcess(terminal->pid());
    ASSERT_TRUE(waitUntil([&] { return lists.count() > 0; }));
    EXPECT_TRUE(awaitTyping([&] { return lists.count() >= 12; }));  // the first looks, and more with the keys
    EXPECT_EQ(accessibility_->frontApplicationElement(), nullptr);  // the text behind it does not stand for it
    EXPECT_EQ(accessibility_->focusedProcess(), 0);
    lists.forget();
    const auto begin = steady_clock::now();
    EXPECT_TRUE(awaitTyping([&] { return lists.count() >= 4; }));  // two looks and the pause between them
    EXPECT_GE(steady_clock::now() - begin, std::chrono::milliseconds(450));
}

// ---- What is found ----

TEST_F(AccessibilityFocusTest, APasswordFieldIsNoticedByTypingAlone) {
    const auto target = startFocused(TargetKind::GtkTextView);
    auto quickest = steady_clock::duration::max();
    // On a busy machine the program itself may take its time: one of a few tries must do.
    for (int i = 0; i < 4 && quickest > std::chrono::milliseconds(500); ++i) {
        awaitEndOfLooks();
        target->showPassword(true);
        ASSERT_TRUE(waitUntil([&] { return rig_->client().focusedWindow() != target->window(); }));
        const auto begin = steady_clock::now();
        ASSERT_TRUE(awaitTyping([] { return accessibility_->focusIsPassword(); }));
        quickest = std::min(quickest, steady_clock::now() - begin);
        target->showPassword(false);
        ASSERT_TRUE(
            awaitTyping([] { return !accessibility_->focusIsPassword() && accessibility_->focusedProcess() != 0; }));
    }
    EXPECT_LE(quickest, std::chrono::milliseconds(500));
}

TEST_F(AccessibilityFocusTest, TheFirstKeyInAnotherProgramKnowsWhetherItIsAPassword) {
    const auto target = startFocused(TargetKind::GtkTextView);
    target->showPassword(true);
    ASSERT_TRUE(awaitTyping([] { return accessibility_->focusIsPassword(); }));
    EXPECT_TRUE(waitUntil([&] {  // a busy machine may take longer than the bound
        accessibility_->setFrontProcess(0);
        accessibility_->setFrontProcess(target->pid());
        return accessibility_->focusIsPasswordForKey();
    }));
}

TEST_F(AccessibilityFocusTest, APasswordStaysOneWhenItsProgramHangs) {
    const auto target = startFocused(TargetKind::GtkTextView);
    target->showPassword(true);
    ASSERT_TRUE(awaitTyping([] { return accessibility_->focusIsPassword(); }));
    ASSERT_EQ(kill(target->pid(), SIGSTOP), 0);
    BusMonitor states(address(), {"GetState"});
    EXPECT_TRUE(awaitTyping([&] { return states.count() >= 2; }));  // the first one was given up
    EXPECT_TRUE(accessibility_->focusIsPassword());
    accessibility_->setFrontProcess(0);
    EXPECT_FALSE(accessibility_->focusIsPassword());
    ASSERT_EQ(kill(target->pid(), SIGCONT), 0);
}

TEST_F(AccessibilityFocusTest, AProgramThatIsListedLateIsFound) {
    accessibility_->setFrontProcess(getpid());
    BusMonitor counts(address(), {"Get"});
    ASSERT_TRUE(awaitTyping([&] { return counts.count() >= 6; }));  // asks the registry how many it lists
    EXPECT_EQ(accessibility_->focusedProcess(), 0);
    ListedProgram program(address(), 3);
    EXPECT_TRUE(awaitTyping([] { return accessibility_->focusedProcess() == getpid(); }));
}

TEST_F(AccessibilityFocusTest, TheActiveWindowStandsForAProgramWithoutANumber) {
    const auto target = rig_->startTarget(TargetKind::QtTextEdit);
    accessibility_->setFrontProcess(1);  // as a sandbox counts
    EXPECT_TRUE(awaitTyping([&] { return accessibility_->focusedProcess() == target->pid(); }));
    accessibility_->setFrontProcess(0);
    EXPECT_TRUE(awaitTyping([&] { return accessibility_->focusedProcess() == target->pid(); }));
}

// ---- Programs that are too deep to walk through ----

TEST_F(AccessibilityFocusTest, ADeepProgramIsListenedToWhileItIsInFront) {
    const auto target = startFocused(TargetKind::GtkTextView);
    BusClient client(address());
    ListedProgram program(address(), 60);
    accessibility_->setFrontProcess(getpid());
    ASSERT_TRUE(awaitTyping([&] { return client.registeredEvents() == 1; }));
    EXPECT_EQ(accessibility_->focusedProcess(), 0);  // out of reach

    program.focus(ListedProgram::Field::Password);
    EXPECT_TRUE(waitUntil([] { return accessibility_->focusIsPassword(); }));
    EXPECT_EQ(accessibility_->focusedProcess(), getpid());
    program.focus(ListedProgram::Field::Text);
    EXPECT_TRUE(waitUntil([] { return !accessibility_->focusIsPassword(); }));
    // The one field may tell that it lost the focus before the other tells that it has it.
    EXPECT_TRUE(waitUntil([] { return accessibility_->focusedProcess() == getpid(); }));

    comesToFront(*target);
    EXPECT_TRUE(waitUntil([&] { return client.registeredEvents() == 0; }));
}

TEST_F(AccessibilityFocusTest, AKeyBehindATabWaitsForWhereTheFocusGoes) {
    ListedProgram program(address(), 60);
    accessibility_->setFrontProcess(getpid());
    bool isPassword = false;
    for (int i = 0; i < 4 && !isPassword; ++i) {  // a busy machine may take longer than the bound
        ASSERT_TRUE(awaitTyping([&] {
            program.focus(ListedProgram::Field::Text);
            return accessibility_->focusedProcess() == getpid() && !accessibility_->focusIsPassword();
        }));
        accessibility_->userMovesFocus(FocusMover::Tab);
        program.focus(ListedProgram::Field::Password);
        isPassword = accessibility_->focusIsPasswordForKey();
    }
    EXPECT_TRUE(isPassword);
}

TEST_F(AccessibilityFocusTest, NoKeyWaitsForAProgramThatTellsNothing) {
    const auto terminal = rig_->startTarget(TargetKind::Xterm);
    accessibility_->setFrontProcess(terminal->pid());
    accessibility_->focusIsPasswordForKey();
    auto quickest = steady_clock::duration::max();
    for (int i = 0; i < 4; ++i) {
        accessibility_->userMovesFocus(FocusMover::Tab);
        const auto begin = steady_clock::now();
        EXPECT_FALSE(accessibility_->focusIsPasswordForKey());
        quickest = std::min(quickest, steady_clock::now() - begin);
    }
    EXPECT_LE(quickest, std::chrono::milliseconds(5));
}

TEST_F(AccessibilityFocusTest, AFocusThatMovesWithoutTheUserIsNoticed) {
    ListedProgram program(address(), 60);
    accessibility_->setFrontProcess(getpid());
    ASSERT_TRUE(awaitTyping([&] {
        program.focus(ListedProgram::Field::Text);
        return accessibility_->focusedProcess() == getpid();
    }));
    accessibility_->userMovesFocus(FocusMover::Tab);
    program.focus(ListedProgram::Field::Password);
    EXPECT_TRUE(waitUntil([] { return accessibility_->focusIsPassword(); }));
    EXPECT_FALSE(accessibility_->takeOwnMove());
    EXPECT_TRUE(awaitTyping([&] {  // within a second of the Tab it would be expected
        program.focus(ListedProgram::Field::Text);
        program.focus(ListedProgram::Field::Password);
        return accessibility_->takeOwnMove();
    }));
}

TEST_F(AccessibilityFocusTest, AProgramThatHidesItsPartsIsAskedForThem) {
    ListedProgram program(address(), 3);
    program.hideParts();
    accessibility_->setFrontProcess(getpid());
    EXPECT_TRUE(awaitTyping([] { return accessibility_->focusedProcess() == getpid(); }));
}

// ---- A bus that goes ----

TEST_F(AccessibilityFocusTest, ABusThatGoesIsTold) {
    DesktopRig rig;
    rig.session().join();
    const std::string itsAddress = findAccessibilityBus().address;
    const auto target = rig.startTarget(TargetKind::GtkTextView);
    AtspiAccessibility accessibility;
    accessibility.setFrontProcess(target->pid());
    target->showPassword(true);
    EXPECT_TRUE(waitUntil([&] {
        accessibility.userTypes();
        return accessibility.focusIsPassword();
    }));
    const auto bus = BusClient(itsAddress)
                         .call({DBUS_SERVICE_DBUS, DBUS_PATH_DBUS, DBUS_INTERFACE_DBUS}, "GetConnectionUnixProcessID",
                               {DBUS_SERVICE_DBUS})
                         .values()
                         .uint32();
    ASSERT_TRUE(bus);
    ASSERT_EQ(kill(static_cast<pid_t>(*bus), SIGKILL), 0);
    EXPECT_TRUE(waitUntil([&] {
        accessibility.userTypes();
        return accessibility.status() == AccessibilityStatus::Failed;
    }));
    EXPECT_TRUE(accessibility.focusIsPassword());
    EXPECT_EQ(AXUtils::getValue(accessibility), std::nullopt);
    accessibility.setFrontProcess(getpid());
    EXPECT_FALSE(accessibility.focusIsPassword());
    rig_->session().join();
}

}  // namespace

}  // namespace plume::rig
