// A hot key: a key with modifiers, or modifiers alone. A plain value.
#pragma once

#include <cstdint>

#include "Foundation/KeyCode.h"
#include "Foundation/KeyModifiers.h"

namespace plume {

struct GeneralHotKey {
    KeyModifiers modifiers;
    KeyCode keyCode = KeyCode::None;  // None: the modifiers alone

    bool isValid() const { return !modifiers.isEmpty() || keyCode != KeyCode::None; }

    // The form kept in the settings: the modifiers in the upper, the key code in the lower 32 bits. A code
    // that is none makes an invalid hot key.
    std::int64_t getValue() const;
    void setValue(std::int64_t packed);

    bool operator==(const GeneralHotKey&) const = default;
};

}  // namespace plume
