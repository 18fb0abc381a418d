#include "ports/simulated/SimulatedInputSources.h"

#include <array>

namespace plume {

namespace {

struct Key {
    KeyCode code;
    char16_t plain;
    char16_t shifted = plain;
    char16_t option = plain;  // what Option makes of it, where that matters
};

// Main keys before keypad keys, so that a character on both is typed on the main one.
constexpr auto Keys = std::to_array<Key>({
    {KeyCode::A, u'a', u'A'},
    {KeyCode::S, u's', u'S'},
    {KeyCode::D, u'd', u'D'},
    {KeyCode::F, u'f', u'F'},
    {KeyCode::H, u'h', u'H'},
    {KeyCode::G, u'g', u'G'},
    {KeyCode::Z, u'z', u'Z'},
    {KeyCode::X, u'x', u'X'},
    {KeyCode::C, u'c', u'C'},
    {KeyCode::V, u'v', u'V'},
    {KeyCode::B, u'b', u'B'},
    {KeyCode::Q, u'q', u'Q'},
    {KeyCode::W, u'w', u'W'},
    {KeyCode::E, u'e', u'E'},
    {KeyCode::R, u'r', u'R'},
    {KeyCode::Y, u'y', u'Y'},
    {KeyCode::T, u't', u'T'},
    {KeyCode::Digit1, u'1', u'!', u'\u00A1'},
    {KeyCode::Digit2, u'2', u'@', u'\u2122'},
    {KeyCode::Digit3, u'3', u'#', u'\u00A3'},
    {KeyCode::Digit4, u'4', u'$', u'\u00A2'},
    {KeyCode::Digit6, u'6', u'^', u'\u00A7'},
    {KeyCode::Digit5, u'5', u'%', u'\u221E'},
    {KeyCode::Equal, u'=', u'+'},
    {KeyCode::Digit9, u'9', u'(', u'\u00AA'},
    {KeyCode::Digit7, u'7', u'&', u'\u00B6'},
    {KeyCode::Minus, u'-', u'_'},
    {KeyCode::Digit8, u'8', u'*', u'\u2022'},
    {KeyCode::Digit0, u'0', u')', u'\u00BA'},
    {KeyCode::RightBracket, u']', u'}'},
    {KeyCode::O, u'o', u'O'},
    {KeyCode::U, u'u', u'U'},
    {KeyCode::LeftBracket, u'[', u'{'},
    {KeyCode::I, u'i', u'I'},
    {KeyCode::P, u'p', u'P'},
    {KeyCode::Return, u'\r'},
    {KeyCode::L, u'l', u'L'},
    {KeyCode::J, u'j', u'J'},
    {KeyCode::Quote, u'\'', u'"'},
    {KeyCode::K, u'k', u'K'},
    {KeyCode::Semicolon, u';', u':'},
    {KeyCode::Backslash, u'\\', u'|'},
    {KeyCode::Comma, u',', u'<'},
    {KeyCode::Slash, u'/', u'?'},
    {KeyCode::N, u'n', u'N'},
    {KeyCode::M, u'm', u'M'},
    {KeyCode::Period, u'.', u'>'},
    {KeyCode::Tab, u'\t'},
    {KeyCode::Space, u' ', u' ', u'\u00A0'},
    {KeyCode::Grave, u'`', u'~'},
    {KeyCode::Delete, u'\b'},
    {KeyCode::Escape, u'\x1B'},
    {KeyCode::KeypadDecimal, u'.'},
    {KeyCode::KeypadMultiply, u'*'},
    {KeyCode::KeypadPlus, u'+'},
    {KeyCode::KeypadDivide, u'/'},
    {KeyCode::KeypadEnter, u'\r'},
    {KeyCode::KeypadMinus, u'-'},
    {KeyCode::KeypadEqual, u'='},
    {KeyCode::Keypad0, u'0'},
    {KeyCode::Keypad1, u'1'},
    {KeyCode::Keypad2, u'2'},
    {KeyCode::Keypad3, u'3'},
    {KeyCode::Keypad4, u'4'},
    {KeyCode::Keypad5, u'5'},
    {KeyCode::Keypad6, u'6'},
    {KeyCode::Keypad7, u'7'},
    {KeyCode::Keypad8, u'8'},
    {KeyCode::Keypad9, u'9'},
    {KeyCode::Home, u'\x01'},
    {KeyCode::PageUp, u'\x0B'},
    {KeyCode::ForwardDelete, u'\x7F'},
    {KeyCode::End, u'\x04'},
    {KeyCode::PageDown, u'\x0C'},
    {KeyCode::Left, u'\x1C'},
    {KeyCode::Right, u'\x1D'},
    {KeyCode::Down, u'\x1F'},
    {KeyCode::Up, u'\x1E'},
});

template <typename Condition>
const Key* findKey(Condition condition) {
    for (const Key& key : Keys) {
        if (condition(key)) return &key;
    }
    return nullptr;
}

char16_t unitOf(const Key& key, EventFlags flags) {
    if (flags.contains(EventFlag::Control) && key.plain >= u'a' && key.plain <= u'z') {
        return static_cast<char16_t>(key.plain & 0x1F);
    }
    if (flags.contains(EventFlag::Option)) return key.option;
    return flags.contains(EventFlag::Shift) ? key.shifted : key.plain;
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

std::optional<std::u16string> SimulatedInputSources::translateKey(KeyCode keyCode, EventFlags flags) const {
    const Key* key = findKey([&](const Key& k) { return k.code == keyCode; });
    if (!key) return std::nullopt;
    return std::u16string(1, unitOf(*key, flags));
}

}  // namespace plume
