// Any bytes are read by any importer, which the first byte chooses; what comes out keeps to its bounds.
#include <cstdint>
#include <cstdlib>
#include <string>
#include <string_view>

#include "import/Importers.h"
#include "import/Remarks.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    if (size == 0) return 0;
    const auto& extensions = plume::importableExtensions();
    const std::string& extension = extensions[data[0] % extensions.size()];
    const std::string_view bytes(reinterpret_cast<const char*>(data) + 1, size - 1);
    const bool converts = data[0] >= 128;
    const auto library = plume::importFile("/x/words." + extension, bytes, {.textExpanderPlaceholders = converts});
    if (!library) {
        if (library.error().message.find("/x/words." + extension) == std::string::npos) std::abort();
        return 0;
    }
    for (const auto& group : library.value().groups) {
        if (!group || group->items().size() > plume::MostImportedSnippets) std::abort();
    }
    return 0;
}
