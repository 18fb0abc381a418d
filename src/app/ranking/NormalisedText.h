// Texts in the form in which they are searched: compatibility forms taken apart, accents dropped, letter case folded.
//
// Every character is normalised by itself, so the normalised form of a piece of a text is a piece of the text's. Pure;
// from any thread. Positions count UTF-16 units.
#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace plume {

std::u16string normalised(std::u16string_view text);

// With where words start in it.
struct NormalisedField {
    std::u16string units;
    // For every unit what a match that starts there is worth: FirstOfWord, FirstOfPart or 0.
    std::string starts;
};
NormalisedField normalisedField(std::u16string_view text);

inline constexpr char FirstOfWord = 8;
inline constexpr char FirstOfPart = 7;  // a capital after a small letter, or a number's first digit

// With the way back.
struct TracedText {
    NormalisedField field;
    // For every unit the position in the text of the character that it came from; the text's length at the end.
    std::vector<std::size_t> origins;
};
TracedText tracedText(std::u16string_view text);

// A bit for each letter and digit, and for groups of other characters: a text holds a term only where its mask holds
// the term's.
std::uint64_t letterMask(std::u16string_view normalisedText);

// The first place of a pattern that is not empty, or NotFound.
std::size_t findUnits(std::u16string_view text, std::u16string_view pattern, std::size_t from = 0);

}  // namespace plume
