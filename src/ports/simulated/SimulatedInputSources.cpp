#include "ports/simulated/SimulatedInputSources.h"

#include <array>

namespace plume {

namespace {

constexpr std::uint64_t ShiftFlag = 0x20000;
constexpr std::uint64_t ControlFlag = 0x40000;
constexpr std::uint64_t OptionFlag = 0x80000;

struct Key {
    std::uint16_t code;
    char16_t plain;
    char16_t shifted = plain;
    char16_t option = plain;  // what Option makes of it, where that matters
};

// Main keys before keypad keys, so that a character on both is typed on the main one.
constexpr auto Keys = std::to_array<Key>({
    {0, u'a', u'A'},
    {1, u's', u'S'},
    {2, u'd', u'D'},
    {3, u'f', u'F'},
    {4, u'h', u'H'},
    {5, u'g', u'G'},
    {6, u'z', u'Z'},
    {7, u'x', u'X'},
    {8, u'c', u'C'},
    {9, u'v', u'V'},
    {11, u'b', u'B'},
    {12, u'q', u'Q'},
    {13, u'w', u'W'},
    {14, u'e', u'E'},
    {15, u'r', u'R'},
    {16, u'y', u'Y'},
    {17, u't', u'T'},
    {18, u'1', u'!', u'\u00A1'},
    {19, u'2', u'@', u'\u2122'},
    {20, u'3', u'#', u'\u00A3'},
    {21, u'4', u'$', u'\u00A2'},
    {22, u'6', u'^', u'\u00A7'},
    {23, u'5', u'%', u'\u221E'},
    {24, u'=', u'+'},
    {25, u'9', u'(', u'\u00AA'},
    {26, u'7', u'&', u'\u00B6'},
    {27, u'-', u'_'},
    {28, u'8', u'*', u'\u2022'},
    {29, u'0', u')', u'\u00BA'},
    {30, u']', u'}'},
    {31, u'o', u'O'},
    {32, u'u', u'U'},
    {33, u'[', u'{'},
    {34, u'i', u'I'},
    {35, u'p', u'P'},
    {36, u'\r'},  // Return
    {37, u'l', u'L'},
    {38, u'j', u'J'},
    {39, u'\'', u'"'},
    {40, u'k', u'K'},
    {41, u';', u':'},
    {42, u'\\', u'|'},
    {43, u',', u'<'},
    {44, u'/', u'?'},
    {45, u'n', u'N'},
    {46, u'm', u'M'},
    {47, u'.', u'>'},
    {48, u'\t'},                  // Tab
    {49, u' ', u' ', u'\u00A0'},  // Space
    {50, u'`', u'~'},
    {51, u'\b'},    // Delete
    {53, u'\x1B'},  // Escape
    {65, u'.'},     // keypad from here
    {67, u'*'},
    {69, u'+'},
    {75, u'/'},
    {76, u'\x03'},  // Enter
    {78, u'-'},
    {81, u'='},
    {82, u'0'},
    {83, u'1'},
    {84, u'2'},
    {85, u'3'},
    {86, u'4'},
    {87, u'5'},
    {88, u'6'},
    {89, u'7'},
    {91, u'8'},
    {92, u'9'},
    {115, u'\x01'},  // Home
    {116, u'\x0B'},  // Page Up
    {117, u'\x7F'},  // Forward Delete
    {119, u'\x04'},  // End
    {121, u'\x0C'},  // Page Down
    {123, u'\x1C'},  // Left
    {124, u'\x1D'},  // Right
    {125, u'\x1F'},  // Down
    {126, u'\x1E'},  // Up
});

template <typename Condition>
const Key* findKey(Condition condition) {
    for (const Key& key : Keys) {
        if (condition(key)) return &key;
    }
    return nullptr;
}

char16_t unitOf(const Key& key, std::uint64_t flags) {
    if ((flags & ControlFlag) != 0 && key.plain >= u'a' && key.plain <= u'z') {
        return static_cast<char16_t>(key.plain & 0x1F);
    }
    if ((flags & OptionFlag) != 0) return key.option;
    return (flags & ShiftFlag) != 0 ? key.shifted : key.plain;
}

}  // namespace

void SimulatedInputSources::setIdentifier(std::optional<std::u16string> identifier) {
    identifier_ = std::move(identifier);
    if (listener_) listener_();
}

std::optional<SimulatedInputSources::Stroke> SimulatedInputSources::strokeFor(char16_t character) {
    const char16_t wanted = character == u'\n' ? u'\r' : character;
    const Key* key = findKey([&](const Key& k) { return k.plain == wanted || k.shifted == wanted; });
    if (!key) return std::nullopt;
    return Stroke{key->code, key->plain != wanted};
}

std::optional<std::u16string> SimulatedInputSources::translateKey(std::uint16_t keyCode, std::uint64_t flags) const {
    const Key* key = findKey([&](const Key& k) { return k.code == keyCode; });
    if (!key) return std::nullopt;
    return std::u16string(1, unitOf(*key, flags));
}

}  // namespace plume
