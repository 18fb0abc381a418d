// A key placeholder's delay as text: the en_US decimal style ("0.5", "1,234.125"), whatever the user's locale.
#pragma once

#include <string>
#include <string_view>

namespace plume {

// Seconds; never infinite or not a number; 0 when the text starts with no number. Grouping commas are read where three
// digits follow, as the style writes them.
double delayFromText(std::u16string_view text);
// At most three fraction digits.
std::u16string textFromDelay(double seconds);

}  // namespace plume
