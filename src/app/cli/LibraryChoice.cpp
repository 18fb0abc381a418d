#include "app/cli/LibraryChoice.h"

#include <filesystem>
#include <utility>

#include "app/cli/UserLibrary.h"
#include "import/Importers.h"
#include "ports/posix/PollRunLoop.h"

namespace plume {

Result<ChosenLibrary> openLibrary(const std::optional<std::string>& named,
                                  const std::function<void(const std::string&)>& report) {
    if (named) {
        const PosixFiles files;
        auto imported = importLibrary(std::filesystem::absolute(*named), files);
        if (!imported) return imported.error();
        return ChosenLibrary{std::move(imported.value().groups), *named};
    }
    PollRunLoop loop;
    const auto own = UserLibrary::open({.loop = loop, .report = report});
    if (!own) return own.error();
    return ChosenLibrary{own.value()->manager().snippetGroups(), own.value()->path()};
}

}  // namespace plume
