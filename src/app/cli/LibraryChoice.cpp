#include "app/cli/LibraryChoice.h"

#include <numeric>
#include <system_error>
#include <utility>

#include "Foundation/Strings.h"
#include "app/cli/CsvLibrary.h"
#include "app/cli/Files.h"
#include "library/LibraryFile.h"

namespace plume {

namespace {

std::filesystem::path standardFile() {
    std::filesystem::path own = configurationFolder() / "library.json";
    std::error_code problem;
    if (own.is_absolute() && std::filesystem::exists(own, problem)) return own;
    return dataFolder() / "sample-library.json";
}

bool isCsv(const std::filesystem::path& file) {
    return equalsIgnoringCase(fromUtf8(file.extension().string()), u".csv");
}

Result<ChosenLibrary> readCsv(const std::filesystem::path& file, std::string_view bytes) {
    auto group = readCsvLibrary(bytes, fromUtf8(file.stem().string()));
    if (!group) return Error{file.string() + ": " + group.error().message};
    return ChosenLibrary{{std::move(group).value()}, file};
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
    if (isCsv(file)) return readCsv(file, bytes.value());
    auto groups = LibraryFile::read(bytes.value(), file.string());
    if (!groups) return groups.error();
    return ChosenLibrary{std::move(groups).value(), file};
}

}  // namespace plume
