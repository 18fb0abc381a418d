// X key codes and the virtual key codes of a US Apple keyboard, which is what Plume calls keys by.
//
// The table knows places on the keyboard, not what is printed on them: XkbKeymap knows the layout.
#pragma once

#include <xcb/xcb.h>

#include <cstdint>

namespace plume {

// Event flag bits of the modifiers.
namespace X11Flag {
inline constexpr std::uint64_t CapsLock = 0x10000;
inline constexpr std::uint64_t Shift = 0x20000;
inline constexpr std::uint64_t Control = 0x40000;
inline constexpr std::uint64_t Option = 0x80000;
inline constexpr std::uint64_t Command = 0x100000;
}  // namespace X11Flag

// Keys that a US Apple keyboard has no code for (media keys and the like) have codes of their own from here on, so that
// every key has one and none is mistaken for another.
inline constexpr std::uint16_t FirstForeignKeyCode = 256;

// The virtual key code of the key at this place.
std::uint16_t virtualKeyAt(xcb_keycode_t keycode);
// The X key code of the place of this key; 0 when there is no such key.
xcb_keycode_t placeOfVirtualKey(std::uint16_t keyCode);

}  // namespace plume
