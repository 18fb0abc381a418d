#include "ports/simulated/SimulatedDesktop.h"

#include <gtest/gtest.h>

#include "Foundation/KeyCode.h"
#include "Foundation/KeyModifiers.h"

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
    desktop_.pasteboard().copyFromProgram(u"P\xD800");  // half a character is kept, too
    editor_.setUsesControlKey(true);
    press(KeyCode::V, KeyModifier::Command);
    EXPECT_EQ(editor_.field().text(), u"");
    press(KeyCode::V, KeyModifier::Control);
    EXPECT_EQ(editor_.field().text(), u"P\xD800");
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

}  // namespace plume
