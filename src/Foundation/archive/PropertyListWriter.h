// Writes property lists. Pure; from any thread.
#pragma once

#include <string>

#include "Foundation/archive/PropertyList.h"

namespace plume {

// Equal strings, numbers and data are written once.
std::string binaryPropertyList(const PropertyList& list);
std::string xmlPropertyList(const PropertyList& list);

}  // namespace plume
