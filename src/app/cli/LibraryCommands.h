// What can be asked of a library without a desktop: show it, expand one snippet of it.
#pragma once

#include <iosfwd>
#include <string>

#include "app/cli/LibraryChoice.h"

namespace plume {

// Each writes what was asked for to `output`, what went wrong to `error`, and returns the exit status.
int listSnippets(const ChosenLibrary& library, bool onlyAbbreviations, std::ostream& output);
// Runs the scripts of the snippet. A snippet with fields to fill in is refused.
int expandSnippet(const ChosenLibrary& library, const std::string& abbreviation, std::ostream& output,
                  std::ostream& error);

}  // namespace plume
