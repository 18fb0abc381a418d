#include "import/Importers.h"

#include <algorithm>
#include <array>

#include "Foundation/Strings.h"
#include "import/AutoKeyImporter.h"
#include "import/EspansoImporter.h"
#include "import/ForeignFile.h"

namespace plume {

namespace {

// Plume's own library is a list, that of Beeftext is not.
Result<ImportedLibrary> importJson(const ForeignFile& file) {
    const std::size_t start = file.bytes.find_first_not_of("\xef\xbb\xbf \t\r\n");
    const bool isObject = start != std::string_view::npos && file.bytes[start] == '{';
    return isObject ? importBeeftext(file) : importReadableLibrary(file);
}

Result<ImportedLibrary> importSeparatedValues(const ForeignFile& file) {
    Result<ImportedLibrary> library = importCsv(file);
    if (library) convertBeeftextVariables(library.value());
    return library;
}

struct Format {
    const char* extension;  // in lower case
    Importer* importer;
};

// What files are, by their ending alone.
constexpr std::array Formats = {
    Format{"ahk", importAutoHotkey},
    Format{"autotyper", importAutomaton},
    Format{"csv", importSeparatedValues},
    Format{"glossary", importGlossary},
    Format{"json", importJson},
    Format{"plist", importPropertyList},
    Format{"plume", importPlume},
    Format{"tedist", importTextExpander},
    Format{"textexpander", importTextExpander},
    Format{"textexpbackup", importTextExpander},
    Format{"typeit4me", importTypeIt4Me},
    Format{"yaml", importEspanso},
    Format{"yml", importEspanso},
};

const Format* formatOf(const std::filesystem::path& path) {
    const std::string extension = toUtf8(lowercased(fromUtf8(path.extension().string())));
    const auto found = std::find_if(Formats.begin(), Formats.end(), [&](const Format& format) {
        return "." + std::string(format.extension) == extension;
    });
    return found == Formats.end() ? nullptr : &*found;
}

std::string knownEndings() {
    std::string list;
    for (const std::string& extension : importableExtensions()) list += (list.empty() ? "." : ", .") + extension;
    return list;
}

Result<ImportedLibrary> readWith(const Format* format, const ForeignFile& file) {
    if (!format) return file.fault("no library has this ending; expected one of " + knownEndings());
    if (file.bytes.empty()) return file.fault("the file is empty; expected a library");
    return format->importer(file);
}

Result<ImportedLibrary> importFolder(const std::filesystem::path& folder, const Files& files) {
    if (isEspansoFolder(folder, files)) return importEspansoFolder(folder, files);
    if (isAutoKeyFolder(folder, files)) return importAutoKeyFolder(folder, files);
    return Error{folder.string() + ": no library is in this folder; expected that of espanso or AutoKey"};
}

}  // namespace

std::u16string ForeignFile::title() const {
    return fromUtf8(path.stem().string());
}

Error ForeignFile::fault(const std::string& placeAndExpected) const {
    return {path.string() + ": " + placeAndExpected};
}

Result<ImportedLibrary> importLibrary(const std::filesystem::path& path, const Files& files,
                                      const ImportOptions& options) {
    if (files.isFolder(path)) return importFolder(path, files);
    const Result<std::string> bytes = files.read(path);
    if (!bytes) return bytes.error();
    return readWith(formatOf(path), {path, bytes.value(), options, &files});
}

Result<ImportedLibrary> importFile(const std::filesystem::path& path, std::string_view bytes,
                                   const ImportOptions& options) {
    return readWith(formatOf(path), {path, bytes, options, nullptr});
}

const std::vector<std::string>& importableExtensions() {
    static const std::vector<std::string> extensions = [] {
        std::vector<std::string> list;
        list.reserve(Formats.size());
        for (const Format& format : Formats) list.emplace_back(format.extension);
        return list;
    }();
    return extensions;
}

}  // namespace plume
