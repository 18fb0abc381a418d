// Where a value stands in the text of a JSON document.
#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>

namespace plume {

// How a path goes on to a member, or to an element.
std::string jsonStep(const std::string& key);
std::string jsonStep(std::size_t index);

// The line, counted from 1, at which the value begins that has this path ("$[0].items[2].rtf"), in a text that is known
// to be JSON. Nothing when there is no such value. Linear; for messages.
std::optional<std::size_t> lineOfJsonPath(std::string_view text, std::string_view path);

}  // namespace plume
