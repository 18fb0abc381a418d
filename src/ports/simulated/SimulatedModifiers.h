// The modifier keys of the simulated keyboard.
#pragma once

#include <cstdint>

#include "input/KeyCodes.h"

namespace plume {

// The event flag bit of a modifier key, 0 for every other key.
constexpr std::uint64_t modifierFlagOf(std::uint16_t keyCode) {
    switch (keyCode) {
        case 54:
        case 55:
            return EventFlag::Command;
        case 56:
        case 60:
            return EventFlag::Shift;
        case 58:
        case 61:
            return EventFlag::Option;
        case 59:
        case 62:
            return EventFlag::Control;
        default:
            return 0;
    }
}

}  // namespace plume
