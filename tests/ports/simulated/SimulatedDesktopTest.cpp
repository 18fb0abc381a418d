#include "ports/simulated/SimulatedDesktop.h"

#include <gtest/gtest.h>

#include <functional>

#include "Foundation/KeyCode.h"
#include "Foundation/KeyModifiers.h"
#include "Foundation/text/RTFD.h"

namespace plume {

namespace {

class SimulatedDesktopTest : public testing::Test {
  protected:
    void press(KeyCode keyCode, KeyModifiers modifiers = {}, int count = 1) {
        for (int i = 0; i < count; ++i) desktop_.pressAndRelease(keyCode, modifiers);
    }
    void post(KeyCode keyCode, EventFlags flags = {}) {
        for (const bool down : {true, false}) desktop_.poster().post({keyCode, flags, down, {}}, false);
    }

    SimulatedDesktop desktop_;
    SimulatedApplication& editor_ = desktop_.activate(u"org.example.editor");
};

// Swallows nothing, and does something at each key that goes down.
class Reacting final : public KeyboardTapListener {
  public:
    explicit Reacting(std::function<void()> reaction) : reaction_(std::move(reaction)) {}
    bool keyboardEvent(const TapEvent& event) override {
        if (event.type != TapEvent::Type::KeyDown) return false;
        ++heard;
        reaction_();
        return false;
    }
    void tapDisabledByTimeout() override { timedOut = true; }
    void tapDisabledByUserInput() override {}
    int heard = 0;
    bool timedOut = false;

  private:
    std::function<void()> reaction_;
};

}  // namespace

TEST_F(SimulatedDesktopTest, EditsTextWithTheKeyboard) {
    struct Case {
        std::u16string text;
        KeyCode keyCode;
        KeyModifiers modifiers;
        int count;
        std::u16string result;
        Range selection;
    };
    const Case cases[] = {
        {u"ab", KeyCode::Return, {}, 1, u"ab\n", {3, 0}},
        {u"ab", KeyCode::KeypadEnter, {}, 1, u"ab\n", {3, 0}},
        {u"ab", KeyCode::Escape, {}, 1, u"ab", {2, 0}},
        {u"ab", KeyCode::A, KeyModifier::Control, 1, u"ab", {2, 0}},
        {u"a\U0001F600", KeyCode::Delete, {}, 1, u"a", {1, 0}},
        {u"ae\u0301", KeyCode::Delete, {}, 1, u"a", {1, 0}},
        {u"a\U0001F600", KeyCode::Left, {}, 1, u"a\U0001F600", {1, 0}},
        {u"abc", KeyCode::Left, KeyModifier::Shift, 2, u"abc", {1, 2}},
        {u"ab\ncd", KeyCode::Home, {}, 1, u"ab\ncd", {3, 0}},
        {u"ab\ncd", KeyCode::Up, {}, 1, u"ab\ncd", {2, 0}},
        {u"ab\ncd", KeyCode::Up, {}, 2, u"ab\ncd", {0, 0}},
        {u"ab\ncd", KeyCode::Down, {}, 1, u"ab\ncd", {5, 0}},
        {u"a\nbcd", KeyCode::Up, {}, 1, u"a\nbcd", {1, 0}},
        {u"", KeyCode::Delete, {}, 1, u"", {0, 0}},
        {u"", KeyCode::ForwardDelete, {}, 1, u"", {0, 0}},
    };
    for (const Case& c : cases) {
        editor_.setText(c.text);
        press(c.keyCode, c.modifiers, c.count);
        EXPECT_EQ(editor_.field().text(), c.result) << "key " << numberOf(c.keyCode);
        EXPECT_EQ(editor_.field().selection(), c.selection) << "key " << numberOf(c.keyCode);
    }
}

TEST_F(SimulatedDesktopTest, WorksOnTheSelection) {
    editor_.setText(u"one two");
    editor_.select({0, 3});
    press(KeyCode::C, KeyModifier::Command);
    EXPECT_EQ(desktop_.pasteboard().string(), u"one");
    press(KeyCode::ForwardDelete);
    EXPECT_EQ(editor_.field().text(), u" two");
    press(KeyCode::End);
    press(KeyCode::V, KeyModifier::Command);
    EXPECT_EQ(editor_.field().text(), u" twoone");
    press(KeyCode::Left, KeyModifier::Shift, 3);
    desktop_.typeCharacter(u"X");
    EXPECT_EQ(editor_.field().text(), u" twoX");
    editor_.select({0, 2});
    press(KeyCode::Left);
    EXPECT_EQ(editor_.field().caret(), 0u);
}

TEST_F(SimulatedDesktopTest, PastesWithTheModifierOfTheApplication) {
    desktop_.pasteboard().copyFromProgram(u"P");
    press(KeyCode::V, KeyModifier::Control);
    EXPECT_EQ(editor_.field().text(), u"");
    editor_.setUsesControlKey(true);
    press(KeyCode::V, KeyModifier::Control);
    press(KeyCode::V, KeyModifier::Command);
    EXPECT_EQ(editor_.field().text(), u"P");
}

TEST_F(SimulatedDesktopTest, PastesTheTextOfRichContent) {
    const AttributedString rich(u"rich \u00E9");
    desktop_.pasteboard().copyFromProgram({{std::string(PasteboardType::RTF), rtfFromAttributedString(rich)}});
    press(KeyCode::V, KeyModifier::Command);
    EXPECT_EQ(editor_.field().text(), u"rich \u00E9");
}

TEST_F(SimulatedDesktopTest, TakesAModifierThatPlumePressesAsAKey) {
    desktop_.pasteboard().copyFromProgram(u"P");
    desktop_.poster().post({KeyCode::Command, {}, true, {}}, false);
    post(KeyCode::V);
    desktop_.poster().post({KeyCode::Command, {}, false, {}}, false);
    post(KeyCode::V);
    EXPECT_EQ(editor_.field().text(), u"Pv");
}

TEST_F(SimulatedDesktopTest, InsertsAChunkAsItStands) {
    desktop_.keyboard().press(KeyCode::Command);
    desktop_.poster().post({KeyCode::A, {}, true, u"a\rb\t"}, false);
    desktop_.poster().post({KeyCode::A, {}, false, u"a\rb\t"}, false);
    EXPECT_EQ(editor_.field().text(), u"a\rb\t");
}

TEST_F(SimulatedDesktopTest, RecordsWhatTheApplicationReceived) {
    desktop_.runLoop().advance(1.5);
    desktop_.typeCharacter(u"A");
    desktop_.typeCharacter(u"\u00E9");
    post(KeyCode::Delete);
    const auto& events = editor_.events();
    ASSERT_EQ(events.size(), 8u);
    EXPECT_EQ(events[0].keyCode, KeyCode::Shift);
    EXPECT_EQ(events[1].keyCode, KeyCode::A);
    EXPECT_EQ(events[1].flags, EventFlag::Shift);
    EXPECT_EQ(events[1].time, 1.5);
    EXPECT_EQ(events[4].keyCode, std::nullopt);
    EXPECT_EQ(events[4].string, u"\u00E9");
    EXPECT_EQ(events[5].origin, SimulatedKeyEvent::Origin::User);
    EXPECT_EQ(events[6].origin, SimulatedKeyEvent::Origin::Plume);
    EXPECT_EQ(events[6].keyCode, KeyCode::Delete);
    EXPECT_FALSE(events[7].down);
}

TEST_F(SimulatedDesktopTest, SendsKeysToTheProgramInFront) {
    desktop_.typeCharacter(u"a");
    SimulatedApplication& terminal = desktop_.activate(u"org.example.terminal");
    desktop_.typeCharacter(u"b");
    desktop_.processManager().bringToFront(editor_.process());
    desktop_.typeCharacter(u"c");
    desktop_.processManager().bringToFront(desktop_.processManager().currentProcess());
    desktop_.typeCharacter(u"d");
    EXPECT_EQ(editor_.field().text(), u"ac");
    EXPECT_EQ(terminal.field().text(), u"b");
    EXPECT_EQ(desktop_.accessibility().frontApplicationElement(), nullptr);
}

TEST_F(SimulatedDesktopTest, LetsKeysWaitForTheOutputWhereThePortCan) {
    int timesHeld = 0;
    Reacting listener([&] {
        if (timesHeld++ == 0) desktop_.poster().holdUserKeys();
    });
    ASSERT_TRUE(desktop_.keyboardTap().create(listener, false).ok());
    desktop_.keyboard().setCanHold(true);
    desktop_.typeCharacter(u"a");
    desktop_.typeCharacter(u"b");
    EXPECT_EQ(editor_.field().text(), u"");
    EXPECT_EQ(listener.heard, 1);
    desktop_.poster().post({KeyCode::A, {}, true, u"1"}, false);
    desktop_.poster().releaseUserKeys();
    EXPECT_EQ(editor_.field().text(), u"1ab");
    EXPECT_EQ(listener.heard, 2);
}

TEST_F(SimulatedDesktopTest, LetsKeysWaitTwoSecondsAtMost) {
    desktop_.keyboard().setCanHold(true);
    desktop_.poster().holdUserKeys();
    desktop_.typeCharacter(u"a");
    desktop_.runLoop().advance(1.9);
    EXPECT_EQ(editor_.field().text(), u"");
    desktop_.runLoop().advance(0.1);
    EXPECT_EQ(editor_.field().text(), u"a");
}

TEST_F(SimulatedDesktopTest, LeavesKeysAloneAfterATimeoutUntilEnabled) {
    Reacting listener([] {});
    ASSERT_TRUE(desktop_.keyboardTap().create(listener, false).ok());
    desktop_.keyboardTap().disableByTimeout();
    EXPECT_TRUE(listener.timedOut);
    desktop_.typeCharacter(u"a");
    EXPECT_EQ(listener.heard, 0);
    desktop_.keyboardTap().enable();
    desktop_.typeCharacter(u"b");
    EXPECT_EQ(listener.heard, 1);
    EXPECT_EQ(editor_.field().text(), u"ab");
}

TEST_F(SimulatedDesktopTest, GivesSystemHotKeysToTheirHandlerAlone) {
    int pressed = 0;
    ASSERT_TRUE(desktop_.systemHotKeys().registerHotKey(1, KeyCode::A, KeyModifier::Option, [&] { ++pressed; }).ok());
    EXPECT_FALSE(desktop_.systemHotKeys().registerHotKey(2, KeyCode::A, KeyModifier::Option, [] {}).ok());
    press(KeyCode::A, KeyModifier::Option);
    press(KeyCode::A);
    desktop_.systemHotKeys().unregisterHotKey(1);
    press(KeyCode::A, KeyModifier::Option);
    EXPECT_EQ(pressed, 1);
    EXPECT_EQ(editor_.field().text(), u"aa");
}

}  // namespace plume
