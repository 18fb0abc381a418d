// Contents as TextExpander writes them, in today's syntax.
#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "library/Snippet.h"

namespace plume {

// Rewrites the snippet's content in place: the macros that convertOldSnippet() does not know, and then those that it
// does. In scripts dates, keys and signs such as %| are code and stay. Returns what could not be carried over, in words
// that go on after the snippet's name.
std::vector<std::string> convertTextExpanderMacros(Snippet& snippet);

// Whether a text that may come from TextExpander has macros that can hardly be anything else.
bool holdsTextExpanderMacros(std::u16string_view text);

}  // namespace plume
