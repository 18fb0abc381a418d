#include "app/ranking/SearchQuery.h"

#include <algorithm>
#include <utility>

#include "Foundation/CharacterSet.h"
#include "app/ranking/NormalisedText.h"

namespace plume {

namespace {

bool isSpace(char16_t unit) {
    return CharacterSet::whitespacesAndNewlines().contains(unit);
}

std::vector<std::u16string_view> wordsOf(std::u16string_view text) {
    std::vector<std::u16string_view> words;
    for (auto at = text.begin(); at != text.end() && words.size() < SearchQuery::MostTerms;) {
        const auto start = std::find_if_not(at, text.end(), isSpace);
        at = std::find_if(start, text.end(), isSpace);
        if (start != at) words.emplace_back(start, at);
    }
    return words;
}

}  // namespace

bool SearchQuery::isNarrowerThan(const SearchQuery& other) const {
    return std::all_of(other.terms.begin(), other.terms.end(), [this](const SearchTerm& wide) {
        return std::any_of(terms.begin(), terms.end(),
                           [&](const SearchTerm& term) { return findUnits(term.units, wide.units) != NotFound; });
    });
}

SearchQuery searchQuery(std::u16string_view text) {
    SearchQuery query;
    std::u16string whole;
    for (const std::u16string_view word : wordsOf(text)) {
        query.isBlank = false;
        std::u16string units = normalised(word);
        if (units.empty()) continue;
        if (!whole.empty()) whole += u' ';
        whole += units;
        const bool isNew = std::none_of(query.terms.begin(), query.terms.end(),
                                        [&](const SearchTerm& term) { return term.units == units; });
        if (!isNew) continue;
        query.terms.emplace_back(std::move(units));
    }
    if (!query.terms.empty() && whole != query.terms.front().units) query.whole.emplace(std::move(whole));
    return query;
}

bool isWildcardSearch(std::u16string_view text, const SearchRule& rule) {
    return rule.isWildcard && text.find_first_of(u"*?") != std::u16string_view::npos &&
           text.find_first_not_of(u"*?") != std::u16string_view::npos;
}

std::int64_t searchedFields(const SearchRule& rule) {
    constexpr std::int64_t Others = SearchRule::Content | SearchRule::Label;
    return (rule.searchBy & Others) == 0 ? SearchRule::Abbreviation : rule.searchBy;
}

}  // namespace plume
