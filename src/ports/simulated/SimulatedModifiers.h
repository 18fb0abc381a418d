// The modifier keys of the simulated keyboard.
#pragma once

#include "Foundation/KeyCode.h"
#include "Foundation/KeyModifiers.h"

namespace plume {

// The event flag of a modifier key, none for every other key.
constexpr EventFlags modifierFlagOf(KeyCode keyCode) {
    switch (keyCode) {
        case KeyCode::RightCommand:
        case KeyCode::Command:
            return EventFlag::Command;
        case KeyCode::Shift:
        case KeyCode::RightShift:
            return EventFlag::Shift;
        case KeyCode::Option:
        case KeyCode::RightOption:
            return EventFlag::Option;
        case KeyCode::Control:
        case KeyCode::RightControl:
            return EventFlag::Control;
        default:
            return {};
    }
}

}  // namespace plume
