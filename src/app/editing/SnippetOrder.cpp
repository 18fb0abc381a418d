#include "app/editing/SnippetOrder.h"

#include <algorithm>
#include <optional>
#include <string>
#include <utility>

#include "Foundation/Strings.h"

namespace plume {

namespace {

using Snippets = std::vector<std::shared_ptr<Snippet>>;

// Keys are made once: there are many more comparisons.
template <typename KeyOf>
Snippets sortedByKey(const Snippets& snippets, bool ascending, KeyOf keyOf) {
    using Key = decltype(keyOf(*snippets.front()));
    std::vector<std::pair<Key, std::shared_ptr<Snippet>>> keyed;
    keyed.reserve(snippets.size());
    for (const auto& snippet : snippets) keyed.emplace_back(keyOf(*snippet), snippet);
    std::stable_sort(keyed.begin(), keyed.end(), [ascending](const auto& a, const auto& b) {
        return ascending ? a.first < b.first : b.first < a.first;
    });
    Snippets result;
    result.reserve(keyed.size());
    for (auto& [key, snippet] : keyed) result.push_back(std::move(snippet));
    return result;
}

std::optional<std::u16string> foldedKey(const std::optional<std::u16string>& text) {
    if (!text) return std::nullopt;
    return folded(*text);
}

}  // namespace

Snippets sorted(const Snippets& snippets, SortBy by, bool ascending) {
    const auto sortedBy = [&](auto keyOf) { return sortedByKey(snippets, ascending, keyOf); };
    switch (by) {
        case SortBy::None:
            return snippets;
        case SortBy::Abbreviation:
            return sortedBy([](const Snippet& snippet) { return foldedKey(snippet.abbreviation()); });
        case SortBy::SortingContent:
            return sortedBy([](const Snippet& snippet) { return foldedKey(snippet.sortingContent()); });
        case SortBy::DateCreated:
            return sortedBy([](const Snippet& snippet) { return snippet.dateCreated(); });
        case SortBy::DateModified:
            return sortedBy([](const Snippet& snippet) { return snippet.dateModified(); });
        case SortBy::LastTimeUsed:
            return sortedBy([](const Snippet& snippet) { return snippet.lastTimeUsed(); });
    }
    return snippets;
}

SnippetGroups sortedByName(const SnippetGroups& groups) {
    SnippetGroups result = groups;
    std::stable_sort(result.begin(), result.end(), [](const auto& a, const auto& b) {
        return compareNaturally(a->name().value_or(u""), b->name().value_or(u"")) < 0;
    });
    return result;
}

}  // namespace plume
