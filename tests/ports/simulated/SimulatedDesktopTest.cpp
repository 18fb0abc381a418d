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
        {u"a\U0001F600", KeyCode::Delete, {}, 1, u"a", {1, 0}},
        {u"ae\u0301", KeyCode::Delete, {}, 1, u"a", {1, 0}},
        {u"a\U0001F600", KeyCode::Left, {}, 1, u"a\U0001F600", {1, 0}},
        {u"abc", KeyCode::Left, KeyModifier::Shift, 2, u"abc", {1, 2}},
        {u"ab\ncd", KeyCode::Up, {}, 2, u"ab\ncd", {0, 0}},
        {u"a\nbcd", KeyCode::Up, {}, 1, u"a\nbcd", {1, 0}},
    };
    for (const Case& c : cases) {
        editor_.setText(c.text);
        press(c.keyCode, c.modifiers, c.count);
        EXPECT_EQ(editor_.field().text(), c.result) << "key " << numberOf(c.keyCode);
        EXPECT_EQ(editor_.field().selection(), c.selection) << "key " << numberOf(c.keyCode);
    }
}

TEST_F(SimulatedDesktopTest, PastesWithTheModifierOfTheApplication) {
    desktop_.pasteboard().copyFromProgram(u"P\xD800");  // half a character is kept, too
    editor_.setUsesControlKey(true);
    press(KeyCode::V, KeyModifier::Command);
    EXPECT_EQ(editor_.field().text(), u"");
    press(KeyCode::V, KeyModifier::Control);
    EXPECT_EQ(editor_.field().text(), u"P\xD800");
}

}  // namespace plume
