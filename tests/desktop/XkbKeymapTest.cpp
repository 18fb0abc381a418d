// What the layout of a keyboard says, without a keyboard.

#include "ports/x11/keyboard/XkbKeymap.h"

#include <gtest/gtest.h>

#include "ports/x11/keyboard/X11KeyCodes.h"

namespace plume {

namespace {

XkbKeymap keymapOf(const char* layout, const char* variant = "", const char* options = "",
                   const KeycodeSet& foreign = {}) {
    const XkbOwned<xkb_context> context(xkb_context_new(XKB_CONTEXT_NO_FLAGS));
    const xkb_rule_names names{"evdev", "pc105", layout, variant, options};
    return {XkbOwned<xkb_keymap>(xkb_keymap_new_from_names(context.get(), &names, XKB_KEYMAP_COMPILE_NO_FLAGS)),
            foreign};
}

constexpr std::uint8_t Shift = XCB_MOD_MASK_SHIFT;
constexpr std::uint8_t LevelThree = XCB_MOD_MASK_5;

struct Typed {
    const char* layout;
    char32_t character;
    int keycode;
    int modifiers;
    unsigned group = 0;
};

TEST(XkbKeymapTest, CharactersAreTypedWithTheFewestModifiers) {
    const Typed cases[] = {
        {"us", U'a', 38, 0},
        {"us", U'A', 38, Shift},
        {"us", U'1', 10, 0},  // not the keypad's
        {"us", U'<', 94, 0},
        {"us", U'\n', 36, 0},
        {"us", U'\t', 23, 0},
        {"de", U'z', 29, 0},
        {"de", U'<', 94, 0},
        {"de", U'@', 24, LevelThree},
        {"de", U'\u00E4', 48, 0},
        {"fr", U'1', 10, Shift},
        {"us,de", U'z', 52, 0},
        {"us,de", U'z', 29, 0, 1},
        {"us,ru", U'\u0434', 46, 0, 1},
    };
    for (const Typed& one : cases) {
        const auto stroke = keymapOf(one.layout).strokeFor(one.character, one.group);
        ASSERT_TRUE(stroke.has_value()) << one.layout << ' ' << static_cast<unsigned>(one.character);
        EXPECT_EQ(stroke->keycode, one.keycode) << one.layout << ' ' << static_cast<unsigned>(one.character);
        EXPECT_EQ(stroke->modifiers, one.modifiers) << one.layout << ' ' << static_cast<unsigned>(one.character);
    }
}

TEST(XkbKeymapTest, CharactersOnNoKeyHaveNoStroke) {
    EXPECT_FALSE(keymapOf("us").strokeFor(U'\u65E5', 0).has_value());
    EXPECT_FALSE(keymapOf("us,ru").strokeFor(U'\u0434', 0).has_value());
    EXPECT_FALSE(keymapOf("us").strokeFor(U'\b', 0).has_value());
}

TEST(XkbKeymapTest, KeysAreWhatTheUserMadeOfThem) {
    const auto swapped = keymapOf("us", "", "caps:swapescape");
    EXPECT_EQ(swapped.keycodeOf(KeyCode::Escape), 66);
    EXPECT_EQ(swapped.keycodeOf(KeyCode::CapsLock), 9);
    EXPECT_EQ(XkbKeymap::virtualKeyOf(66, XKB_KEY_Escape), KeyCode::Escape);
    const auto control = keymapOf("us", "", "ctrl:nocaps");
    EXPECT_EQ(control.keycodeOf(KeyCode::CapsLock), 0) << "there is no Caps Lock left";
    EXPECT_EQ(control.keycodeOf(KeyCode::Control), 37);
    EXPECT_EQ(XkbKeymap::virtualKeyOf(66, XKB_KEY_Control_L), KeyCode::Control);
    EXPECT_EQ(XkbKeymap::virtualKeyOf(66, XKB_KEY_a), foreignKeyCode(66)) << "no longer Caps Lock";
}

TEST(XkbKeymapTest, ModifiersHaveKeys) {
    const auto german = keymapOf("de");
    EXPECT_EQ(german.keyOfModifier(Shift), 50);
    EXPECT_EQ(german.keyOfModifier(XCB_MOD_MASK_CONTROL), 37);
    EXPECT_EQ(german.keyOfModifier(XCB_MOD_MASK_1), 64);
    EXPECT_EQ(german.keyOfModifier(XCB_MOD_MASK_4), 133);
    EXPECT_EQ(german.modifiersOf(german.keyOfModifier(LevelThree)), LevelThree);
    EXPECT_EQ(german.keyOfModifier(XCB_MOD_MASK_LOCK), 0) << "it locks, it is not held";
    EXPECT_EQ(german.modifiersOf(38), 0);
    EXPECT_EQ(german.modifiersOf(62), Shift);
}

TEST(XkbKeymapTest, ForeignKeysAreNoPartOfTheLayout) {
    const auto german = keymapOf("de");
    KeycodeSet foreign;
    foreign.set(48);  // the only one for U+00E4
    const auto without = keymapOf("de", "", "", foreign);
    EXPECT_FALSE(without.strokeFor(U'\u00E4', 0).has_value());
    EXPECT_EQ(without.spareKeycodes().size(), german.spareKeycodes().size() + 1);
    EXPECT_NE(without.fingerprint(), german.fingerprint());
    EXPECT_EQ(german.fingerprint(), keymapOf("de").fingerprint());
    EXPECT_NE(german.fingerprint(), keymapOf("de", "nodeadkeys").fingerprint());
}

TEST(XkbKeymapTest, OnlyDeadAndComposeKeysCompose) {
    EXPECT_FALSE(keymapOf("us").hasComposingKeys());
    EXPECT_TRUE(keymapOf("de").hasComposingKeys());
    EXPECT_TRUE(keymapOf("us", "", "compose:ralt").hasComposingKeys());
}

TEST(X11KeyCodesTest, EveryKeyHasOneCodeAndBack) {
    for (unsigned keycode = 8; keycode < 256; ++keycode) {
        const auto key = static_cast<xcb_keycode_t>(keycode);
        EXPECT_EQ(placeOfVirtualKey(virtualKeyAt(key)), key);
    }
    EXPECT_EQ(placeOfVirtualKey(KeyCode::None), 0);
    EXPECT_EQ(placeOfVirtualKey(KeyCode{127}), 0);
}

}  // namespace

}  // namespace plume
