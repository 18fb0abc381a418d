// Any bytes are read as files of espanso, AutoKey and Beeftext: as a library or as an error that says what was
// expected.
#include <array>
#include <cstdint>
#include <cstdlib>
#include <string>
#include <string_view>

#include "import/AutoKeyImporter.h"
#include "import/Importers.h"
#include "ports/simulated/SimulatedFiles.h"

namespace {

void check(const plume::Result<plume::ImportedLibrary>& library) {
    if (!library) {
        if (library.error().message.empty()) std::abort();
        return;
    }
    for (const auto& group : library.value().groups) {
        if (!group) std::abort();
    }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    if (size == 0) return 0;
    const std::string_view bytes(reinterpret_cast<const char*>(data) + 1, size - 1);
    constexpr std::array<const char*, 3> Names = {"/a.yml", "/a.json", "/a.csv"};
    const std::size_t kind = data[0] % 5;
    if (kind < Names.size()) {
        check(plume::importFile(Names[kind], bytes));
        return 0;
    }
    // The settings of a phrase and the phrase itself, which a 0 parts.
    plume::SimulatedFiles files;
    const std::size_t part = std::min(bytes.find('\0'), bytes.size());
    const bool isWritten = bool(files.createFolder("/f")) && bool(files.write("/f/.a.json", bytes.substr(0, part))) &&
                           bool(files.write(kind == 3 ? "/f/a.txt" : "/f/a.py", bytes.substr(part)));
    if (isWritten) check(plume::importAutoKeyFolder("/f", files));
    return 0;
}
