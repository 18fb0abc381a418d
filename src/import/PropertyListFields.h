// Values of dictionaries as foreign programs write them.
#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

#include "Foundation/archive/PropertyList.h"

namespace plume {

// Nothing when the key is missing or holds no string.
std::optional<std::u16string> textAt(const PropertyList& dictionary, std::string_view key);
// A number, a boolean as 0 or 1, or a string with a number; nothing when the key is missing or holds anything else.
std::optional<std::int64_t> integerAt(const PropertyList& dictionary, std::string_view key);

}  // namespace plume
