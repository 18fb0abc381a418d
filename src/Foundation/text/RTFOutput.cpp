#include "Foundation/text/RTFOutput.h"

#include <cctype>
#include <cstdint>

namespace plume {

void RTFOutput::openGroup() {
    bytes_.push_back('{');
    needsDelimiter_ = false;
}

void RTFOutput::closeGroup() {
    bytes_.push_back('}');
    needsDelimiter_ = false;
}

void RTFOutput::control(std::string_view word) {
    bytes_.push_back('\\');
    bytes_.append(word);
    needsDelimiter_ = true;
}

void RTFOutput::control(std::string_view word, int number) {
    control(word);
    bytes_.append(std::to_string(number));
}

void RTFOutput::ignorableControl(std::string_view word) {
    bytes_.append("\\*");
    control(word);
}

void RTFOutput::newline() {
    bytes_.push_back('\n');
    needsDelimiter_ = false;
}

void RTFOutput::append(const RTFOutput& other) {
    bytes_.append(other.bytes_);
    needsDelimiter_ = other.needsDelimiter_;
}

void RTFOutput::byte(unsigned char byte) {
    constexpr std::string_view Digits = "0123456789abcdef";
    bytes_.append("\\'");
    bytes_.push_back(Digits[byte >> 4]);
    bytes_.push_back(Digits[byte & 0xF]);
    needsDelimiter_ = false;
}

void RTFOutput::literal(char character) {
    const bool couldBelongToWord = std::isalnum(static_cast<unsigned char>(character)) || character == '-';
    if (needsDelimiter_ && (couldBelongToWord || character == ' ')) bytes_.push_back(' ');
    bytes_.push_back(character);
    needsDelimiter_ = false;
}

void RTFOutput::text(std::u16string_view text) {
    for (const char16_t next : text) unit(next);
}

void RTFOutput::unit(char16_t unit) {
    switch (unit) {
        case u'\\':
        case u'{':
        case u'}':
            bytes_.push_back('\\');
            bytes_.push_back(static_cast<char>(unit));
            needsDelimiter_ = false;
            return;
        case u'\n':
            control("par");
            newline();
            return;
        case u'\t':
            control("tab");
            return;
        case u'\f':
            control("page");
            return;
        case u'\u2028':
            control("line");
            return;
        default:
            break;
    }
    if (unit >= 0x80) {
        // The number is signed, of 16 bits.
        control("u", static_cast<std::int16_t>(unit));
    } else if (unit < 0x20 || unit == 0x7F) {
        byte(static_cast<unsigned char>(unit));
    } else {
        literal(static_cast<char>(unit));
    }
}

}  // namespace plume
