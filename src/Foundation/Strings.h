// UTF-16 strings: the operations on text that the rest of Plume needs, over ICU's Unicode data.
//
// Text is std::u16string throughout; every length and position counts UTF-16 units. Nothing here throws on odd input:
// unpaired surrogates are ordinary units that have no case. All functions are pure and may be called from any thread.
#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace plume {

// A place in a text: `length` units from `location`.
struct Range {
    std::size_t location = 0;
    std::size_t length = 0;

    std::size_t end() const { return location + length; }
    bool operator==(const Range&) const = default;
};

// "Not found", where a position is returned.
inline constexpr std::size_t NotFound = static_cast<std::size_t>(-1);

// ---- Encoding ----
// Conversion to UTF-8 writes unpaired surrogates as U+FFFD.
std::string toUtf8(std::u16string_view text);
// Malformed sequences become U+FFFD.
std::u16string fromUtf8(std::string_view bytes);
// The text, or nullopt when the bytes are not well-formed UTF-8.
std::optional<std::u16string> fromStrictUtf8(std::string_view bytes);

// ---- Case ----
// Full, locale-independent case mapping: the length may change.
std::u16string lowercased(std::u16string_view text);
std::u16string uppercased(std::u16string_view text);

// Simple case folding of one code point: never changes how many UTF-16 units it takes.
char32_t foldedCodePoint(char32_t c);
// Simple case folding of a whole text, unit for unit: the result is as long as the text.
std::u16string folded(std::u16string_view text);

// ---- Comparison ----
// Equality under simple case folding.
bool equalsIgnoringCase(std::u16string_view a, std::u16string_view b);
// Order under simple case folding, by code unit of the folded texts: negative, 0 or positive.
int compareIgnoringCase(std::u16string_view a, std::u16string_view b);
// As compareIgnoringCase, but runs of decimal digits are ordered by the number they write ("a2" before "a10").
int compareNaturally(std::u16string_view a, std::u16string_view b);

// ---- Search ----
// The first occurrence of `pattern` that starts at or after `from`, or NotFound. An empty pattern is never found.
std::size_t findIgnoringCase(std::u16string_view text, std::u16string_view pattern, std::size_t from = 0);
// All occurrences from left to right, each search starting after the end of the occurrence before it.
std::vector<Range> rangesOfString(std::u16string_view text, std::u16string_view pattern, bool ignoringCase);
bool containsIgnoringCase(std::u16string_view text, std::u16string_view pattern);

// ---- Pieces ----
// The pieces between occurrences of `separator`; a text without it is one piece, so the result is never empty.
std::vector<std::u16string> split(std::u16string_view text, char16_t separator);
// Without the white space and newlines at both ends.
std::u16string_view trimmed(std::u16string_view text);
// Every occurrence of `pattern` replaced, left to right; an empty pattern replaces nothing.
std::u16string replacingAll(std::u16string_view text, std::u16string_view pattern, std::u16string_view replacement);
// The whole number that the text starts with, after optional white space and a sign; 0 when there is none. Values
// beyond 64 bits stop at the limits.
std::int64_t integerValue(std::u16string_view text);

}  // namespace plume
