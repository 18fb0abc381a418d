// What a port tells of the rest of the desktop: who keeps the keyboard, the system's hot keys, clicks.
#include <initializer_list>
#include <string>
#include <vector>

#include "Foundation/KeyCode.h"
#include "Foundation/KeyModifiers.h"
#include "tests/contract/ContractDesk.h"

namespace plume {

namespace {

void chord(ContractDesk& desk, std::initializer_list<KeyCode> modifiers, KeyCode keyCode) {
    for (const KeyCode modifier : modifiers) desk.press(modifier);
    desk.press(keyCode);
    desk.release(keyCode);
    for (const KeyCode modifier : modifiers) desk.release(modifier);
}

class PassingListener final : public KeyboardTapListener {
  public:
    bool keyboardEvent(const TapEvent&) override { return false; }
    void tapDisabledByTimeout() override {}
    void tapDisabledByUserInput() override {}
};

// Writes the places of clicks down.
MouseTap::Listener writingTo(std::vector<Point>& places) {
    return [&places](Point place) { places.push_back(place); };
}

}  // namespace

TEST_P(SecureInputContract, IsOnWhileAnotherProgramHoldsTheKeyboard) {
    const SecureInput& secureInput = desk_->secureInput();
    EXPECT_FALSE(secureInput.isSecureEventInputEnabled());
    for (int round = 0; round < 2; ++round) {
        desk_->setKeyboardHeldElsewhere(true);
        EXPECT_TRUE(desk_->runUntil([&] { return secureInput.isSecureEventInputEnabled(); }));
        desk_->setKeyboardHeldElsewhere(false);
        EXPECT_TRUE(desk_->runUntil([&] { return !secureInput.isSecureEventInputEnabled(); }));
    }
}

TEST_P(SecureInputContract, DoesNotMistakeTheKeyboardTapForAnotherProgram) {
    PassingListener listener;
    ASSERT_TRUE(desk_->keyboardTap().create(listener, false).ok());
    chord(*desk_, {}, KeyCode::A);
    EXPECT_TRUE(desk_->runUntil([&] { return desk_->text(Program::First) == u"a"; }));
    EXPECT_FALSE(desk_->secureInput().isSecureEventInputEnabled());
    desk_->keyboardTap().remove();
}

TEST_P(SystemHotKeysContract, CallsTheHandlerForExactlyItsCombination) {
    int called = 0;
    ASSERT_TRUE(desk_->systemHotKeys().registerHotKey(FirstId, KeyCode::B, KeyModifier::Shift, [&] { ++called; }).ok());
    chord(*desk_, {}, KeyCode::B);
    chord(*desk_, {KeyCode::Control}, KeyCode::B);
    chord(*desk_, {KeyCode::Control, KeyCode::Shift}, KeyCode::B);
    chord(*desk_, {KeyCode::Shift}, KeyCode::A);
    EXPECT_TRUE(desk_->runUntil([&] { return desk_->text(Program::First) == u"bA"; }));
    EXPECT_EQ(called, 0);
    for (int times = 1; times <= 2; ++times) {
        chord(*desk_, {KeyCode::Shift}, KeyCode::B);
        EXPECT_TRUE(desk_->runUntil([&] { return called == times; }));
    }
    chord(*desk_, {}, KeyCode::A);
    EXPECT_TRUE(desk_->runUntil([&] { return desk_->text(Program::First) == u"bAa"; })) << "no program gets it";
}

TEST_P(SystemHotKeysContract, ReplacesWhatHadTheSameId) {
    SystemHotKeys& hotKeys = desk_->systemHotKeys();
    std::string called;
    ASSERT_TRUE(hotKeys.registerHotKey(FirstId, KeyCode::B, KeyModifier::Control, [&] { called += 'x'; }).ok());
    ASSERT_TRUE(hotKeys.registerHotKey(FirstId, KeyCode::A, KeyModifier::Control, [&] { called += 'x'; }).ok());
    ASSERT_TRUE(hotKeys.registerHotKey(FirstId, KeyCode::A, KeyModifier::Control, [&] { called += 'a'; }).ok());
    chord(*desk_, {KeyCode::Control}, KeyCode::B);
    chord(*desk_, {KeyCode::Control}, KeyCode::A);
    EXPECT_TRUE(desk_->runUntil([&] { return !called.empty(); }));
    EXPECT_EQ(called, "a");
    EXPECT_TRUE(hotKeys.registerHotKey(SecondId, KeyCode::B, KeyModifier::Control, [&] { called += 'b'; }).ok())
        << "what was replaced is free";
    chord(*desk_, {KeyCode::Control}, KeyCode::B);
    EXPECT_TRUE(desk_->runUntil([&] { return called == "ab"; }));
}

TEST_P(SystemHotKeysContract, RefusesACombinationThatAnotherIdHas) {
    SystemHotKeys& hotKeys = desk_->systemHotKeys();
    std::string called;
    ASSERT_TRUE(hotKeys.registerHotKey(FirstId, KeyCode::B, KeyModifier::Control, [&] { called += '1'; }).ok());
    const auto refused = hotKeys.registerHotKey(SecondId, KeyCode::B, KeyModifier::Control, [&] { called += '2'; });
    ASSERT_FALSE(refused.ok());
    EXPECT_FALSE(refused.error().message.empty());
    chord(*desk_, {KeyCode::Control}, KeyCode::B);
    EXPECT_TRUE(desk_->runUntil([&] { return called == "1"; }));
}

TEST_P(SystemHotKeysContract, ForgetsWhatWasUnregistered) {
    SystemHotKeys& hotKeys = desk_->systemHotKeys();
    std::string called;
    hotKeys.unregisterHotKey(FirstId);
    ASSERT_TRUE(hotKeys.registerHotKey(FirstId, KeyCode::B, KeyModifier::Control, [&] { called += 'x'; }).ok());
    ASSERT_TRUE(hotKeys.registerHotKey(SecondId, KeyCode::A, KeyModifier::Control, [&] { called += 'a'; }).ok());
    hotKeys.unregisterHotKey(FirstId);
    hotKeys.unregisterHotKey(FirstId);
    chord(*desk_, {KeyCode::Control}, KeyCode::B);
    chord(*desk_, {KeyCode::Control}, KeyCode::A);
    EXPECT_TRUE(desk_->runUntil([&] { return !called.empty(); }));
    EXPECT_EQ(called, "a");
}

TEST_P(NoticesContract, TellOfTheButtonThatWasPressedAndOfNoOther) {
    std::string pressed;
    const auto write = [&pressed](char c) { return [&pressed, c] { pressed += c; }; };
    desk_->notices().show({"First", "1 < 2 & so on", {{"Yes", write('y')}, {"No", write('n')}}});
    desk_->notices().show({"Second", "Nothing to press."});
    EXPECT_TRUE(desk_->runUntil([&] { return desk_->notice("First") && desk_->notice("Second"); }));
    desk_->pressNoticeButton("First", "No");
    EXPECT_TRUE(desk_->runUntil([&] { return !pressed.empty(); }));
    EXPECT_EQ(pressed, "n");
}

TEST_P(MouseTapContract, HearsClicksWithTheirPlaceAndNoWheel) {
    using Button = ContractDesk::Button;
    struct Case {
        Button button;
        Point place;
    };
    std::vector<Point> heard;
    ASSERT_TRUE(desk_->mouseTap().create(writingTo(heard)).ok());
    std::vector<Point> expected;
    for (const Case& c : {Case{Button::Left, {40, 60}}, {Button::Right, {300, 20}}, {Button::Middle, {0, 0}}}) {
        desk_->click(Button::Wheel, {7, 7});
        desk_->click(c.button, c.place);
        expected.push_back(c.place);
        EXPECT_TRUE(desk_->runUntil([&] { return heard.size() >= expected.size(); }));
        EXPECT_EQ(heard, expected) << "the button's coming up is not told";
        EXPECT_EQ(desk_->poster().pointerLocation(), c.place);
    }
    desk_->mouseTap().remove();
}

TEST_P(MouseTapContract, HearsNothingOnceRemoved) {
    MouseTap& mouseTap = desk_->mouseTap();
    std::vector<Point> before;
    std::vector<Point> after;
    EXPECT_FALSE(mouseTap.exists());
    ASSERT_TRUE(mouseTap.create(writingTo(before)).ok());
    EXPECT_TRUE(mouseTap.exists());
    mouseTap.remove();
    EXPECT_FALSE(mouseTap.exists());
    mouseTap.remove();
    desk_->click(ContractDesk::Button::Left, {40, 60});
    ASSERT_TRUE(mouseTap.create(writingTo(after)).ok());
    desk_->click(ContractDesk::Button::Right, {50, 70});
    EXPECT_TRUE(desk_->runUntil([&] { return !after.empty(); }));
    EXPECT_EQ(after, (std::vector<Point>{{50, 70}}));
    EXPECT_TRUE(before.empty());
    mouseTap.remove();
}

}  // namespace plume
