// A library that was changed as readable text, taken back without losing what such text does not hold.
#pragma once

#include "library/LibraryArchive.h"

namespace plume {

// The groups of `edited`, made of the records of `current` where those are meant: snippets are told by their identity,
// groups by their name. What was not changed stays exactly as it was: dates, attached files, rich text.
SnippetGroups takeEdits(const SnippetGroups& current, const SnippetGroups& edited);

}  // namespace plume
