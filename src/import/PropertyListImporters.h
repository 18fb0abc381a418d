// Libraries in property lists whose file's ending does not tell what they are. The errors name the file.
#pragma once

#include "Foundation/Result.h"
#include "Foundation/archive/PropertyList.h"
#include "import/ForeignFile.h"
#include "library/ImportedLibrary.h"

namespace plume {

Result<ImportedLibrary> libraryFromTextExpander(const PropertyList& list, const ForeignFile& file);
Result<ImportedLibrary> libraryFromTypeIt4Me(const PropertyList& list, const ForeignFile& file);

}  // namespace plume
