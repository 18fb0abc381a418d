// Folders of espanso: the one with its files, or a package. A single file of matches is read by importEspanso().
#pragma once

#include <filesystem>

#include "Foundation/Result.h"
#include "library/ImportedLibrary.h"
#include "platform/Files.h"

namespace plume {

// Whether the folder is one that importEspansoFolder() reads.
bool isEspansoFolder(const std::filesystem::path& folder, const Files& files);

// A group for each file, and for each way in which its triggers expand; what its variables run is in a group that never
// expands by itself. Errors name the file, the line and the column.
Result<ImportedLibrary> importEspansoFolder(const std::filesystem::path& folder, const Files& files);

}  // namespace plume
