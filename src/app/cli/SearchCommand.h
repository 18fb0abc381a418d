// Searches a library from the command line, in the order of quick search.
#pragma once

#include <iosfwd>
#include <string>

#include "app/cli/LibraryChoice.h"

namespace plume {

// The best first, below a divider what is only like the text or has it in its note; as JSON the same for programs.
// Nothing found is a failure. Returns the exit status.
int searchSnippets(const ChosenLibrary& library, const std::string& text, bool asJson, std::ostream& output,
                   std::ostream& error);

}  // namespace plume
