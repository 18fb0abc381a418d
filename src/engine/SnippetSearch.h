// Finds snippets by what stands in their abbreviation, their content or their label: for quick search and for the list
// of snippets.
//
// Pure; belongs to the thread that owns the library.
#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "library/SnippetGroup.h"

namespace plume {

class SnippetSearch {
  public:
    using Groups = std::vector<std::shared_ptr<SnippetGroup>>;
    using Snippets = std::vector<std::shared_ptr<Snippet>>;
    using Found = std::unordered_map<std::shared_ptr<SnippetGroup>, Snippets>;

    // Where is searched, to be added up.
    enum SearchBy : std::int64_t { Abbreviation = 1, Content = 2, Label = 4 };

    // The snippets that match, in the order of their groups' items, and in `orderedGroups` (may be null) the groups
    // that have some, in their order. Nothing, with `orderedGroups` left as it is, for no text or an empty one. An
    // abbreviation is searched with its prefix. Case never matters. With wildcards a whole abbreviation, content or
    // label has to match, where "*" stands for any characters and "?" for one; a text of nothing else is searched for
    // as it is.
    static std::optional<Found> filter(const std::optional<std::u16string>& searchText, const Groups& inGourps,
                                       bool isWildcard, std::int64_t searchBy, Groups* orderedGroups);
};

}  // namespace plume
