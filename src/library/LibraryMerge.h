// Brings together what two processes did to one library at the same time.
#pragma once

#include "library/LibraryArchive.h"
#include "library/RecordedLibrary.h"

namespace plume {

// Puts what has changed here since `before` (`delta`, with `mine` as the library of today) on top of `theirs`, which
// another process made of the same `before`. Records are told by their identity; of a snippet that both have changed
// the later one stays, and what one has changed the other's removal does not take away. Records of `mine` come into
// `theirs` themselves.
void mergeLibraries(const RecordedLibrary& before, const LibraryContents& mine, const LibraryDelta& delta,
                    LibraryContents& theirs);

// Puts the records of `mine` into `theirs`, which takes its place, wherever both mean the same, so that who holds one
// keeps holding it: a snippet that is equal in everything; a group of the same identity, which gets their settings and
// list. What only `mine` had is gone then.
void keepRecords(const LibraryContents& mine, LibraryContents& theirs);

}  // namespace plume
