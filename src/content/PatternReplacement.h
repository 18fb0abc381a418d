// Find-and-replace with a regular expression, as clipboard placeholders ask for it.
#pragma once

#include <chrono>
#include <functional>
#include <string>
#include <string_view>

#include "Foundation/Strings.h"
#include "content/SnippetClipboardVariable.h"

namespace plume {

// What replacing may let a text grow to, in UTF-16 units.
inline constexpr std::size_t LongestReplacementResult = std::size_t{16} * 1024 * 1024;

// Called for every replacement, from left to right; false stops.
using ReplacementVisitor = std::function<bool(Range, const std::u16string&)>;

// Whether the variable's find text is searched for as a pattern: it is one, or it counts at the borders of words only.
bool usesPattern(const SnippetClipboardVariable& variable);

// Calls the visitor for every match, until the deadline. The result is what is wrong, in words that follow the find
// text; empty when all matches were visited.
std::string visitMatches(const SnippetClipboardVariable& variable, std::u16string_view content,
                         std::chrono::steady_clock::time_point deadline, const ReplacementVisitor& visitor);

}  // namespace plume
