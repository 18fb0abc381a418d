// Plume's own libraries in their readable form.
#include <utility>

#include "import/ForeignFile.h"
#include "library/LibraryFile.h"

namespace plume {

Result<ImportedLibrary> importReadableLibrary(const ForeignFile& file) {
    auto groups = LibraryFile::read(file.bytes, file.path.string());
    if (!groups) return groups.error();
    return ImportedLibrary{std::move(groups).value(), {}};
}

}  // namespace plume
