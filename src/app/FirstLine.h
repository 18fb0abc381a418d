// The beginning of a snippet's content as lists show it.
#pragma once

#include <string>
#include <string_view>

namespace plume {

// The first line that says something, as much of it as suits a list, with an ellipsis where more follows. Takes no
// longer for a longer text.
std::u16string firstLine(std::u16string_view content);

}  // namespace plume
