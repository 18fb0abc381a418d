// Plume's own archives: backups, exports and sync files.
#include "content/OldSyntax.h"
#include "import/ForeignFile.h"
#include "library/LibraryArchive.h"

namespace plume {

Result<ImportedLibrary> importPlume(const ForeignFile& file) {
    auto contents = readLibraryArchive(file.bytes, convertOldSnippet);
    if (!contents) return file.fault(contents.error().message);
    return ImportedLibrary{std::move(contents.value().snippetGroups), {}};
}

}  // namespace plume
