// Reads property lists in all their forms: binary, XML, and the old one of braces and parentheses.
//
// Made for foreign bytes: bounded in depth, time and memory (a small file never becomes a large one in memory by
// references to the same object). Pure; from any thread.
#pragma once

#include <string_view>

#include "Foundation/Result.h"
#include "Foundation/archive/PropertyList.h"

namespace plume {

// The form is told by the first bytes. The error says where the bytes are wrong (an offset, or a line) and what was
// expected there. A reference of a keyed archive written in XML, {"CF$UID": n}, is read as one.
Result<PropertyList> readPropertyList(std::string_view bytes);

}  // namespace plume
