#include "app/cli/LibraryChoice.h"

#include <numeric>
#include <system_error>
#include <utility>

#include "app/cli/Files.h"
#include "import/Importers.h"

namespace plume {

namespace {

std::filesystem::path standardFile() {
    std::filesystem::path own = configurationFolder() / "library.json";
    std::error_code problem;
    if (own.is_absolute() && std::filesystem::exists(own, problem)) return own;
    return dataFolder() / "sample-library.json";
}

}  // namespace

std::size_t ChosenLibrary::snippetCount() const {
    return std::accumulate(groups.begin(), groups.end(), std::size_t{0},
                           [](std::size_t sum, const auto& group) { return sum + group->items().size(); });
}

Result<ChosenLibrary> openLibrary(const std::optional<std::string>& named) {
    const std::filesystem::path file = named ? std::filesystem::path(*named) : standardFile();
    const Result<std::string> bytes = readWholeFile(file);
    if (!bytes) return bytes.error();
    auto imported = importFile(file, bytes.value());
    if (!imported) return imported.error();
    return ChosenLibrary{std::move(imported.value().groups), file};
}

}  // namespace plume
