// What the list of groups and snippets shows: all of them, or those that a text is found in.
//
// Owned by the editor's window; belongs to the thread that owns the library. The settings outlive it.
#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>

#include "engine/SnippetSearch.h"
#include "library/LibraryArchive.h"
#include "platform/UserDefaults.h"

namespace plume {

class LibraryFilter {
  public:
    explicit LibraryFilter(WritableUserDefaults& settings) : settings_(settings) {}

    // Searches anew; the empty text shows everything.
    void onFilterChanged(const std::u16string& filter, const SnippetGroups& groups);
    bool filtering() const { return filtering_; }
    const std::u16string& filter() const { return filter_; }
    // In order; empty while nothing is searched for.
    const SnippetGroups& filteredGroups() const { return filteredGroups_; }
    const SnippetSearch::Found& filteredGroupsMacros() const { return filteredGroupsMacros_; }

    // They hold from the next search on.
    void flipWildcardSearchOption();
    bool isWildcardSearch() const;
    void onSearchByChanged(SnippetSearch::SearchBy field);
    bool searchesBy(SnippetSearch::SearchBy field) const;

    // The snippets that are shown.
    std::size_t total(const SnippetGroups& groups) const;

  private:
    WritableUserDefaults& settings_;
    std::u16string filter_;
    bool filtering_ = false;
    SnippetGroups filteredGroups_;
    SnippetSearch::Found filteredGroupsMacros_;
};

// "3 of 12 snippets selected", or "12 snippets" when none is.
std::u16string statusString(std::size_t selected, std::size_t total);

}  // namespace plume
