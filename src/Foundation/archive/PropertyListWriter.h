// Writes property lists. Pure; from any thread.
#pragma once

#include <string>

#include "Foundation/archive/PropertyList.h"

namespace plume {

// Equal values are written once.
std::string binaryPropertyList(const PropertyList& list);
// XML holds dates to the second, and what it has no characters for, like unpaired surrogates and most control
// characters, as U+FFFD.
std::string xmlPropertyList(const PropertyList& list);

}  // namespace plume
