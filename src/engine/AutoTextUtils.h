// Where sentences start.
#pragma once

#include <string_view>

namespace plume {

class AutoTextUtils {
  public:
    // Whether the word that ends one character before the end of the text starts a sentence: a line starts before it,
    // or a sentence ends and spaces follow.
    static bool shouldCapitalize(std::u16string_view text);
};

}  // namespace plume
