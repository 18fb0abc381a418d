// One snippet on one line of a terminal.
#pragma once

#include <cstddef>
#include <string>

#include "library/Snippet.h"

namespace plume {

// How many characters the abbreviation takes, with its prefix.
std::size_t typedWidth(const Snippet& snippet);
// The abbreviation, padded to a width that it fits into, the label and how the content begins.
std::string snippetLine(const Snippet& snippet, std::size_t width);

}  // namespace plume
