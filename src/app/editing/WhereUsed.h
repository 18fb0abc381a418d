// Which snippets include another one by a placeholder.
#pragma once

#include <memory>
#include <vector>

#include "library/LibraryArchive.h"

namespace plume {

// In the order of the library. Those are told whose placeholder finds this very snippet, as an expansion would; what is
// included by what is included is not.
std::vector<std::shared_ptr<Snippet>> snippetsThatInclude(const Snippet& snippet, const SnippetGroups& groups);

}  // namespace plume
