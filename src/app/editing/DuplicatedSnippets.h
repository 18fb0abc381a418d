// Finds snippets that are there twice: the same abbreviation and the same content.
#pragma once

#include <cstddef>
#include <functional>
#include <memory>
#include <vector>

#include "library/LibraryArchive.h"

namespace plume {

// The first of them in the library, and all others.
struct DuplicatedSnippets {
    std::shared_ptr<Snippet> kept;
    std::vector<std::shared_ptr<Snippet>> others;
};

// Among the snippets of which `isDuplicated` holds, by their abbreviation with its prefix. What of each abbreviation
// differs in its content is a find of its own; without others there is none.
std::vector<DuplicatedSnippets> duplicatedSnippetsIn(const SnippetGroups& groups,
                                                     const std::function<bool(const Snippet&)>& isDuplicated);

}  // namespace plume
