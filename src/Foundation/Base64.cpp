#include "Foundation/Base64.h"

#include <cstdint>

namespace plume {

namespace {

// The value of a character, or -1.
int valueOf(char c) {
    if (c >= 'A' && c <= 'Z') return c - 'A';
    if (c >= 'a' && c <= 'z') return c - 'a' + 26;
    if (c >= '0' && c <= '9') return c - '0' + 52;
    return c == '+' ? 62 : c == '/' ? 63 : -1;
}

}  // namespace

std::optional<std::string> bytesFromBase64(std::string_view text) {
    constexpr std::string_view Ignored = "= \t\r\n\f\v";
    std::string bytes;
    bytes.reserve(text.size() / 4 * 3 + 3);
    std::uint32_t group = 0;
    unsigned bits = 0;
    for (const char c : text) {
        if (Ignored.find(c) != std::string_view::npos) continue;
        const int value = valueOf(c);
        if (value < 0) return std::nullopt;
        group = group << 6 | static_cast<std::uint32_t>(value);
        bits += 6;
        if (bits < 8) continue;
        bits -= 8;
        bytes += static_cast<char>(group >> bits & 0xff);
    }
    return bytes;
}

}  // namespace plume
