#include "app/cli/LibraryChoice.h"

#include <filesystem>
#include <utility>

#include "app/cli/UserLibrary.h"
#include "import/Importers.h"
#include "library/KnownSettings.h"
#include "library/SnippetUses.h"
#include "ports/posix/PollRunLoop.h"

namespace plume {

namespace {

std::shared_ptr<MemoryUserDefaults> settingsOfSearch(const UserDefaults* own) {
    auto settings = std::make_shared<MemoryUserDefaults>();
    settings->registerDefaults(registeredSettings());
    for (const char* key :
         {"SnippetQuickSearchSearchBy", "SnippetQuickSearchWildcardSearch", SnippetUses::SwitchKey, SnippetUses::Key}) {
        if (auto value = own ? own->objectForKey(key) : std::nullopt) settings->set(key, *std::move(value));
    }
    return settings;
}

}  // namespace

Result<ChosenLibrary> openLibrary(const std::optional<std::string>& named,
                                  const std::function<void(const std::string&)>& report) {
    if (named) {
        const PosixFiles files;
        auto imported = importLibrary(std::filesystem::absolute(*named), files);
        if (!imported) return imported.error();
        return ChosenLibrary{std::move(imported.value().groups), *named, settingsOfSearch(nullptr)};
    }
    PollRunLoop loop;
    const auto own = UserLibrary::open({.loop = loop, .report = report});
    if (!own) return own.error();
    return ChosenLibrary{own.value()->manager().snippetGroups(), own.value()->path(),
                         settingsOfSearch(&own.value()->settings())};
}

}  // namespace plume
