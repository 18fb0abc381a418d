// What an importer is given: one file, and what its reader asked for.
#pragma once

#include <filesystem>
#include <string>
#include <string_view>

#include "Foundation/Result.h"
#include "import/Importers.h"
#include "library/ImportedLibrary.h"

namespace plume {

struct ForeignFile {
    std::filesystem::path path;
    std::string_view bytes;  // never empty
    ImportOptions options;
    const Files* files = nullptr;  // for what the file names; null when only its bytes are at hand

    // The file's name without its folder and ending, after which groups are named that have no name of their own.
    std::u16string title() const;
    // "/home/jo/words.csv: line 1: expected …"
    Error fault(const std::string& placeAndExpected) const;
};

// Reads one format. Pure. Errors name the file, the place and what was expected.
using Importer = Result<ImportedLibrary>(const ForeignFile& file);

Importer importAutoHotkey;
Importer importAutomaton;
Importer importBeeftext;
Importer importCsv;
Importer importEspanso;
Importer importGlossary;
Importer importPlume;
Importer importPropertyList;
Importer importReadableLibrary;
Importer importTextExpander;
Importer importTypeIt4Me;

// Turns variables of Beeftext, which its exports as CSV hold, into placeholders.
void convertBeeftextVariables(ImportedLibrary& library);

}  // namespace plume
