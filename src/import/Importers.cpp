#include "import/Importers.h"

#include <algorithm>
#include <array>

#include "Foundation/Strings.h"
#include "import/ForeignFile.h"

namespace plume {

namespace {

struct Format {
    const char* extension;  // in lower case
    Importer* importer;
};

// What files are, by their ending alone.
constexpr std::array Formats = {
    Format{"ahk", importAutoHotkey},
    Format{"csv", importCsv},
    Format{"json", importReadableLibrary},
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

}  // namespace

std::u16string ForeignFile::title() const {
    return fromUtf8(path.stem().string());
}

Error ForeignFile::fault(const std::string& placeAndExpected) const {
    return {path.string() + ": " + placeAndExpected};
}

Result<ImportedLibrary> importLibrary(const std::filesystem::path& path, const Files& files,
                                      const ImportOptions& options) {
    const Result<std::string> bytes = files.read(path);
    return bytes ? importFile(path, bytes.value(), options) : bytes.error();
}

Result<ImportedLibrary> importFile(const std::filesystem::path& path, std::string_view bytes,
                                   const ImportOptions& options) {
    const ForeignFile file{path, bytes, options};
    const Format* format = formatOf(path);
    if (!format) return file.fault("no library has this ending; expected one of " + knownEndings());
    if (bytes.empty()) return file.fault("the file is empty; expected a library");
    return format->importer(file);
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
