// Puts the keyboard into a neutral state for as long as this exists: nothing pressed, nothing locked.
//
// Keys that are down on the XTEST keyboard are released; the modifiers among them that the user still holds are pressed
// again at the end. A shift or a Caps Lock that is locked is unlocked and locked again; a latched modifier is spent.
// The group in force stays, and so does Num Lock, which only changes the keypad. Tap thread; waits for the
// server once.
#pragma once

#include <xcb/xcb.h>

#include <cstdint>
#include <vector>

#include "ports/x11/keyboard/TapConnection.h"
#include "ports/x11/keyboard/XkbKeymap.h"

namespace plume {

class NeutralKeyboard {
  public:
    // Both outlive it.
    NeutralKeyboard(TapConnection& connection, const XkbKeymap& keymap);
    ~NeutralKeyboard();
    NeutralKeyboard(const NeutralKeyboard&) = delete;
    NeutralKeyboard& operator=(const NeutralKeyboard&) = delete;

    // In force.
    xkb_layout_index_t group() const { return group_; }

  private:
    void releaseKeys();
    void readState();
    void lock(std::uint8_t modifiers, std::uint8_t spentLatches);

    TapConnection& connection_;
    const XkbKeymap& keymap_;
    std::vector<xcb_keycode_t> heldModifiers_;
    std::uint8_t lockedModifiers_ = 0;
    std::uint8_t latchedModifiers_ = 0;
    xkb_layout_index_t group_ = 0;
};

}  // namespace plume
