// A query, taken apart into the terms that all have to be found.
//
// Pure; from any thread.
#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string_view>
#include <vector>

#include "app/ranking/SnippetRanking.h"
#include "app/ranking/TermFit.h"

namespace plume {

struct SearchQuery {
    // Of a longer text that was pasted, the first words tell what is meant.
    static constexpr std::size_t MostTerms = 32;

    // White space and nothing else.
    bool isBlank = true;
    // Each once, normalised; what normalises to nothing is none.
    std::vector<SearchTerm> terms;
    // All of them as they were written, with one space between; nothing when there is only one.
    std::optional<SearchTerm> whole;

    // Whatever is found for this is found for the other too: all of the other's terms are in these.
    bool isNarrowerThan(const SearchQuery& other) const;
};

SearchQuery searchQuery(std::u16string_view text);
// Whether * and ? stand for anything in this text.
bool isWildcardSearch(std::u16string_view text, const SearchRule& rule);
// The fields that are searched: with neither content nor label, the abbreviation.
std::int64_t searchedFields(const SearchRule& rule);

}  // namespace plume
