// The entries of the journal: each turns one state of the library into the next.
//
// Pure; from any thread, as far as nobody changes the records meanwhile.
#pragma once

#include <string>
#include <string_view>

#include "Foundation/Result.h"
#include "library/LibraryArchive.h"
#include "library/RecordedLibrary.h"

namespace plume {

// What the delta tells of the library of today, as bytes. Costs what has changed.
std::string journalEntry(const LibraryContents& library, const LibraryDelta& delta);

// Changes the library as the entry says. One that does not fit the library, or is damaged, changes nothing and is an
// error.
Result<void> applyJournalEntry(std::string_view bytes, LibraryContents& library);

}  // namespace plume
