// Files that the editor writes of the library, or of what is selected in it.
#pragma once

#include <filesystem>
#include <optional>
#include <string>
#include <vector>

#include "Foundation/Date.h"
#include "Foundation/Result.h"
#include "app/editing/LibraryEditor.h"
#include "library/LibraryArchive.h"

namespace plume {

// The endings that exportedFile() knows, the usual one first.
const std::vector<std::string>& exportableExtensions();

// The selected groups whole, and the selected snippets of others in groups with their own groups' names and settings.
// The records are copies of the same identity: the library's stay where they are.
SnippetGroups groupsOfSelection(const LibrarySelection& selection, const SnippetGroups& library);

// The bytes for a file of this name, by its ending: a library's archive, CSV (with labels where there is one group
// alone), the readable form or RTF. Another ending is an error, which names the file.
Result<std::string> exportedFile(const SnippetGroups& groups, const std::filesystem::path& path,
                                 const std::optional<Date>& dateInstalled);

}  // namespace plume
