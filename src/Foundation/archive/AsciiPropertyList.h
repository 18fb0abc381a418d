// The reader of property lists in the old form of braces and parentheses; internal to readPropertyList().
#pragma once

#include <string_view>

#include "Foundation/Result.h"
#include "Foundation/archive/PropertyList.h"

namespace plume {

Result<PropertyList> readAsciiPropertyList(std::u16string_view text);

}  // namespace plume
