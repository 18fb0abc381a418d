// A hot key: a key with modifiers, or modifiers alone. A plain value.
#pragma once

#include <cstdint>

#include "input/KeyCodes.h"

namespace plume {

struct GeneralHotKey {
    std::int32_t modifiers = 0;            // KeyModifier bits
    std::int32_t keyCode = KeyCode::None;  // None: the modifiers alone

    bool isValid() const { return modifiers != 0 || keyCode != KeyCode::None; }

    // The form kept in the settings: the modifiers in the upper, the key code in the lower 32 bits.
    std::int64_t getValue() const;
    void setValue(std::int64_t packed);

    bool operator==(const GeneralHotKey&) const = default;
};

}  // namespace plume
