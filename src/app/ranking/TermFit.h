// How one term of a query fits the texts of one snippet.
//
// Pure; from any thread. All texts are normalised (NormalisedText.h).
#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

#include "app/ranking/FuzzyScore.h"

namespace plume {

struct SearchTerm {
    // Normalised; not empty.
    explicit SearchTerm(std::u16string term);

    std::u16string units;
    std::uint64_t mask = 0;
    // Of a place in a content at the start of a word, or elsewhere.
    double qualityAtWord = 0;
    double qualityInWord = 0;
};

// The letters that are anywhere in the fields; none of a field that is left out.
struct LetterMasks {
    std::uint64_t abbreviation = 0;
    std::uint64_t label = 0;
    std::uint64_t content = 0;

    std::uint64_t all() const { return abbreviation | label | content; }
};

// What is searched of a snippet; fields that the search leaves out are empty. Nothing is owned.
struct SearchedTexts {
    FieldView abbreviation;
    // Where a person may hold the abbreviation to begin: with its prefix, without it, after punctuation.
    std::array<std::size_t, 3> beginnings{};
    FieldView label;
    std::u16string_view content;
    LetterMasks masks;
};

// Tiers, from the worst.
namespace Tier {
inline constexpr double None = -1;
inline constexpr double Slip = 0;         // but for one or two typing slips a word of abbreviation or label
inline constexpr double Subsequence = 1;  // its letters stand in abbreviation or label in order, close together
inline constexpr double InContent = 2;
inline constexpr double InField = 3;  // inside abbreviation or label
inline constexpr double StartsWord = 4;
inline constexpr double BeginsLabel = 5;
inline constexpr double BeginsAbbreviation = 6;
inline constexpr double IsLabel = 6.5;
inline constexpr double IsAbbreviation = 7;
}  // namespace Tier

struct TermFit {
    double tier = Tier::None;
    double quality = 0;  // 0 to 1, within the tier
};

// The best place of a term that stands in a text whole, in abbreviation or label, or in any field; None where it stands
// in none.
TermFit fieldFit(const SearchedTexts& texts, const SearchTerm& term);
TermFit wholeFit(const SearchedTexts& texts, const SearchTerm& term);
// Of a term that does not stand in them whole. Slips are looked for only when asked for.
TermFit looseFit(const SearchedTexts& texts, const SearchTerm& term, bool withSlips);

// How many slips are forgiven in a term of this length.
std::size_t forgivenSlips(std::size_t length);
// Letters put in, left out, changed, or swapped with their neighbour, to make one word of the other; more than `most`
// counts as most + 1.
std::size_t slipsBetween(std::u16string_view one, std::u16string_view other, std::size_t most);

}  // namespace plume
