// Bytes written as text in base 64.
#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace plume {

// White space and the padding at the end count for nothing. Nothing when there is any other character.
std::optional<std::string> bytesFromBase64(std::string_view text);

}  // namespace plume
