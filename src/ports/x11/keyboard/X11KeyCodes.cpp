#include "ports/x11/keyboard/X11KeyCodes.h"

#include <array>

namespace plume {

namespace {

// X key codes are the key codes of Linux input devices, shifted past what the core protocol cannot carry.
constexpr unsigned Shifted = 8;

struct Place {
    std::uint8_t virtualKey;
    std::uint8_t linuxKey;
};

constexpr auto Places = std::to_array<Place>({
    // Letters, by what a US keyboard prints: a s d f h g z x c v b q w e r y t o u i p l j k n m
    {0, 30},
    {1, 31},
    {2, 32},
    {3, 33},
    {4, 35},
    {5, 34},
    {6, 44},
    {7, 45},
    {8, 46},
    {9, 47},
    {11, 48},
    {12, 16},
    {13, 17},
    {14, 18},
    {15, 19},
    {16, 21},
    {17, 20},
    {31, 24},
    {32, 22},
    {34, 23},
    {35, 25},
    {37, 38},
    {38, 36},
    {40, 37},
    {45, 49},
    {46, 50},
    // Digits: 1 2 3 4 6 5 9 7 8 0
    {18, 2},
    {19, 3},
    {20, 4},
    {21, 5},
    {22, 7},
    {23, 6},
    {25, 10},
    {26, 8},
    {28, 9},
    {29, 11},
    // Punctuation: = - ] [ ' ; \ , / . ` and the key that European keyboards have beside the left Shift
    {24, 13},
    {27, 12},
    {30, 27},
    {33, 26},
    {39, 40},
    {41, 39},
    {42, 43},
    {43, 51},
    {44, 53},
    {47, 52},
    {50, 41},
    {10, 86},
    // Return, Tab, Space, Backspace, Escape
    {36, 28},
    {48, 15},
    {49, 57},
    {51, 14},
    {53, 1},
    // Modifiers: Command right and left, Shift, Caps Lock, Option, Control, Shift, Option and Control on the right
    {54, 126},
    {55, 125},
    {56, 42},
    {57, 58},
    {58, 56},
    {59, 29},
    {60, 54},
    {61, 100},
    {62, 97},
    // Keypad: . * + Clear (Num Lock) / Enter - = 0 to 9 ,
    {65, 83},
    {67, 55},
    {69, 78},
    {71, 69},
    {75, 98},
    {76, 96},
    {78, 74},
    {81, 117},
    {82, 82},
    {83, 79},
    {84, 80},
    {85, 81},
    {86, 75},
    {87, 76},
    {88, 77},
    {89, 71},
    {91, 72},
    {92, 73},
    {95, 121},
    // F1 to F20
    {122, 59},
    {120, 60},
    {99, 61},
    {118, 62},
    {96, 63},
    {97, 64},
    {98, 65},
    {100, 66},
    {101, 67},
    {109, 68},
    {103, 87},
    {111, 88},
    {105, 183},
    {107, 184},
    {113, 185},
    {106, 186},
    {64, 187},
    {79, 188},
    {80, 189},
    {90, 190},
    // Help (Insert), Home, Page Up, Delete, End, Page Down, Left, Right, Down, Up, Menu
    {114, 110},
    {115, 102},
    {116, 104},
    {117, 111},
    {119, 107},
    {121, 109},
    {123, 105},
    {124, 106},
    {125, 108},
    {126, 103},
    {110, 127},
    // Louder, quieter, mute; Japanese: yen, underscore, Eisu, Kana
    {72, 115},
    {73, 114},
    {74, 113},
    {93, 124},
    {94, 89},
    {102, 94},
    {104, 92},
});

struct Tables {
    std::array<std::uint16_t, 256> virtualKeys{};
    std::array<xcb_keycode_t, FirstForeignKeyCode> keycodes{};
};

constexpr Tables makeTables() {
    Tables tables;
    for (unsigned i = 0; i < tables.virtualKeys.size(); ++i) {
        tables.virtualKeys[i] = static_cast<std::uint16_t>(FirstForeignKeyCode + i);
    }
    for (const Place& place : Places) {
        const unsigned keycode = place.linuxKey + Shifted;
        tables.virtualKeys[keycode] = place.virtualKey;
        tables.keycodes[place.virtualKey] = static_cast<xcb_keycode_t>(keycode);
    }
    return tables;
}

constexpr Tables Both = makeTables();

}  // namespace

std::uint16_t virtualKeyAt(xcb_keycode_t keycode) {
    return Both.virtualKeys[keycode];
}

xcb_keycode_t placeOfVirtualKey(std::uint16_t keyCode) {
    if (keyCode < FirstForeignKeyCode) return Both.keycodes[keyCode];
    const unsigned keycode = keyCode - FirstForeignKeyCode;
    return keycode < 256 ? static_cast<xcb_keycode_t>(keycode) : xcb_keycode_t{0};
}

}  // namespace plume
