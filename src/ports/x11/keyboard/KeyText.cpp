#include "ports/x11/keyboard/KeyText.h"

#include <xkbcommon/xkbcommon-keysyms.h>

#include "Foundation/Strings.h"

namespace plume {

namespace {

bool isControl(char32_t character) {
    return character < U' ' || character == 0x7F;
}

}  // namespace

void KeyText::assignKey(xkb_state& state, xcb_keycode_t keycode, bool alt) {
    clear();
    char32_t character = xkb_state_key_get_utf32(&state, keycode);
    if (isControl(character)) {
        // With Control some digits are control characters, too, an inheritance of terminals.
        const xkb_keysym_t symbol = xkb_state_key_get_one_sym(&state, keycode);
        if (symbol >= XKB_KEY_0 && symbol <= XKB_KEY_9) character = symbol;
    }
    if (character != 0 && (isControl(character) || !alt)) append(character);
}

void KeyText::assign(std::string_view utf8) {
    clear();
    const std::u16string text = fromUtf8(utf8);
    length_ = text.copy(units_.data(), units_.size());
}

void KeyText::append(char32_t character) {
    if (character <= 0xFFFF) {
        units_[length_++] = static_cast<char16_t>(character);
        return;
    }
    units_[length_++] = static_cast<char16_t>(0xD7C0 + (character >> 10));
    units_[length_++] = static_cast<char16_t>(0xDC00 + (character & 0x3FF));
}

}  // namespace plume
