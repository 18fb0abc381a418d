// Adapting the case of an expanded content to the case in which its abbreviation was typed.
#pragma once

#include <cstdint>
#include <string_view>

#include "content/SnippetExpandedContent.h"

namespace plume {

// `flags` are those of SnippetUtils::caseOf. Where upper-casing lengthens the text, variables move with the characters
// that they stand before.
void correctSnippetContentCase(SnippetExpandedContent& content, std::u16string_view typedAbbreviation,
                               std::int64_t flags);

}  // namespace plume
