// The keyboard tap of X11 between a keyboard and real programs.

#include <xcb/xinput.h>
#include <xcb/xtest.h>

#include <algorithm>
#include <atomic>
#include <chrono>
#include <memory>
#include <random>
#include <string>
#include <utility>
#include <vector>

#include "ports/x11/keyboard/InputDevices.h"
#include "ports/x11/keyboard/XcbXkb.h"
#include "testing/rig/Deadline.h"
#include "testing/rig/FocusCounter.h"
#include "testing/rig/KeyWitness.h"
#include "testing/rig/XcbReply.h"
#include "tests/desktop/X11TapFixture.h"

namespace plume::rig {

namespace {

class X11TapTargetTest : public X11TapTest, public testing::WithParamInterface<TargetKind> {};

TEST_P(X11TapTargetTest, SwallowsAnyHalfOfFastTyping) {
    constexpr std::size_t Keys = 2'000;
    std::mt19937 random(static_cast<unsigned>(GetParam()) + 1);  // NOLINT(cert-msc51-cpp): the same every time
    std::string typed;
    std::string expected;
    std::vector<bool> swallow;
    for (std::size_t i = 0; i < Keys; ++i) {
        typed += "abcdefghijklmnopqrstuvwxyz0123456789 "[random() % 37];
        swallow.push_back(random() % 2 == 0);
        if (!swallow.back()) expected += typed.back();
    }
    const auto target = rig_->startTarget(GetParam());
    FocusCounter focus(rig_->server().display(), target->window());
    createTap();
    setDecision([&swallow, next = std::size_t{0}](const TapEvent& event) mutable {
        return event.type == Type::KeyDown && swallow.at(next++);
    });
    rig_->keyboard().typeRollingOver(typed);
    EXPECT_EQ(target->awaitText(expected, Milliseconds(30'000)), expected);
    EXPECT_EQ(takeHeard(2 * Keys).size(), 2 * Keys);
    await("all keys are up", [] { return keysDown().empty(); });
    removeTap();
    EXPECT_EQ(focus.takeCore(), FocusCounter::Counts{});
    EXPECT_EQ(focus.takeInputExtension(), FocusCounter::Counts{});
    rig_->keyboard().type("End");
    EXPECT_EQ(target->awaitText(expected + "End"), expected + "End");
}

INSTANTIATE_TEST_SUITE_P(All, X11TapTargetTest,
                         testing::Values(TargetKind::GtkTextView, TargetKind::QtTextEdit, TargetKind::Xterm),
                         [](const auto& tested) { return nameOf(tested.param); });

// A window manager that is told of another layout in the middle of a shortcut gives the shortcut up.
TEST_F(X11TapTest, HasTheLayoutToldBeforeTheFirstKey) {
    rig_->keyboard().type("x");
    createTap();
    const std::unique_ptr<xcb_connection_t, decltype(&xcb_disconnect)> program(
        xcb_connect(rig_->server().display().c_str(), nullptr), &xcb_disconnect);
    const int key = rig_->keyboard().keycodeOf(U'x');
    rig_->keyboard().press(key);
    await("the key is down for programs", [&] { return std::ranges::count(keysDown(), key) == 1; });
    rig_->keyboard().release(key);
    own(xcb_get_input_focus_reply(program.get(), xcb_get_input_focus(program.get()), nullptr));
    while (const auto event = own(xcb_poll_for_queued_event(program.get()))) {
        EXPECT_NE(event->response_type, XCB_MAPPING_NOTIFY);
    }
}

TEST_F(X11TapTest, TellsWhatKeysProduceAndWhichModifiersAreHeld) {
    struct Case {
        int keycode;
        Heard down;
        std::vector<Key> held = {};
    };
    const std::vector<Case> cases{
        {38, {Type::KeyDown, KeyCode::A, {}, u"a"}},
        {38, {Type::KeyDown, KeyCode::A, EventFlag::Shift, u"A"}, {Key::LeftShift}},
        {54, {Type::KeyDown, KeyCode::C, EventFlag::Control, u"\x03"}, {Key::LeftControl}},
        {11, {Type::KeyDown, KeyCode::Digit2, EventFlag::Control, u"2"}, {Key::LeftControl}},
        {17, {Type::KeyDown, KeyCode::Digit8, EventFlag::Control, u"8"}, {Key::LeftControl}},
        {53, {Type::KeyDown, KeyCode::X, EventFlag::Option, u"", false, true}, {Key::LeftAlt}},
        {22, {Type::KeyDown, KeyCode::Delete, EventFlag::Option, u"\b", false, true}, {Key::LeftAlt}},
        {29, {Type::KeyDown, KeyCode::Y, EventFlag::Command, u"y"}, {Key::LeftSuper}},
        {29,
         {Type::KeyDown, KeyCode::Y, EventFlag::Control | EventFlag::Shift, u"\x19"},
         {Key::LeftControl, Key::LeftShift}},
        {36, {Type::KeyDown, KeyCode::Return, {}, u"\r"}},
        {104, {Type::KeyDown, KeyCode::KeypadEnter, {}, u"\r"}},
        {23, {Type::KeyDown, KeyCode::Tab, {}, u"\t"}},
        {9, {Type::KeyDown, KeyCode::Escape, {}, u"\x1B"}},
        {119, {Type::KeyDown, KeyCode::ForwardDelete, {}, u"\x7F"}},
        {113, {Type::KeyDown, KeyCode::Left, {}, u""}},
        {83, {Type::KeyDown, KeyCode::Left, {}, u""}},  // keypad 4 while Num Lock is off
        {71, {Type::KeyDown, KeyCode::F5, {}, u""}},
        {123, {Type::KeyDown, KeyCode::VolumeUp, {}, u""}},
        {180, {Type::KeyDown, KeyCode{436}, {}, u""}},  // a browser key, which Apple keyboards do not have
    };
    createTap();
    for (const Case& each : cases) {
        for (const Key key : each.held) rig_->keyboard().press(key);
        takeHeard(each.held.size());
        tapKey(each.keycode);
        Heard up = each.down;
        up.type = Type::KeyUp;
        EXPECT_THAT(takeHeard(2), testing::ElementsAre(each.down, up)) << "X key code " << each.keycode;
        for (const Key key : each.held) rig_->keyboard().release(key);
        takeHeard(each.held.size());
    }
}

TEST_F(X11TapTest, TellsEachModifierByItsKey) {
    struct Case {
        int keycode;
        KeyCode keyCode;
        EventFlags flags;
    };
    const std::vector<Case> cases{
        {50, KeyCode::Shift, EventFlag::Shift},      {62, KeyCode::RightShift, EventFlag::Shift},
        {37, KeyCode::Control, EventFlag::Control},  {105, KeyCode::RightControl, EventFlag::Control},
        {64, KeyCode::Option, EventFlag::Option},    {108, KeyCode::RightOption, EventFlag::Option},
        {133, KeyCode::Command, EventFlag::Command}, {134, KeyCode::RightCommand, EventFlag::Command}};
    createTap();
    for (const Case& each : cases) {
        tapKey(each.keycode);
        EXPECT_THAT(takeHeard(2), testing::ElementsAre(Heard{Type::FlagsChanged, each.keyCode, each.flags, u""},
                                                       Heard{Type::FlagsChanged, each.keyCode, {}, u""}));
    }
}

TEST_F(X11TapTest, WhatIsSwallowedDoesNotLookLikeAModifierAlone) {
    KeyWitness programs(rig_->server().display());
    createTap();
    setDecision([](const TapEvent& event) { return event.type != Type::KeyUp && event.flags.isEmpty(); });
    rig_->keyboard().tap(Key::LeftSuper);
    programs.awaitPress(static_cast<int>(Key::LeftControl), Bound);
    setDecision([](const TapEvent& event) { return event.type == Type::KeyDown; });
    rig_->keyboard().chord({Key::LeftAlt}, U'k');
    programs.awaitPress(static_cast<int>(Key::LeftControl), Bound);
}

TEST_F(X11TapTest, TellsWhenAnotherProgramTypes) {
    const auto target = rig_->startTarget(TargetKind::GtkTextView);
    createTap();
    rig_->keyboard().type("ab");
    EXPECT_EQ(target->awaitText("ab"), "ab");
    takeHeard(4);
    EXPECT_EQ(tap_->run([this] { return listener_.withheld; }), 0) << "what passes is no other program's";
    for (const bool down : {true, false}) {
        xcb_test_fake_input(rig_->client().connection(), down ? XCB_KEY_PRESS : XCB_KEY_RELEASE, 54, XCB_CURRENT_TIME,
                            XCB_NONE, 0, 0, 0);
    }
    rig_->client().focusedWindow();
    EXPECT_EQ(target->awaitText("abc"), "abc");
    await("it is told", [this] { return tap_->run([this] { return listener_.withheld == 1; }); });
    EXPECT_EQ(heard(), std::vector<Heard>{});
}

TEST_F(X11TapTest, HeldKeysRepeat) {
    const auto target = rig_->startTarget(TargetKind::GtkTextView);
    createTap();
    rig_->keyboard().press(38);
    await("it repeats", [&] { return target->text().size() >= 4; });
    rig_->keyboard().releaseAll();
    await("it is up", [] { return keysDown().empty(); });
    const std::string text = target->text();
    rig_->keyboard().type("b");
    EXPECT_EQ(target->awaitText(text + "b"), text + "b");
    const auto all = heard();
    EXPECT_GE(std::ranges::count(all, Heard{Type::KeyDown, KeyCode::A, {}, u"a"}), 3);
    EXPECT_EQ(std::ranges::count(all, Heard{Type::KeyUp, KeyCode::A, {}, u"a"}), 1);
    EXPECT_EQ(tap_->run([this] { return listener_.withheld; }), 0) << "what repeats is no other program's";
}

TEST_F(X11TapTest, AKeyWhoseRepeatIsSwallowedStopsRepeating) {
    const auto target = rig_->startTarget(TargetKind::GtkTextView);
    createTap();
    setDecision([presses = 0](const TapEvent& event) mutable { return event.type == Type::KeyDown && ++presses > 1; });
    rig_->keyboard().press(38);
    takeHeard(8);
    EXPECT_EQ(keysDown(), std::vector<int>{}) << "for the programs, that is";
    const std::string text = target->text();
    EXPECT_LE(text.size(), 2U);
    rig_->keyboard().releaseAll();
    setDecision(nullptr);
    rig_->keyboard().type("b");
    EXPECT_EQ(target->awaitText(text + "b"), text + "b");
}

TEST_F(X11TapTest, HeldBackKeysWaitTwoSecondsAtMost) {
    const auto target = rig_->startTarget(TargetKind::GtkTextView);
    createTap();
    setDecision([this](const TapEvent& event) {
        if (event.type == Type::KeyDown && event.string == u"x") tap_->tap->hold();
        return false;
    });
    const auto start = std::chrono::steady_clock::now();
    rig_->keyboard().type("xy");
    EXPECT_EQ(target->awaitText("xy"), "xy");
    EXPECT_GT(std::chrono::steady_clock::now() - start, std::chrono::milliseconds(1'900));
}

TEST_F(X11TapTest, KeysThatAreKeptWaitingFollowAClickOrAKeyWithAlt) {
    const auto target = rig_->startTarget(TargetKind::GtkTextView);
    createTap();
    setDecision([this](const TapEvent& event) {
        if (event.type == Type::KeyDown && event.string == u"x") tap_->tap->hold();
        return false;
    });
    for (const bool click : {true, false}) {
        target->clear();
        rig_->keyboard().type("xy");
        await("keys are held", [&] {
            return std::ranges::count(heard(), Heard{Type::KeyDown, KeyCode::X, {}, u"x"}) == (click ? 1 : 2);
        });
        tap_->run([this] { tap_->tap->keepHolding(); });
        const auto start = std::chrono::steady_clock::now();
        rig_->keyboard().type("z");
        if (click) tap_->run([this] { tap_->tap->userClicked(); });
        if (!click) rig_->keyboard().tap(Key::LeftAlt);
        EXPECT_EQ(target->awaitText("xyz"), "xyz");
        EXPECT_LT(std::chrono::steady_clock::now() - start, std::chrono::milliseconds(1'500));
    }
}

TEST_F(X11TapTest, AKeyThatIsDownDoesNotRepeatWhileKeysAreKeptWaiting) {
    const auto target = rig_->startTarget(TargetKind::GtkTextView);
    createTap();
    rig_->keyboard().press(Key::LeftShift);
    rig_->keyboard().press(38);
    EXPECT_EQ(target->awaitText("A"), "A");
    tap_->run([this] {
        tap_->tap->hold();
        tap_->tap->keepHolding();
    });
    await("all but the modifier, which goes on counting, is up", [] { return keysDown() == std::vector<int>{50}; });
    rig_->keyboard().releaseAll();
    rig_->keyboard().type("b");
    tap_->run([this] { tap_->tap->release(); });
    EXPECT_EQ(target->awaitText("Ab"), "Ab");
    await("all is up", [] { return keysDown().empty(); });
}

TEST_F(X11TapTest, KeysHeldWhileItComesAndGoesComeUp) {
    const auto target = rig_->startTarget(TargetKind::GtkTextView);
    rig_->keyboard().press(Key::LeftShift);
    rig_->keyboard().sync();
    createTap();
    tapKey(38);
    EXPECT_EQ(target->awaitText("A"), "A");
    rig_->keyboard().releaseAll();
    tapKey(38);
    EXPECT_EQ(target->awaitText("Aa"), "Aa");
    rig_->keyboard().press(Key::LeftShift);
    rig_->keyboard().sync();
    await("shift is down", [] { return keysDown() == std::vector<int>{50}; });
    removeTap();
    EXPECT_EQ(keysDown(), std::vector<int>{}) << "nothing pressed by the tap stays down";
    rig_->keyboard().releaseAll();
    rig_->keyboard().type("bC");
    EXPECT_EQ(target->awaitText("AabC"), "AabC");
}

TEST_F(X11TapTest, PassesKeysUnheardWhileSomebodyHoldsTheKeyboard) {
    createTap();
    {
        XClient locker(rig_->server().display());
        const auto cookie = xcb_grab_keyboard(locker.connection(), 0, locker.root(), XCB_CURRENT_TIME,
                                              XCB_GRAB_MODE_ASYNC, XCB_GRAB_MODE_ASYNC);
        ASSERT_EQ(own(xcb_grab_keyboard_reply(locker.connection(), cookie, nullptr))->status, 0);
        int received = 0;
        const auto awaitEvents = [&](int count) {
            await("the locker gets the keys", [&] {
                while (const auto event = own(xcb_poll_for_event(locker.connection()))) {
                    if (event->response_type == XCB_KEY_PRESS || event->response_type == XCB_KEY_RELEASE) ++received;
                }
                return received == count;
            });
        };
        tapKey(39);  // the first key may still go by an answer of before
        awaitEvents(2);
        tap_->run([this] { listener_.heard.clear(); });
        tapKey(38);
        awaitEvents(4);
        EXPECT_EQ(heard(), std::vector<Heard>{});
    }
    await("the locker has let go", [&] {
        tapKey(38);
        return !heard().empty();
    });
}

TEST_F(X11TapTest, PassesKeysUnheardIntoPasswordFields) {
    const auto target = rig_->startTarget(TargetKind::GtkTextView);
    std::atomic<bool> password = true;
    std::atomic<bool> moved = false;
    tap_->run([&] {
        tap_->tap->setFocusQuestions({[&] { return password.load(); }, [&] { return moved.exchange(false); }});
    });
    createTap();
    rig_->keyboard().type("Se");
    rig_->keyboard().press(Key::LeftShift);
    EXPECT_EQ(target->awaitText("Se"), "Se");
    EXPECT_EQ(heard(), std::vector<Heard>{});
    EXPECT_EQ(tap_->run([this] { return listener_.withheld; }), 1) << "of all of them";
    await("shift is down", [] { return keysDown() == std::vector<int>{50}; });
    password = false;
    tapKey(38);
    rig_->keyboard().releaseAll();
    EXPECT_EQ(target->awaitText("SeA"), "SeA");
    const auto all = takeHeard(3);
    EXPECT_EQ(all.at(0), (Heard{Type::FlagsChanged, KeyCode::Shift, EventFlag::Shift, u""}))
        << "what was missed is made up for";
    EXPECT_EQ(all.at(1), (Heard{Type::KeyDown, KeyCode::A, EventFlag::Shift, u"A"}));
    moved = true;
    tapKey(38);
    takeHeard(2);
    EXPECT_EQ(tap_->run([this] { return listener_.withheld; }), 2) << "what was typed before was for another field";
}

// Makes a word of two letters of every key.
class Doubling final : public InputMethod {
  public:
    bool takesText() const override { return true; }
    bool isComposing() const override { return false; }
    bool isIdle() const override { return !announced && !outcome; }
    void announceKey(std::uint32_t /*code*/, bool typesNothing) override {
        announced = true;
        passes = typesNothing;
    }
    void settle() override {
        if (std::exchange(announced, false)) outcome = Outcome{.text = passes ? u"" : u"ab", .keyPassed = passes};
    }
    std::optional<Outcome> next() override { return std::exchange(outcome, std::nullopt); }

    bool announced = false;
    bool passes = false;
    std::optional<Outcome> outcome;
};

TEST_F(X11TapTest, TellsWhatAKeyBecameBeforeTheNextKey) {
    const auto target = rig_->startTarget(TargetKind::GtkTextView);
    Doubling method;
    tap_->run([&] { tap_->tap->setInputMethod(&method); });
    createTap();
    tapKey(38);
    EXPECT_EQ(takeHeard(2).at(0), (Heard{Type::KeyDown, KeyCode::A, {}, u""})) << "undecided";
    rig_->keyboard().tap(Key::Home);
    EXPECT_THAT(takeHeard(3), testing::ElementsAre(Heard{Type::KeyDown, KeyCode::None, {}, u"ab"},
                                                   Heard{Type::KeyDown, KeyCode::Home, {}, u""},
                                                   Heard{Type::KeyUp, KeyCode::Home, {}, u""}));
    EXPECT_TRUE(method.announced && method.passes) << "the next key waits, but this one is decided";
    tapKey(56);
    EXPECT_EQ(takeHeard(2).at(0), (Heard{Type::KeyDown, KeyCode::B, {}, u""}));
    EXPECT_EQ(target->awaitText("ba"), "ba");
    setDecision([this](const TapEvent& event) {
        if (event.delivered) tap_->tap->remove();
        return false;
    });
    tapKey(54);
    EXPECT_EQ(target->awaitText("bca"), "bca") << "the session ended before the key was told";
    EXPECT_EQ(takeHeard(1).size(), 1U);
    method.outcome = InputMethod::Outcome{.text = u"d"};
    tap_->run([this] { tap_->tap->inputMethodTold(); });
    EXPECT_TRUE(method.isIdle()) << "nothing is kept for later";
}

TEST_F(X11TapTest, ComesBackAfterItsConnectionWasEndedAndMakesUpForWhatItMissed) {
    const auto target = rig_->startTarget(TargetKind::GtkTextView);
    createTap();
    std::vector<xcb_window_t> windows;
    tap_->run([&] {
        windows.push_back(tap_->connection->window());
        tap_->connection->setReopenedListener([&](xcb_window_t window) { windows.push_back(window); });
    });
    rig_->keyboard().press(Key::LeftControl);
    EXPECT_EQ(takeHeard(1).front(), (Heard{Type::FlagsChanged, KeyCode::Control, EventFlag::Control, u""}));
    await("Control is down", [] { return keysDown() == std::vector<int>{37}; });
    xcb_kill_client(rig_->client().connection(), windows.front());
    rig_->client().focusedWindow();
    await("the tap is told", [&] { return tap_->run([this] { return listener_.timeouts == 1; }); });
    rig_->keyboard().releaseAll();
    await("all keys are up", [] { return keysDown().empty(); });
    tap_->run([this] { tap_->tap->enable(); });
    tapKey(38);
    const auto all = takeHeard(3);
    EXPECT_EQ(all.at(0), (Heard{Type::FlagsChanged, KeyCode::Control, {}, u""}));
    EXPECT_EQ(all.at(1), (Heard{Type::KeyDown, KeyCode::A, {}, u"a"}));
    EXPECT_EQ(target->awaitText("a"), "a");
    tap_->run([&] {
        EXPECT_EQ(windows.size(), 2U);
        EXPECT_EQ(windows.back(), tap_->connection->window());
        EXPECT_EQ(listener_.timeouts, 1);
        listener_.tapToEnable = tap_->tap.get();
    });
    xcb_kill_client(rig_->client().connection(), windows.back());
    rig_->client().focusedWindow();
    await("the tap is back at once", [&] { return tap_->run([&] { return windows.size() == 3; }); });
    tapKey(56);
    EXPECT_EQ(takeHeard(2).front(), (Heard{Type::KeyDown, KeyCode::B, {}, u"b"}));
    EXPECT_EQ(target->awaitText("ab"), "ab");
}

TEST_F(X11TapTest, SaysThatAnotherProgramHasTheKeyboard) {
    TapThread other(rig_->server().display());
    Listener listener;
    EXPECT_TRUE(other.run([&] { return other.tap->create(listener, false); }).ok());
    const auto refused = tap_->run([this] { return tap_->tap->create(listener_, false); });
    ASSERT_FALSE(refused.ok());
    EXPECT_THAT(refused.error().message, testing::HasSubstr("\"test keyboard\""));
    EXPECT_THAT(refused.error().message, testing::HasSubstr("held by another program"));
    EXPECT_FALSE(tap_->run([this] { return tap_->tap->exists(); }));
    other.run([&] { other.tap->remove(); });
    createTap();
    EXPECT_TRUE(tap_->run([this] { return tap_->tap->check().ok(); }));
}

TEST(X11TapDisplayTest, NamesTheDisplayThatCannotBeOpened) {
    const auto nowhere = TapConnection::check(":99999");
    ASSERT_FALSE(nowhere.ok());
    EXPECT_THAT(nowhere.error().message, testing::HasSubstr(":99999"));
}

// A keyboard of the server. Switching it on and off is what plugging it in and out does to it.
class Device {
  public:
    Device(const std::string& display, std::string name) : client_(display), name_(std::move(name)) {
        auto connection = XcbConnection::open(display);
        if (!connection) throw RigError(connection.error().message);
        connection_ = std::move(connection).value();
        const auto version = xcb_input_xi_query_version(connection_->get(), 2, 2);
        own(xcb_input_xi_query_version_reply(connection_->get(), version, nullptr));
    }
    void set(bool on) {
        const std::array<std::uint8_t, 4> value{static_cast<std::uint8_t>(on ? 1 : 0)};  // xcb reads whole words
        xcb_input_xi_change_property(client_.connection(), now().id, XCB_PROP_MODE_REPLACE, 8,
                                     client_.atom("Device Enabled"), XCB_ATOM_INTEGER, 1, value.data());
        client_.focusedWindow();
    }
    std::uint16_t id() const { return now().id; }
    // It hangs on no master as long as somebody has taken it.
    bool isTaken() const { return now().type == XCB_INPUT_DEVICE_TYPE_FLOATING_SLAVE; }

  private:
    InputDevice now() const {
        for (InputDevice& device : inputDevices(*connection_)) {
            if (device.name == name_) return device;
        }
        throw RigError("there is no " + name_);
    }

    XClient client_;
    std::string name_;
    std::unique_ptr<XcbConnection> connection_;
};

TEST(X11TapHotplugTest, TakesKeyboardsThatComeAndReleasesWhatWentDownOnThoseThatGo) {
    XServer::Options options;
    options.secondKeyboard = true;
    DesktopRig rig(options);
    Device second(rig.server().display(), "second keyboard");
    second.set(false);
    const auto target = rig.startTarget(TargetKind::GtkTextView);
    Listener listener;
    TapThread tap(rig.server().display());
    ASSERT_TRUE(tap.run([&] { return tap.tap->create(listener, false); }).ok());
    second.set(true);
    rig.client().await("the keyboard is taken", Bound, [&] { return second.isTaken(); });
    InputTestSocket keys(rig.server().secondKeyboardSocket());
    for (const bool down : {true, false}) keys.sendKey(56, down);
    EXPECT_EQ(target->awaitText("b"), "b");
    rig.client().await("its release is heard", Bound,
                       [&] { return tap.run([&] { return listener.heard.size(); }) >= 2; });
    const auto heard = tap.run([&] { return listener.heard; });
    EXPECT_THAT(heard, testing::ElementsAre(Heard{Type::KeyDown, KeyCode::B, {}, u"b"},
                                            Heard{Type::KeyUp, KeyCode::B, {}, u"b"}));

    // Each has a layout of its own, and keeps it.
    const auto layout = [&](std::vector<std::string> arguments) {
        arguments.insert(arguments.begin(), "setxkbmap");
        EXPECT_EQ(rig.session().start(arguments, "x11-xkb-utils")->waitForExit(Bound), 0);
    };
    layout({"-device", std::to_string(second.id()), "de"});
    std::string expected = "b";
    const auto typeOnBoth = [&] {
        for (int i = 0; i < 2; ++i) {
            rig.keyboard().type("y");
            EXPECT_EQ(target->awaitText(expected += 'y'), expected);
            for (const bool down : {true, false}) keys.sendKey(29, down);
            EXPECT_EQ(target->awaitText(expected += 'z'), expected);
        }
    };
    typeOnBoth();
    EXPECT_THAT(tap.run([&] { return listener.heard.back(); }), (Heard{Type::KeyUp, KeyCode::Y, {}, u"z"}));
    tap.run([&] { tap.tap->remove(); });
    typeOnBoth();
    ASSERT_TRUE(tap.run([&] { return tap.tap->create(listener, false); }).ok());
    typeOnBoth();

    keys.sendKey(50, true);  // Shift
    keys.sync();
    second.set(false);
    rig.keyboard().type("c");
    EXPECT_EQ(target->awaitText(expected + "c"), expected + "c");
}

}  // namespace

}  // namespace plume::rig
