#include "input/GeneralHotKey.h"

namespace plume {

std::int64_t GeneralHotKey::getValue() const {
    const auto high = std::uint64_t{static_cast<std::uint32_t>(modifiers.bits())} << 32;
    return static_cast<std::int64_t>(high | numberOf(keyCode));
}

void GeneralHotKey::setValue(std::int64_t packed) {
    const auto bits = static_cast<std::uint64_t>(packed);
    const auto code = static_cast<std::uint32_t>(bits);
    *this = {};
    // A code that no keyboard has must not stand for some other key.
    if (code > numberOf(KeyCode::None)) return;
    modifiers = KeyModifiers::fromBits(static_cast<std::int32_t>(bits >> 32));
    keyCode = KeyCode{static_cast<std::uint16_t>(code)};
}

}  // namespace plume
