#include "input/GeneralHotKey.h"

namespace plume {

std::int64_t GeneralHotKey::getValue() const {
    const auto high = static_cast<std::uint64_t>(static_cast<std::uint32_t>(modifiers)) << 32;
    return static_cast<std::int64_t>(high | static_cast<std::uint32_t>(keyCode));
}

void GeneralHotKey::setValue(std::int64_t packed) {
    const auto bits = static_cast<std::uint64_t>(packed);
    modifiers = static_cast<std::int32_t>(static_cast<std::uint32_t>(bits >> 32));
    keyCode = static_cast<std::int32_t>(static_cast<std::uint32_t>(bits));
}

}  // namespace plume
