// Where the focus of a program is on the screen.
#pragma once

#include "platform/Accessibility.h"
#include "ports/atspi/AtspiFocusTracker.h"

namespace plume {

// On the accessibility thread, within the bound that the bus was given.
FocusedPlaces placesOf(AtspiBus& bus, const AtspiFocused& focused);

}  // namespace plume
