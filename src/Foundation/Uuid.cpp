#include "Foundation/Uuid.h"

#include <unistd.h>

#include <cstdlib>

namespace plume {

namespace {

constexpr std::size_t TextLength = 36;

bool isHyphenPlace(std::size_t index) {
    return index == 8 || index == 13 || index == 18 || index == 23;
}

// The value of a hexadecimal digit, or -1.
int hexValue(char16_t unit) {
    if (unit >= u'0' && unit <= u'9') return unit - u'0';
    if (unit >= u'a' && unit <= u'f') return unit - u'a' + 10;
    if (unit >= u'A' && unit <= u'F') return unit - u'A' + 10;
    return -1;
}

}  // namespace

Uuid Uuid::random() {
    std::array<std::uint8_t, 16> bytes{};
    // The kernel's own: one short call, where std::random_device takes a hundred times as long. It cannot fail for so
    // few bytes.
    if (getentropy(bytes.data(), bytes.size()) != 0) std::abort();
    bytes[6] = static_cast<std::uint8_t>((bytes[6] & 0x0F) | 0x40);  // version: random
    bytes[8] = static_cast<std::uint8_t>((bytes[8] & 0x3F) | 0x80);  // variant: RFC 4122
    return Uuid(bytes);
}

std::optional<Uuid> Uuid::parse(std::u16string_view text) {
    if (text.size() != TextLength) return std::nullopt;
    std::array<std::uint8_t, 16> bytes{};
    std::size_t digits = 0;
    for (std::size_t i = 0; i < TextLength; ++i) {
        if (isHyphenPlace(i)) {
            if (text[i] != u'-') return std::nullopt;
            continue;
        }
        const int value = hexValue(text[i]);
        if (value < 0) return std::nullopt;
        std::uint8_t& byte = bytes[digits / 2];
        byte = static_cast<std::uint8_t>(byte * 16 + value);
        ++digits;
    }
    return Uuid(bytes);
}

std::u16string Uuid::toString() const {
    constexpr std::u16string_view Digits = u"0123456789ABCDEF";
    std::u16string text;
    text.reserve(TextLength);
    for (const std::uint8_t byte : bytes_) {
        if (isHyphenPlace(text.size())) text += u'-';
        text += Digits[byte >> 4];
        text += Digits[byte & 0x0F];
    }
    return text;
}

}  // namespace plume
