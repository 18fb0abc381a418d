// The keyboard as synthesised keys want it, for as long as this lives: nothing pressed, nothing locked.
//
// Keys that are down on the XTEST keyboard are released; the modifiers among them that the user still holds are pressed
// again at the end. A shift or a Caps Lock that is locked is unlocked and locked again; a latched modifier is spent.
// The group in force stays, and so does Num Lock, which only the keypad's keys mind. Tap thread; waits for the server
// once.
#pragma once

#include <xcb/xcb.h>

#include <cstdint>
#include <vector>

#include "ports/x11/keyboard/TapConnection.h"
#include "ports/x11/keyboard/XkbKeymap.h"

namespace plume {

class QuietKeyboard {
  public:
    // Both outlive it.
    QuietKeyboard(TapConnection& connection, const XkbKeymap& keymap);
    ~QuietKeyboard();
    QuietKeyboard(const QuietKeyboard&) = delete;
    QuietKeyboard& operator=(const QuietKeyboard&) = delete;

    // In force.
    xkb_layout_index_t group() const { return group_; }

  private:
    void releaseKeys();
    void readState();
    void lock(std::uint8_t modifiers, std::uint8_t spentLatches);
    void keepMenusClosed();

    TapConnection& connection_;
    const XkbKeymap& keymap_;
    std::vector<xcb_keycode_t> heldModifiers_;
    std::uint8_t lockedModifiers_ = 0;
    std::uint8_t latchedModifiers_ = 0;
    xkb_layout_index_t group_ = 0;
};

}  // namespace plume
