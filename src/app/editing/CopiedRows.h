// Groups and snippets of the list as they lie in the clipboard: an archive with all that they are.
#pragma once

#include <string>
#include <string_view>

#include "Foundation/Result.h"
#include "app/editing/LibraryEditor.h"

namespace plume {

std::string archiveOfRows(const LibrarySelection& rows);

// New records. Each keeps its identity unless one in `library` has it: what was cut out comes back as itself, what was
// copied becomes another one. The error says what is wrong with the bytes.
Result<LibrarySelection> rowsOfArchive(std::string_view bytes, const SnippetGroups& library);

}  // namespace plume
