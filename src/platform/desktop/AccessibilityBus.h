// Whether this session has an accessibility bus, asked of the session's D-Bus before libatspi looks for it: libatspi
// waits longer and ends the program with some faults.
#pragma once

#include "platform/desktop/AtspiAccessibility.h"

namespace plume {

// Starts the bus when it can be started. May wait for seconds: on the accessibility thread. Working, SwitchedOff,
// NotInstalled or NoSession.
AccessibilityStatus findAccessibilityBus();

}  // namespace plume
