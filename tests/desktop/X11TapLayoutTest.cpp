// What the keyboard tap of X11 hears with other layouts, groups, locks and Compose sequences.
#include <xkbcommon/xkbcommon-keysyms.h>

#include "ports/x11/keyboard/XcbXkb.h"
#include "testing/rig/XcbReply.h"
#include "tests/desktop/X11TapFixture.h"

namespace plume::rig {

namespace {

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
