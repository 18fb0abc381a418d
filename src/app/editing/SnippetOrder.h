// The orders in which the editor sorts.
//
// Pure; belongs to the thread that owns the records. Records that are equal in the key keep their order.
#pragma once

#include <cstddef>
#include <memory>
#include <vector>

#include "library/LibraryArchive.h"

namespace plume {

// What snippets are sorted by, numbered as in the menu.
enum class SortBy : std::size_t { None, Abbreviation, SortingContent, DateCreated, DateModified, LastTimeUsed };

// Texts ignoring case, dates by time; what lacks one comes first. None leaves the order as it is.
std::vector<std::shared_ptr<Snippet>> sorted(const std::vector<std::shared_ptr<Snippet>>& snippets, SortBy by,
                                             bool ascending);
// By their names, numbers in them by their value.
SnippetGroups sortedByName(const SnippetGroups& groups);

}  // namespace plume
