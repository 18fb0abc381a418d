// The tap and the poster, which have to know of each other.
#include <functional>
#include <string>
#include <vector>

#include "Foundation/KeyCode.h"
#include "Foundation/KeyModifiers.h"
#include "tests/contract/ContractDesk.h"

namespace plume {

namespace {

// Writes down what it hears, and swallows one key.
class Listener final : public KeyboardTapListener {
  public:
    struct Heard {
        TapEvent::Type type;
        KeyCode keyCode;
        EventFlags flags;
        std::u16string string;
        bool operator==(const Heard&) const = default;
    };

    bool keyboardEvent(const TapEvent& event) override {
        heard.push_back({event.type, event.keyCode, event.flags, std::u16string(event.string)});
        if (event.type == TapEvent::Type::KeyDown) downs += event.string;
        if (whenHeard) whenHeard(event);
        return event.keyCode == swallowed;
    }
    void tapDisabledByTimeout() override { ADD_FAILURE() << "nothing took long"; }
    void tapDisabledByUserInput() override { ADD_FAILURE() << "nobody switched the tap off"; }

    std::vector<Heard> heard;
    std::u16string downs;                            // the texts of all presses
    std::function<void(const TapEvent&)> whenHeard;  // during the decision; may be empty
    KeyCode swallowed = KeyCode::None;
};

using Type = TapEvent::Type;

void strike(ContractDesk& desk, KeyCode keyCode) {
    desk.press(keyCode);
    desk.release(keyCode);
}

void postText(EventPoster& poster, std::u16string_view text) {
    poster.begin();
    for (const bool down : {true, false}) poster.post({KeyCode::A, {}, down, text}, false);
    poster.end();
}

}  // namespace

TEST_P(KeyboardContract, HearsKeysWithTheirTextAndModifiers) {
    Listener listener;
    ASSERT_TRUE(desk_->keyboardTap().create(listener, false).ok());
    desk_->press(KeyCode::Shift);
    desk_->press(KeyCode::A);
    desk_->release(KeyCode::A);
    desk_->release(KeyCode::Shift);
    EXPECT_TRUE(desk_->runUntil([&] { return listener.heard.size() == 4; }));
    const std::vector<Listener::Heard> expected{{Type::FlagsChanged, KeyCode::Shift, EventFlag::Shift, u""},
                                                {Type::KeyDown, KeyCode::A, EventFlag::Shift, u"A"},
                                                {Type::KeyUp, KeyCode::A, EventFlag::Shift, u"A"},
                                                {Type::FlagsChanged, KeyCode::Shift, {}, u""}};
    EXPECT_EQ(listener.heard, expected);
    EXPECT_TRUE(desk_->runUntil([&] { return desk_->text(Program::First) == u"A"; }));
    desk_->keyboardTap().remove();
}

TEST_P(KeyboardContract, KeepsSwallowedKeysFromPrograms) {
    Listener listener;
    listener.swallowed = KeyCode::A;
    ASSERT_TRUE(desk_->keyboardTap().create(listener, false).ok());
    for (const KeyCode key : {KeyCode::A, KeyCode::B, KeyCode::A, KeyCode::B}) {
        desk_->press(key);
        desk_->release(key);
    }
    EXPECT_TRUE(desk_->runUntil([&] { return desk_->text(Program::First) == u"bb"; }));
    EXPECT_TRUE(desk_->runUntil([&] { return listener.heard.size() == 8; }));
    desk_->keyboardTap().remove();
}

TEST_P(KeyboardContract, LeavesKeysAloneOnceRemoved) {
    Listener listener;
    listener.swallowed = KeyCode::A;
    EXPECT_FALSE(desk_->keyboardTap().exists());
    EXPECT_TRUE(desk_->keyboardTap().check().ok());
    EXPECT_FALSE(desk_->keyboardTap().exists()) << "checking creates no tap";
    ASSERT_TRUE(desk_->keyboardTap().create(listener, false).ok());
    EXPECT_TRUE(desk_->keyboardTap().exists());
    desk_->keyboardTap().remove();
    EXPECT_FALSE(desk_->keyboardTap().exists());
    desk_->press(KeyCode::A);
    desk_->release(KeyCode::A);
    EXPECT_TRUE(desk_->runUntil([&] { return desk_->text(Program::First) == u"a"; }));
    EXPECT_TRUE(listener.heard.empty());
}

TEST_P(KeyboardContract, PostsKeysAndTextsInOrderAndUnheard) {
    Listener listener;
    ASSERT_TRUE(desk_->keyboardTap().create(listener, false).ok());
    EventPoster& poster = desk_->poster();
    const std::u16string text = u"x na\u00EFve \u65E5\u672C";
    ASSERT_TRUE(poster.canType(text));
    poster.begin();
    for (const bool down : {true, false}) poster.post({KeyCode::A, {}, down, text}, false);
    for (const bool down : {true, false}) poster.post({KeyCode::Delete, {}, down, {}}, false);
    for (const bool down : {true, false}) poster.post({KeyCode::A, EventFlag::Shift, down, {}}, false);
    poster.end();
    EXPECT_TRUE(desk_->runUntil([&] { return desk_->text(Program::First) == u"x na\u00EFve \u65E5A"; }));
    desk_->press(KeyCode::B);
    desk_->release(KeyCode::B);
    EXPECT_TRUE(desk_->runUntil([&] { return listener.heard.size() >= 2; }));
    const std::vector<Listener::Heard> expected{{Type::KeyDown, KeyCode::B, {}, u"b"},
                                                {Type::KeyUp, KeyCode::B, {}, u"b"}};
    EXPECT_EQ(listener.heard, expected) << "posted keys come before this one, and would have been heard by now";
    desk_->keyboardTap().remove();
}

TEST_P(KeyboardContract, LetsAPassedKeyFollowWhatWasPostedDuringTheDecision) {
    struct Posting final : KeyboardTapListener {
        explicit Posting(EventPoster& aPoster) : poster(aPoster) {}
        bool keyboardEvent(const TapEvent& event) override {
            if (event.type != Type::KeyDown) return false;
            poster.begin();
            for (const bool down : {true, false}) poster.post({KeyCode::A, {}, down, u"12"}, false);
            poster.end();
            return false;
        }
        void tapDisabledByTimeout() override {}
        void tapDisabledByUserInput() override {}
        EventPoster& poster;
    } listener(desk_->poster());
    ASSERT_TRUE(desk_->keyboardTap().create(listener, false).ok());
    desk_->press(KeyCode::A);
    desk_->release(KeyCode::A);
    EXPECT_TRUE(desk_->runUntil([&] { return desk_->text(Program::First) == u"12a"; }));
    desk_->keyboardTap().remove();
}

TEST_P(KeyboardContract, KnowsWhichKeysTheUserHolds) {
    Listener listener;
    ASSERT_TRUE(desk_->keyboardTap().create(listener, false).ok());
    desk_->press(KeyCode::B);
    EXPECT_TRUE(desk_->runUntil([&] { return desk_->poster().isKeyDown(KeyCode::B); }));
    EXPECT_FALSE(desk_->poster().isKeyDown(KeyCode::A));
    desk_->release(KeyCode::B);
    EXPECT_TRUE(desk_->runUntil([&] { return !desk_->poster().isKeyDown(KeyCode::B); }));
    desk_->keyboardTap().remove();
}

// What is typed while keys are held comes after the output where the port can make keys wait, else at once.

TEST_P(KeyboardContract, LetsTheDecidedKeyAndThoseAfterItFollowTheOutput) {
    Listener listener;
    listener.whenHeard = [&](const TapEvent& event) {
        if (event.type == Type::KeyDown && event.keyCode == KeyCode::C) desk_->poster().holdUserKeys();
    };
    ASSERT_TRUE(desk_->keyboardTap().create(listener, false).ok());
    for (const KeyCode key : {KeyCode::C, KeyCode::A, KeyCode::B}) strike(*desk_, key);
    const bool canHold = desk_->canHoldUserKeys();
    const std::u16string heardAtOnce = canHold ? u"c" : u"cab";
    ASSERT_TRUE(desk_->runUntil([&] { return listener.downs == heardAtOnce; }));
    EXPECT_TRUE(desk_->runUntil([&] { return desk_->text(Program::First) == (canHold ? u"" : u"cab"); }));
    postText(desk_->poster(), u"12");
    postText(desk_->poster(), u"34");
    desk_->poster().releaseUserKeys();
    const std::u16string expected = canHold ? u"1234cab" : u"cab1234";
    EXPECT_TRUE(desk_->runUntil([&] { return desk_->text(Program::First) == expected; }));
    EXPECT_EQ(listener.downs, u"cab") << "each key is decided about once";
    desk_->keyboardTap().remove();
}

TEST_P(KeyboardContract, KeepsTheModifiersOfHeldKeysOutOfTheOutput) {
    Listener listener;
    ASSERT_TRUE(desk_->keyboardTap().create(listener, false).ok());
    desk_->poster().holdUserKeys();
    desk_->press(KeyCode::Shift);
    strike(*desk_, KeyCode::A);
    desk_->release(KeyCode::Shift);
    strike(*desk_, KeyCode::B);
    const bool canHold = desk_->canHoldUserKeys();
    EXPECT_TRUE(desk_->runUntil([&] { return desk_->text(Program::First) == (canHold ? u"" : u"Ab"); }));
    postText(desk_->poster(), u"x");
    desk_->poster().releaseUserKeys();
    const std::u16string expected = canHold ? u"xAb" : u"Abx";
    EXPECT_TRUE(desk_->runUntil([&] { return desk_->text(Program::First) == expected; }));
    desk_->keyboardTap().remove();
}

TEST_P(KeyboardContract, LosesNoKeyWhenNobodyReleasesThem) {
    Listener listener;
    ASSERT_TRUE(desk_->keyboardTap().create(listener, false).ok());
    desk_->poster().holdUserKeys();
    for (const KeyCode key : {KeyCode::A, KeyCode::B}) strike(*desk_, key);
    EXPECT_TRUE(desk_->runUntil([&] { return desk_->text(Program::First) == u"ab"; }));
    desk_->poster().releaseUserKeys();
    strike(*desk_, KeyCode::C);
    EXPECT_TRUE(desk_->runUntil([&] { return desk_->text(Program::First) == u"abc"; }));
    desk_->keyboardTap().remove();
}

}  // namespace plume
