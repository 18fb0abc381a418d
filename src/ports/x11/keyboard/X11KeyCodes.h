// X key codes and the virtual key codes of a US Apple keyboard, which is what Plume calls keys by.
//
// The table knows places on the keyboard, not what is printed on them: XkbKeymap knows the layout.
#pragma once

#include <xcb/xcb.h>

#include <cstdint>

#include "Foundation/KeyCode.h"

namespace plume {

// Keys that a US Apple keyboard has no code for (media keys and the like) have codes of their own, so that every key
// has one and none is mistaken for another.
constexpr KeyCode foreignKeyCode(xcb_keycode_t keycode) {
    constexpr std::uint16_t First = 256;
    return KeyCode{static_cast<std::uint16_t>(First + keycode)};
}

// The virtual key code of the key at this place.
KeyCode virtualKeyAt(xcb_keycode_t keycode);
// The X key code of the place of this key; 0 when there is no such key.
xcb_keycode_t placeOfVirtualKey(KeyCode keyCode);

}  // namespace plume
