#include "app/editing/DuplicatedSnippets.h"

#include <string>
#include <unordered_map>
#include <utility>

namespace plume {

namespace {

using Snippets = std::vector<std::shared_ptr<Snippet>>;

// Splits those of one abbreviation by their contents.
void addFinds(Snippets same, std::vector<DuplicatedSnippets>& finds) {
    while (!same.empty()) {
        DuplicatedSnippets find{same.front(), {}};
        Snippets different;
        for (std::size_t i = 1; i < same.size(); ++i) {
            (find.kept->isContentEqualTo(*same[i]) ? find.others : different).push_back(same[i]);
        }
        if (!find.others.empty()) finds.push_back(std::move(find));
        same = std::move(different);
    }
}

}  // namespace

std::vector<DuplicatedSnippets> duplicatedSnippetsIn(const SnippetGroups& groups,
                                                     const std::function<bool(const Snippet&)>& isDuplicated) {
    std::unordered_map<std::u16string, std::size_t> placeOf;
    std::vector<Snippets> byAbbreviation;
    for (const auto& group : groups) {
        for (const auto& snippet : group->items()) {
            if (!isDuplicated(*snippet)) continue;
            const auto [found, isNew] = placeOf.try_emplace(*snippet->abbreviationWithPrefix(), byAbbreviation.size());
            if (isNew) byAbbreviation.emplace_back();
            byAbbreviation[found->second].push_back(snippet);
        }
    }
    std::vector<DuplicatedSnippets> finds;
    for (auto& same : byAbbreviation) addFinds(std::move(same), finds);
    return finds;
}

}  // namespace plume
