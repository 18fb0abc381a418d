// A keyboard layout as the X server has it: what each key produces, and how a character is typed.
//
// Immutable and shared: a changed layout is another XkbKeymap. Any thread.
#pragma once

#include <xcb/xcb.h>
#include <xkbcommon/xkbcommon.h>

#include <array>
#include <bitset>
#include <cstdint>
#include <memory>
#include <optional>
#include <unordered_map>
#include <vector>

#include "Foundation/KeyCode.h"

namespace plume {

struct XkbUnref {
    void operator()(xkb_context* context) const { xkb_context_unref(context); }
    void operator()(xkb_keymap* keymap) const { xkb_keymap_unref(keymap); }
    void operator()(xkb_state* state) const { xkb_state_unref(state); }
};
template <typename Type>
using XkbOwned = std::unique_ptr<Type, XkbUnref>;

using KeycodeSet = std::bitset<256>;

// How a character is typed: this key while these real modifiers (XCB_MOD_MASK_…), and of Shift, Lock and the level
// choosers no others, are in force.
struct XkbStroke {
    xcb_keycode_t keycode = 0;
    std::uint8_t modifiers = 0;
};

class XkbKeymap {
  public:
    // `foreign`: key codes whose symbols are no part of the layout, because Plume itself put them there.
    XkbKeymap(XkbOwned<xkb_keymap> keymap, const KeycodeSet& foreign);

    xkb_keymap* get() const { return keymap_.get(); }

    // In the given group (layout of the keymap); the strokes with the fewest modifiers. '\n' is Return.
    std::optional<XkbStroke> strokeFor(char32_t character, xkb_layout_index_t group) const;
    // The key that puts a single real modifier into force while it is held; 0 when there is none.
    xcb_keycode_t keyOfModifier(std::uint8_t modifier) const;
    // The key that does what the virtual key of this code does: for keys that print nothing the one that has the
    // symbol wherever the user put it, otherwise the key at its place. 0 when there is none.
    xcb_keycode_t keycodeOf(KeyCode virtualKey) const;
    // The other way round, for a key with this symbol now.
    static KeyCode virtualKeyOf(xcb_keycode_t keycode, xkb_keysym_t symbol);

    // Key codes without any symbol, ascending: free to be given symbols.
    const std::vector<xcb_keycode_t>& spareKeycodes() const { return spares_; }
    // Real modifiers that each key holds down (not locks).
    std::uint8_t modifiersOf(xcb_keycode_t keycode) const { return modifiersOf_[keycode]; }
    // Whether some key starts a composed character.
    bool hasComposingKeys() const { return composing_; }

    // Equal for keymaps that produce the same, whatever lies on the spare and foreign key codes.
    std::uint64_t fingerprint() const { return fingerprint_; }

  private:
    void addKey(xcb_keycode_t keycode);
    void addStrokes(xcb_keycode_t keycode, xkb_layout_index_t group);
    void findModifierKeys();

    XkbOwned<xkb_keymap> keymap_;
    std::vector<std::unordered_map<char32_t, XkbStroke>> strokes_;  // by group
    std::unordered_map<KeyCode, xcb_keycode_t> keyOfFunction_;
    std::array<std::uint8_t, 256> modifiersOf_{};
    std::array<xcb_keycode_t, 8> keyOfModifier_{};
    std::vector<xcb_keycode_t> spares_;
    bool composing_ = false;
    std::uint64_t fingerprint_ = 0;
};

}  // namespace plume
