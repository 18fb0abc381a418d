// What AT-SPI calls the parts of a user interface, and what Plume calls them.
#pragma once

#include <string_view>

#include "ports/atspi/AtspiParts.h"

namespace plume {

// "AXUnknown" for a role that Plume has no use for. On the accessibility thread.
std::u16string_view roleOf(AtspiBus& bus, const AtspiPart& part);
// Empty when it has none. On the accessibility thread.
std::u16string_view subroleOf(AtspiBus& bus, const AtspiPart& part);

}  // namespace plume
