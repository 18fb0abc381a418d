// Where this session has its accessibility bus, if it has one: asked of the session's D-Bus.
#pragma once

#include <string>

#include "ports/atspi/AtspiAccessibility.h"

namespace plume {

struct AccessibilityBus {
    AccessibilityStatus status;  // Working, SwitchedOff, NotInstalled or NoSession
    std::string address;         // empty for the last two
};

// Starts the bus when it can be started. May wait for seconds: on the accessibility thread.
AccessibilityBus findAccessibilityBus();

}  // namespace plume
