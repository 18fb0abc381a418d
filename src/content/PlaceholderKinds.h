// Which kinds of placeholders there are, told apart by what their body starts with. The tables in PlaceholderKinds.cpp
// are where a new kind begins.
#pragma once

#include <cstddef>
#include <memory>
#include <string_view>

#include "content/SnippetVariable.h"

namespace plume {

// The placeholder that a body of parameters stands for; null for the caret, the arrows and everything that is no
// placeholder. Never fails; takes time linear in the body.
std::shared_ptr<SnippetVariable> parseVariable(std::u16string_view body);

// The placeholder that is one sign alone, the caret or an arrow, written at `location`; null for any other body.
std::shared_ptr<SnippetVariable> parseSign(std::u16string_view body, std::size_t location);

// Whether the body starts as that of some placeholder does.
bool startsWithKeyword(std::u16string_view body);

}  // namespace plume
