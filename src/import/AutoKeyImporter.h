// Folders of AutoKey: phrases and scripts, each with a file that says what triggers it.
#pragma once

#include <filesystem>

#include "Foundation/Result.h"
#include "library/ImportedLibrary.h"
#include "platform/Files.h"

namespace plume {

// Whether the folder, or one in it, has files of AutoKey.
bool isAutoKeyFolder(const std::filesystem::path& folder, const Files& files);

// A group for each folder, and for each way in which its abbreviations expand. Errors name the file and the place.
Result<ImportedLibrary> importAutoKeyFolder(const std::filesystem::path& folder, const Files& files);

}  // namespace plume
