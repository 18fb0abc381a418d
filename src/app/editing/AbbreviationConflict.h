// Who stands in the way of an abbreviation.
#pragma once

#include <memory>
#include <string_view>

#include "library/LibraryArchive.h"

namespace plume {

struct AbbreviationConflict {
    enum class Kind {
        None,
        Same,         // `other` has it, too
        ExpandsFirst  // `other` is expanded as soon as the beginning of it is typed
    };
    Kind kind = Kind::None;
    std::shared_ptr<Snippet> other;
};

// As if `snippet` had this abbreviation, without the prefix of its group. The same abbreviation is told first, of
// several snippets the first in the library.
AbbreviationConflict conflictOf(const Snippet& snippet, std::u16string_view abbreviation, const SnippetGroups& groups);

}  // namespace plume
