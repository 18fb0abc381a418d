// A group of corrections, made of a dictionary's text.
#pragma once

#include <memory>
#include <string>
#include <string_view>

#include "library/SnippetGroup.h"

namespace plume {

// Of two lines each: the abbreviation, then what stands for it; a last line alone is left out. The group expands behind
// a delimiter that stays, and is in no list and menu. Its snippets adapt the case, whatever `caseSensitivity` the group
// has.
std::shared_ptr<SnippetGroup> dictionaryGroup(std::u16string name, std::string_view utf8,
                                              CaseSensitivity caseSensitivity);

}  // namespace plume
