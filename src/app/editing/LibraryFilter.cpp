#include "app/editing/LibraryFilter.h"

#include <numeric>
#include <utility>

#include "Foundation/Strings.h"

namespace plume {

namespace {

constexpr const char* WildcardKey = "WildcardSearch";
constexpr const char* SearchByKey = "MainWindowSearchBy";

}  // namespace

void LibraryFilter::onFilterChanged(const std::u16string& filter, const SnippetGroups& groups) {
    filter_ = filter;
    filtering_ = !filter.empty();
    filteredGroups_.clear();
    filteredGroupsMacros_.clear();
    if (!filtering_) return;
    auto found = SnippetSearch::filter(filter, groups, isWildcardSearch(), settings_.integerForKey(SearchByKey),
                                       &filteredGroups_);
    if (found) filteredGroupsMacros_ = std::move(*found);
}

void LibraryFilter::flipWildcardSearchOption() {
    const std::int64_t flipped = isWildcardSearch() ? 0 : 1;
    static_cast<void>(settings_.setObject(WildcardKey, flipped));
}

bool LibraryFilter::isWildcardSearch() const {
    return settings_.integerForKey(WildcardKey) == 1;
}

void LibraryFilter::onSearchByChanged(SnippetSearch::SearchBy field) {
    static_cast<void>(settings_.setObject(SearchByKey, settings_.integerForKey(SearchByKey) ^ field));
}

bool LibraryFilter::searchesBy(SnippetSearch::SearchBy field) const {
    return (settings_.integerForKey(SearchByKey) & field) != 0;
}

std::size_t LibraryFilter::total(const SnippetGroups& groups) const {
    if (filtering_) {
        return std::accumulate(filteredGroupsMacros_.begin(), filteredGroupsMacros_.end(), std::size_t{0},
                               [](std::size_t sum, const auto& found) { return sum + found.second.size(); });
    }
    return std::accumulate(groups.begin(), groups.end(), std::size_t{0},
                           [](std::size_t sum, const auto& group) { return sum + group->items().size(); });
}

std::u16string statusString(std::size_t selected, std::size_t total) {
    const std::string all = std::to_string(total);
    return fromUtf8(selected > 0 ? std::to_string(selected) + " of " + all + " snippets selected" : all + " snippets");
}

}  // namespace plume
