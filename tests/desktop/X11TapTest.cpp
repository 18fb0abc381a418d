// The keyboard tap of X11 between a keyboard and real programs.

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <xcb/xinput.h>

#include <algorithm>
#include <array>
#include <atomic>
#include <chrono>
#include <functional>
#include <memory>
#include <optional>
#include <ostream>
#include <random>
#include <string>
#include <utility>
#include <vector>

#include "Foundation/Strings.h"
#include "ports/x11/keyboard/InputDevices.h"
#include "ports/x11/keyboard/TapConnection.h"
#include "ports/x11/keyboard/X11InputSources.h"
#include "ports/x11/keyboard/X11KeyboardTap.h"
#include "ports/x11/keyboard/XcbXkb.h"
#include "ports/x11/keyboard/XkbKeyboard.h"
#include "testing/rig/Deadline.h"
#include "testing/rig/DesktopRig.h"
#include "testing/rig/FocusCounter.h"
#include "testing/rig/SessionThread.h"
#include "testing/rig/XcbReply.h"

namespace plume::rig {

namespace {

using Type = TapEvent::Type;

constexpr Milliseconds Bound{10'000};

struct Heard {
    Type type = Type::KeyDown;
    KeyCode keyCode = KeyCode::None;
    EventFlags flags;
    std::u16string string;
    bool composing = false;
    bool command = false;

    bool operator==(const Heard&) const = default;
    friend std::ostream& operator<<(std::ostream& out, const Heard& heard) {
        constexpr std::array<const char*, 3> Names{"down", "up", "flags"};
        out << Names[static_cast<std::size_t>(heard.type)] << ' ' << numberOf(heard.keyCode) << ' ' << std::hex
            << heard.flags.bits();
        for (const char16_t unit : heard.string) out << " U+" << static_cast<unsigned>(unit);
        return out << std::dec << (heard.composing ? " composing" : "") << (heard.command ? " command" : "");
    }
};

// Writes down what it hears and does as it is told. Tap thread.
class Listener final : public KeyboardTapListener {
  public:
    bool keyboardEvent(const TapEvent& event) override {
        heard.push_back(
            {event.type, event.keyCode, event.flags, std::u16string(event.string), event.composing, event.command});
        return decide && decide(event);
    }
    void tapDisabledByTimeout() override { ++timeouts; }
    void tapDisabledByUserInput() override { ADD_FAILURE() << "nobody did that"; }
    void keysWithheld() override { ++withheld; }

    std::vector<Heard> heard;
    std::function<bool(const TapEvent&)> decide;
    int timeouts = 0;
    int withheld = 0;
};

// Plume's ears on a rig's display. All of it is used inside run().
class TapThread : public SessionThread {
  public:
    explicit TapThread(const std::string& display) : SessionThread(display) {
        run([&] {
            keyboard = valueOrThrow(XkbKeyboard::open(session().connection()));
            keyboard->listenTo(session());
            inputSources = std::make_unique<X11InputSources>(*keyboard);
            connection = valueOrThrow(TapConnection::open(display, *keyboard));
            tap = std::make_unique<X11KeyboardTap>(loop(), *connection, *keyboard);
        });
    }
    ~TapThread() {
        run([this] { tap->remove(); });
        end();
    }

    std::unique_ptr<XkbKeyboard> keyboard;
    std::unique_ptr<X11InputSources> inputSources;
    std::unique_ptr<TapConnection> connection;
    std::unique_ptr<X11KeyboardTap> tap;
};

class X11TapTest : public testing::Test {
  protected:
    static void SetUpTestSuite() {
        rig_ = std::make_unique<DesktopRig>();
        rig_->keyboard().tap(Key::LeftShift);  // only a device that was used answers when asked to sync
    }
    static void TearDownTestSuite() { rig_.reset(); }

    void SetUp() override { tap_ = std::make_unique<TapThread>(rig_->server().display()); }
    void TearDown() override {
        rig_->keyboard().releaseAll();
        tap_.reset();
        EXPECT_EQ(keysDown(), std::vector<int>{}) << "what was pressed has to come up";
        if (layoutChanged_) setLayout({"us", "-option", ""});
    }

    void createTap() {
        const auto created = tap_->run([this] { return tap_->tap->create(listener_, false); });
        ASSERT_TRUE(created.ok()) << created.error().message;
    }
    void removeTap() {
        tap_->run([this] { tap_->tap->remove(); });
    }
    void setDecision(std::function<bool(const TapEvent&)> decide) {
        tap_->run([&] { listener_.decide = std::move(decide); });
    }
    std::vector<Heard> heard() {
        return tap_->run([this] { return listener_.heard; });
    }
    std::vector<Heard> takeHeard(std::size_t count) {
        await("keys are heard", [&] { return heard().size() >= count; });
        return tap_->run([this] { return std::exchange(listener_.heard, {}); });
    }
    static void await(const std::string& what, const std::function<bool()>& condition) {
        rig_->client().await(what, Bound, condition);
    }

    void setLayout(const std::vector<std::string>& arguments) {
        layoutChanged_ = true;
        std::vector<std::string> command{"setxkbmap"};
        command.insert(command.end(), arguments.begin(), arguments.end());
        const auto program = rig_->session().start(command, "x11-xkb-utils");
        ASSERT_EQ(program->waitForExit(Bound), 0) << program->logTail();
    }
    std::string identifier() {
        const auto name = tap_->run([this] { return tap_->inputSources->currentInputSourceIdentifier(); });
        return name ? toUtf8(*name) : "";
    }
    std::optional<std::u16string> translate(KeyCode keyCode, EventFlags flags) {
        return tap_->run([=, this] { return tap_->inputSources->translateKey(keyCode, flags); });
    }

    static void tapKey(int keycode) {
        rig_->keyboard().press(keycode);
        rig_->keyboard().release(keycode);
        rig_->keyboard().sync();
    }

    // On the main keyboard, as programs see it.
    static std::vector<int> keysDown() { return rig_->client().keysDown(); }

    static inline std::unique_ptr<DesktopRig> rig_;
    Listener listener_;  // outlives the tap
    std::unique_ptr<TapThread> tap_;
    bool layoutChanged_ = false;
};

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

TEST_F(X11TapTest, CapsLockLocks) {
    const auto target = rig_->startTarget(TargetKind::GtkTextView);
    createTap();
    rig_->keyboard().tap(Key::CapsLock);
    rig_->keyboard().type("a");
    rig_->keyboard().tap(Key::CapsLock);
    rig_->keyboard().type("b");
    EXPECT_EQ(target->awaitText("Ab"), "Ab");
    constexpr EventFlag Locked = EventFlag::CapsLock;
    const auto all = takeHeard(8);
    EXPECT_EQ(all.at(2), (Heard{Type::KeyDown, KeyCode::A, Locked, u"A"}));
    EXPECT_EQ(all.at(6), (Heard{Type::KeyDown, KeyCode::B, {}, u"b"}));
}

TEST_F(X11TapTest, FollowsTheLayout) {
    const auto target = rig_->startTarget(TargetKind::QtTextEdit);
    createTap();
    EXPECT_EQ(identifier(), "us");
    EXPECT_EQ(translate(KeyCode::Y, {}), u"y");
    EXPECT_EQ(translate(KeyCode::Y, EventFlag::Shift), u"Y");
    EXPECT_EQ(translate(KeyCode::Y, EventFlag::Option), std::nullopt);
    EXPECT_EQ(translate(KeyCode::Keypad1, {}), u"1") << "on the keypad";
    EXPECT_EQ(translate(KeyCode::Delete, EventFlag::Option), u"\b");

    setLayout({"de"});
    await("the layout is de", [&] { return identifier() == "de"; });
    EXPECT_EQ(translate(KeyCode::Y, {}), u"z");
    EXPECT_EQ(translate(KeyCode::Equal, {}), std::nullopt) << "a dead key";
    tapKey(29);
    EXPECT_EQ(target->awaitText("z"), "z");
    EXPECT_EQ(takeHeard(2).front(), (Heard{Type::KeyDown, KeyCode::Y, {}, u"z"}));
    rig_->keyboard().press(Key::AltGr);
    tapKey(24);
    rig_->keyboard().releaseAll();
    EXPECT_EQ(target->awaitText("z@"), "z@");
    EXPECT_EQ(takeHeard(2).front(), (Heard{Type::KeyDown, KeyCode::Q, {}, u"@"})) << "AltGr is not told of";

    removeTap();
    tapKey(29);
    EXPECT_EQ(target->awaitText("z@z"), "z@z") << "the keyboard itself has to have the new layout, too";
    createTap();
    setLayout({"de", "-variant", "nodeadkeys"});
    await("the variant is told", [&] { return identifier() == "de(nodeadkeys)"; });
    EXPECT_EQ(translate(KeyCode::Equal, {}), u"\u00B4");
}

TEST_F(X11TapTest, FollowsTheGroup) {
    const auto target = rig_->startTarget(TargetKind::GtkTextView);
    createTap();
    setLayout({"-layout", "us,de", "-option", "grp:menu_toggle"});
    await("both layouts are there",
          [&] { return tap_->run([this] { return xkb_keymap_num_layouts(tap_->keyboard->keymap()->get()) == 2; }); });
    EXPECT_EQ(identifier(), "us");
    tapKey(135);  // switches
    tapKey(29);
    EXPECT_EQ(target->awaitText("z"), "z");
    await("the other layout is named", [&] { return identifier() == "de"; });
    const auto all = heard();
    EXPECT_THAT(all, testing::Contains(Heard{Type::KeyDown, KeyCode::Y, {}, u"z"}));

    // A program that switches layouts does it so.
    XClient switcher(rig_->server().display());
    const auto use = xcb_xkb_use_extension(switcher.connection(), 1, 0);
    own(xcb_xkb_use_extension_reply(switcher.connection(), use, nullptr));
    xcb_xkb_latch_lock_state(switcher.connection(), XCB_XKB_ID_USE_CORE_KBD, 0, 0, 1, 0, 0, 0, 0);
    switcher.focusedWindow();
    await("the first layout is back", [&] { return identifier() == "us"; });
    takeHeard(2);
    tapKey(29);
    EXPECT_EQ(target->awaitText("zy"), "zy");
    EXPECT_EQ(takeHeard(2).front(), (Heard{Type::KeyDown, KeyCode::Y, {}, u"y"}));
}

TEST_F(X11TapTest, Composes) {
    struct Case {
        std::vector<std::string> layout;
        std::vector<int> keycodes;
        std::vector<Heard> downs;
        std::string text;
    };
    const Case cases[] = {
        {{"de"},  // dead acute, e, e
         {21, 26, 26},
         {{Type::KeyDown, KeyCode::Equal, {}, u"", true},
          {Type::KeyDown, KeyCode::E, {}, u"\u00E9"},
          {Type::KeyDown, KeyCode::E, {}, u"e"}},
         "ée"},
        {{"us", "-option", "compose:ralt"},  // Compose, which Apple keyboards do not have, comma, c, c
         {108, 59, 54, 54},
         {{Type::KeyDown, KeyCode{364}, {}, u"", true},
          {Type::KeyDown, KeyCode::Comma, {}, u"", true},
          {Type::KeyDown, KeyCode::C, {}, u"\u00E7"},
          {Type::KeyDown, KeyCode::C, {}, u"c"}},
         "çc"}};
    const auto target = rig_->startTarget(TargetKind::Xterm);
    createTap();
    for (const Case& each : cases) {
        setLayout(each.layout);
        await("the layout composes", [&] {
            return identifier() == each.layout.front() &&
                   tap_->run([this] { return tap_->keyboard->keymap()->hasComposingKeys(); });
        });
        for (const int keycode : each.keycodes) tapKey(keycode);
        auto all = takeHeard(2 * each.keycodes.size());
        std::erase_if(all, [](const Heard& heard) { return heard.type == Type::KeyUp; });
        EXPECT_EQ(all, each.downs);
        EXPECT_EQ(target->awaitText(each.text), each.text);
        target->clear();
        setLayout({"us", "-option", ""});
    }
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
    tap_->run([&] { tap_->tap->setFocusIsPassword([&] { return password.load(); }); });
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
    });
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
    const auto heard = tap.run([&] { return listener.heard; });
    EXPECT_THAT(heard, testing::ElementsAre(Heard{Type::KeyDown, KeyCode::B, {}, u"b"},
                                            Heard{Type::KeyUp, KeyCode::B, {}, u"b"}));

    keys.sendKey(50, true);  // Shift
    keys.sync();
    second.set(false);
    rig.keyboard().type("c");
    EXPECT_EQ(target->awaitText("bc"), "bc");
}

TEST_F(X11TapTest, SymbolsOfItsOwnAreNoPartOfTheLayout) {
    constexpr xkb_keysym_t Own = 0x1006E00;
    struct KeymapChanges {
        int count = 0;
        void changed(const XkbKeyboard::Change& change) {
            if (change == XkbKeyboard::Change::Keymap) ++count;
        }
    } changes;
    Subscription counting;
    const auto spare = tap_->run([&] {
        counting = tap_->keyboard->changedEvent.addObserver(&changes, &KeymapChanges::changed);
        return tap_->keyboard->keymap()->spareKeycodes().back();
    });
    const auto write = [&](xcb_keycode_t keycode, std::vector<xcb_keysym_t> symbols) {
        xcb_change_keyboard_mapping(rig_->client().connection(), 1, keycode, static_cast<std::uint8_t>(symbols.size()),
                                    symbols.data());
        rig_->client().focusedWindow();
    };
    layoutChanged_ = true;  // to be undone
    tap_->run([&] { tap_->keyboard->willWrite(spare, std::array{Own}); });
    write(spare, {Own, Own});
    write(38, {XKB_KEY_q, XKB_KEY_Q});  // the user's change
    await("the layout has changed", [&] { return translate(KeyCode::A, {}) == u"q"; });
    tap_->run([&] {
        counting.end();
        EXPECT_EQ(changes.count, 1);
        EXPECT_FALSE(tap_->keyboard->keymap()->strokeFor(U'\u6E00', 0).has_value());
        EXPECT_THAT(tap_->keyboard->keymap()->spareKeycodes(), testing::Contains(spare));
        EXPECT_EQ(tap_->keyboard->keymap()->strokeFor(U'Q', 0)->keycode, 24) << "Q first of all where it was";
    });
}

}  // namespace

}  // namespace plume::rig
