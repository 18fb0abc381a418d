// The poster on a real X server: what it types arrives, exactly, in programs of three kinds, whatever the user's
// keyboard is just doing.

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>

#include "Foundation/Strings.h"
#include "testing/rig/Deadline.h"
#include "testing/rig/DesktopRig.h"
#include "testing/rig/KeyboardPort.h"

namespace plume::rig {

namespace {

// CJK characters from the given one on, none twice.
std::string distinctCharacters(int from, int count) {
    std::u16string text;
    for (int i = 0; i < count; ++i) text += static_cast<char16_t>(0x4E00 + from + i);
    return toUtf8(text);
}

// A thousand characters in lines, such that a lost, doubled or swapped one shows.
std::string lines(const std::string& start) {
    std::string text;
    for (int line = 0; fromUtf8(text).size() < 1000; ++line) {
        text += start + " Line " + std::to_string(line * 7919 % 1000) + ", (~_~) {x}|\\^\n";
    }
    return text;
}

const std::string AsciiLine = "Quick \"brown\" fox";
const std::string MixedLine = "naïve Ünïcödé — 日本語 【】 😀";

// A held or locked key at the end of a test must not reach the next one, so each brings its own desktop's keyboard to
// rest.
class X11PosterTest : public testing::TestWithParam<TargetKind> {
  protected:
    static void SetUpTestSuite() { rig_ = std::make_unique<DesktopRig>(); }
    static void TearDownTestSuite() { rig_.reset(); }

    void SetUp() override {
        target_ = rig_->startTarget(GetParam());
        port_ = std::make_unique<KeyboardPort>(rig_->server().display(), KeyboardPort::Options{});
    }
    void TearDown() override { rig_->keyboard().releaseAll(); }

    bool canType(const std::string& text) {
        return port_->run([&] { return port_->poster().canType(fromUtf8(text)); });
    }

    static inline std::unique_ptr<DesktopRig> rig_;
    std::unique_ptr<TargetProgram> target_;
    std::unique_ptr<KeyboardPort> port_;
};

TEST_P(X11PosterTest, TypesAThousandCharactersExactly) {
    ASSERT_TRUE(canType(MixedLine));
    for (const std::string& start : {AsciiLine, MixedLine}) {
        target_->clear();
        port_->type(fromUtf8(lines(start)));
        EXPECT_EQ(target_->awaitText(lines(start), Milliseconds(20'000)), lines(start));
    }
}

TEST_P(X11PosterTest, TextInPiecesLosesNothingAtTheCuts) {
    port_->run([&] {
        port_->poster().begin();
        for (const std::u16string_view piece : {u"a\xD83D", u"\xDE00\r", u"\nb\r", u"\r\n", u"\nc\xD83D", u"d"}) {
            port_->poster().post({.down = true, .text = piece}, false);
            port_->poster().post({.down = false, .text = piece}, false);
        }
        port_->poster().end();
    });
    const std::string expected = "a😀\nb\n\n\ncd";
    EXPECT_EQ(target_->awaitText(expected), expected);
}

TEST_P(X11PosterTest, CapsLockDoesNotTouchTheTextAndComesBack) {
    rig_->keyboard().tap(Key::CapsLock);
    rig_->keyboard().type("x");
    ASSERT_EQ(target_->awaitText("X"), "X");
    port_->type(u" Caps é日 Ün ");
    EXPECT_EQ(target_->awaitText("X Caps é日 Ün "), "X Caps é日 Ün ");
    rig_->keyboard().type("x");
    ASSERT_EQ(target_->awaitText("X Caps é日 Ün X"), "X Caps é日 Ün X");
    rig_->keyboard().tap(Key::CapsLock);
}

TEST_P(X11PosterTest, SpareKeyCodesAreUsedAgainOnceTheyHaveRested) {
    EXPECT_FALSE(canType(distinctCharacters(0, 40)));
    EXPECT_FALSE(canType("control \x02"));
    EXPECT_TRUE(canType("line\nand\ttab"));
    std::string expected;
    int rested = 0;
    for (int round = 0; round < 4; ++round) {
        const std::string text = distinctCharacters(10 * round, 10) + ' ';
        if (!canType(text)) ++rested;
        waitUntil([&] { return canType(text); });
        port_->type(fromUtf8(text));
        expected += text;
    }
    EXPECT_EQ(target_->awaitText(expected), expected);
    EXPECT_GT(rested, 0);
    // More than there are: the batch waits for the first ones to have rested.
    target_->clear();
    port_->type(fromUtf8(distinctCharacters(100, 24)));
    EXPECT_EQ(target_->awaitText(distinctCharacters(100, 24)), distinctCharacters(100, 24));
}

INSTANTIATE_TEST_SUITE_P(All, X11PosterTest,
                         testing::Values(TargetKind::GtkTextView, TargetKind::QtTextEdit, TargetKind::Xterm),
                         [](const auto& tested) { return nameOf(tested.param); });

// What does not depend on the program.
using X11PosterKeysTest = X11PosterTest;

TEST_P(X11PosterKeysTest, PostsKeysWithExactlyTheirModifiers) {
    rig_->keyboard().type("abcd");
    ASSERT_EQ(target_->awaitText("abcd"), "abcd");
    const auto press = [&](KeyCode key, EventFlags flags) {
        port_->poster().post({.keyCode = key, .flags = flags, .down = true, .text = {}}, false);
        port_->poster().post({.keyCode = key, .flags = {}, .down = false, .text = {}}, false);
    };
    // The user holds Shift: an arrow would select, were it not for the poster.
    rig_->keyboard().press(Key::LeftShift);
    rig_->keyboard().sync();
    EXPECT_TRUE(waitUntil([&] { return port_->run([&] { return port_->poster().isKeyDown(KeyCode::Shift); }); }));
    port_->run([&] {
        auto& poster = port_->poster();
        poster.begin();
        press(KeyCode::Left, {});
        poster.post({.text = u"-"}, false);
        press(KeyCode::Left, EventFlag::Shift);
        press(KeyCode::Delete, {});
        press(KeyCode::Home, EventFlag::Shift);
        poster.post({.text = u"X"}, false);
        press(KeyCode::A, EventFlag::Control);
        poster.post({.text = u"all\r\n\tü"}, false);
        poster.end();
    });
    EXPECT_EQ(target_->awaitText("all\n\tü"), "all\n\tü");
}

TEST_P(X11PosterKeysTest, AKeyThatTheUserHoldsNeitherRepeatsIntoTheTextNorHidesInIt) {
    const int x = rig_->keyboard().keycodeOf(U'x');
    rig_->keyboard().press(x);
    rig_->keyboard().sync();
    ASSERT_EQ(target_->awaitText("x"), "x");
    port_->type(u"xx, box");
    ASSERT_EQ(target_->awaitText("xxx, box"), "xxx, box");
    rig_->keyboard().release(x);
    rig_->keyboard().type("x");
    EXPECT_EQ(target_->awaitText("xxx, boxx"), "xxx, boxx");
}

INSTANTIATE_TEST_SUITE_P(All, X11PosterKeysTest, testing::Values(TargetKind::GtkTextView),
                         [](const auto& tested) { return nameOf(tested.param); });

TEST(X11PosterLayoutTest, TypesTextOnTheLayoutAndTheGroupInForce) {
    XServer::Options options;
    options.layout = "de,us";
    DesktopRig rig(options);
    const auto target = rig.startTarget(TargetKind::GtkTextView);
    KeyboardPort port(rig.server().display(), {});
    const std::string text = "zyZY äöüÖß?_-:; @€{[]}\\~ µ „Grüße“ — 日本語 ^`´";
    port.type(fromUtf8(text));
    EXPECT_EQ(target->awaitText(text), text);

    target->clear();
    const auto switcher = rig.session().start({"setxkbmap", "us,de"}, "x11-xkb-utils");
    ASSERT_EQ(switcher->waitForExit(Milliseconds(10'000)), 0);
    const std::string mixed = "zyZY [] /?' äöü 日";
    std::string typed;
    // The port hears of the change in its own time.
    for (int tries = 0; tries < 100 && typed != mixed; ++tries) {
        target->clear();
        port.type(fromUtf8(mixed));
        typed = target->awaitText(mixed, Milliseconds(200));
    }
    EXPECT_EQ(typed, mixed);

    // A shortcut whose letter no key of the layout has.
    const auto keyOfA = [&] { return port.run([&] { return port.poster().keyCodeOfLetter(u'a'); }); };
    EXPECT_EQ(keyOfA(), KeyCode::A);
    const auto other = rig.session().start({"setxkbmap", "ru"}, "x11-xkb-utils");
    ASSERT_EQ(other->waitForExit(Milliseconds(10'000)), 0);
    ASSERT_TRUE(waitUntil([&] { return keyOfA() != KeyCode::A; }));
    const KeyCode selectAll = keyOfA();
    port.run([&] {
        port.poster().post({.keyCode = selectAll, .flags = EventFlag::Control, .down = true, .text = {}}, false);
    });
    port.type(u"all");
    EXPECT_EQ(target->awaitText("all"), "all");
}

}  // namespace

}  // namespace plume::rig
