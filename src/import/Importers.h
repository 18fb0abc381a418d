// Reads the libraries of other text expanders, and Plume's own files, by the ending of the file's name.
#pragma once

#include <filesystem>
#include <string>
#include <string_view>
#include <vector>

#include "Foundation/Result.h"
#include "library/ImportedLibrary.h"
#include "platform/Files.h"

namespace plume {

// The group that text replacements of the system become: who has one of that name puts them into it, in place of what
// it holds.
inline constexpr const char16_t* SystemSubstitutionsGroup = u"System's Symbol And Text Substitutions";

struct ImportOptions {
    // Contents of CSV files hold the placeholders of TextExpander.
    bool textExpanderPlaceholders = false;
};

// All that the file or folder holds, or the reason why nothing of it can be taken, with the file's name, the place and
// what was expected. Endings count in either case.
Result<ImportedLibrary> importLibrary(const std::filesystem::path& path, const Files& files,
                                      const ImportOptions& options = {});

// The same for a file that was read already.
Result<ImportedLibrary> importFile(const std::filesystem::path& path, std::string_view bytes,
                                   const ImportOptions& options = {});

// The endings that importLibrary() knows, in lower case and without the dot.
const std::vector<std::string>& importableExtensions();

}  // namespace plume
