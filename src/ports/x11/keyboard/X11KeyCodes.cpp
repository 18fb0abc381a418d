#include "ports/x11/keyboard/X11KeyCodes.h"

#include <array>

namespace plume {

namespace {

// X key codes are the key codes of Linux input devices, shifted past what the core protocol cannot carry.
constexpr unsigned Shifted = 8;

constexpr unsigned FirstForeign = numberOf(foreignKeyCode(0));

struct Place {
    KeyCode virtualKey;
    std::uint8_t linuxKey;
};

constexpr auto Places = std::to_array<Place>({
    {KeyCode::A, 30},
    {KeyCode::S, 31},
    {KeyCode::D, 32},
    {KeyCode::F, 33},
    {KeyCode::H, 35},
    {KeyCode::G, 34},
    {KeyCode::Z, 44},
    {KeyCode::X, 45},
    {KeyCode::C, 46},
    {KeyCode::V, 47},
    {KeyCode::B, 48},
    {KeyCode::Q, 16},
    {KeyCode::W, 17},
    {KeyCode::E, 18},
    {KeyCode::R, 19},
    {KeyCode::Y, 21},
    {KeyCode::T, 20},
    {KeyCode::O, 24},
    {KeyCode::U, 22},
    {KeyCode::I, 23},
    {KeyCode::P, 25},
    {KeyCode::L, 38},
    {KeyCode::J, 36},
    {KeyCode::K, 37},
    {KeyCode::N, 49},
    {KeyCode::M, 50},
    {KeyCode::Digit1, 2},
    {KeyCode::Digit2, 3},
    {KeyCode::Digit3, 4},
    {KeyCode::Digit4, 5},
    {KeyCode::Digit6, 7},
    {KeyCode::Digit5, 6},
    {KeyCode::Digit9, 10},
    {KeyCode::Digit7, 8},
    {KeyCode::Digit8, 9},
    {KeyCode::Digit0, 11},
    {KeyCode::Equal, 13},
    {KeyCode::Minus, 12},
    {KeyCode::RightBracket, 27},
    {KeyCode::LeftBracket, 26},
    {KeyCode::Quote, 40},
    {KeyCode::Semicolon, 39},
    {KeyCode::Backslash, 43},
    {KeyCode::Comma, 51},
    {KeyCode::Slash, 53},
    {KeyCode::Period, 52},
    {KeyCode::Grave, 41},
    {KeyCode::Section, 86},
    {KeyCode::Return, 28},
    {KeyCode::Tab, 15},
    {KeyCode::Space, 57},
    {KeyCode::Delete, 14},
    {KeyCode::Escape, 1},
    {KeyCode::RightCommand, 126},
    {KeyCode::Command, 125},
    {KeyCode::Shift, 42},
    {KeyCode::CapsLock, 58},
    {KeyCode::Option, 56},
    {KeyCode::Control, 29},
    {KeyCode::RightShift, 54},
    {KeyCode::RightOption, 100},
    {KeyCode::RightControl, 97},
    {KeyCode::KeypadDecimal, 83},
    {KeyCode::KeypadMultiply, 55},
    {KeyCode::KeypadPlus, 78},
    {KeyCode::KeypadClear, 69},
    {KeyCode::KeypadDivide, 98},
    {KeyCode::KeypadEnter, 96},
    {KeyCode::KeypadMinus, 74},
    {KeyCode::KeypadEqual, 117},
    {KeyCode::Keypad0, 82},
    {KeyCode::Keypad1, 79},
    {KeyCode::Keypad2, 80},
    {KeyCode::Keypad3, 81},
    {KeyCode::Keypad4, 75},
    {KeyCode::Keypad5, 76},
    {KeyCode::Keypad6, 77},
    {KeyCode::Keypad7, 71},
    {KeyCode::Keypad8, 72},
    {KeyCode::Keypad9, 73},
    {KeyCode::KeypadComma, 121},
    {KeyCode::F1, 59},
    {KeyCode::F2, 60},
    {KeyCode::F3, 61},
    {KeyCode::F4, 62},
    {KeyCode::F5, 63},
    {KeyCode::F6, 64},
    {KeyCode::F7, 65},
    {KeyCode::F8, 66},
    {KeyCode::F9, 67},
    {KeyCode::F10, 68},
    {KeyCode::F11, 87},
    {KeyCode::F12, 88},
    {KeyCode::F13, 183},
    {KeyCode::F14, 184},
    {KeyCode::F15, 185},
    {KeyCode::F16, 186},
    {KeyCode::F17, 187},
    {KeyCode::F18, 188},
    {KeyCode::F19, 189},
    {KeyCode::F20, 190},
    {KeyCode::Help, 110},
    {KeyCode::Home, 102},
    {KeyCode::PageUp, 104},
    {KeyCode::ForwardDelete, 111},
    {KeyCode::End, 107},
    {KeyCode::PageDown, 109},
    {KeyCode::Left, 105},
    {KeyCode::Right, 106},
    {KeyCode::Down, 108},
    {KeyCode::Up, 103},
    {KeyCode::Menu, 127},
    {KeyCode::VolumeUp, 115},
    {KeyCode::VolumeDown, 114},
    {KeyCode::Mute, 113},
    {KeyCode::Yen, 124},
    {KeyCode::Underscore, 89},
    {KeyCode::Eisu, 94},
    {KeyCode::Kana, 92},
});

struct Tables {
    std::array<KeyCode, 256> virtualKeys{};
    std::array<xcb_keycode_t, FirstForeign> keycodes{};
};

constexpr Tables makeTables() {
    Tables tables;
    for (unsigned i = 0; i < tables.virtualKeys.size(); ++i) {
        tables.virtualKeys[i] = foreignKeyCode(static_cast<xcb_keycode_t>(i));
    }
    for (const Place& place : Places) {
        const unsigned keycode = place.linuxKey + Shifted;
        tables.virtualKeys[keycode] = place.virtualKey;
        tables.keycodes[numberOf(place.virtualKey)] = static_cast<xcb_keycode_t>(keycode);
    }
    return tables;
}

constexpr Tables Both = makeTables();

}  // namespace

KeyCode virtualKeyAt(xcb_keycode_t keycode) {
    return Both.virtualKeys[keycode];
}

xcb_keycode_t placeOfVirtualKey(KeyCode keyCode) {
    const unsigned number = numberOf(keyCode);
    if (number < FirstForeign) return Both.keycodes[number];
    const unsigned keycode = number - FirstForeign;
    return keycode < 256 ? static_cast<xcb_keycode_t>(keycode) : xcb_keycode_t{0};
}

}  // namespace plume
