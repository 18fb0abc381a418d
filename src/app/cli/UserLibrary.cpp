#include "app/cli/UserLibrary.h"

#include <cstdlib>
#include <utility>

#include "app/cli/Files.h"
#include "content/OldSyntax.h"
#include "import/Importers.h"
#include "library/KnownSettings.h"

namespace plume {

namespace {

std::filesystem::path homeFolder() {
    const char* const home = std::getenv("HOME");
    return home && *home == '/' ? home : "";
}

// Those of a Macintosh are there for whoever brought their home folder along.
DataManager::Places places() {
    const std::filesystem::path home = homeFolder();
    const std::filesystem::path configuration = configurationFolder();
    DataManager::Places places;
    places.sampleLibrary = dataFolder() / "sample-library.json";
    places.ownEarlierLibrary = configuration / "library.json";
    places.damagedFiles = configuration;
    if (home.empty()) return places;
    places.textExpanderSettings = home / "Library/Application Support/TextExpander/Settings.textexpander";
    places.systemSubstitutions = home / "Library/Preferences/.GlobalPreferences.plist";
    return places;
}

}  // namespace

Result<SqliteStore::Opened> openUserStore(FileWatcher& watcher) {
    if (configurationFolder().empty()) return Error{"there is no home folder to keep the library in: set HOME"};
    auto opened = SqliteStore::open(configurationFolder(), &watcher);
    if (opened) opened.value().store->settings().registerDefaults(registeredSettings(backupFolder()));
    return opened;
}

Result<std::unique_ptr<UserLibrary>> UserLibrary::open(Options options) {
    auto opened = openSettings(std::move(options));
    if (!opened) return opened;
    if (const auto loaded = opened.value()->load(); !loaded) return loaded.error();
    return opened;
}

Result<std::unique_ptr<UserLibrary>> UserLibrary::openSettings(Options options) {
    std::unique_ptr<UserLibrary> library(new UserLibrary(options.loop));
    auto opened = openUserStore(library->watcher_);
    if (!opened) return opened.error();
    for (const std::string& problem : opened.value().problems) options.report(problem);
    library->store_ = std::move(opened.value().store);
    library->storeWasDamaged_ = opened.value().damagedFile.has_value();
    library->manager_ = std::make_unique<DataManager>(library->dependencies(options));
    return library;
}

Result<void> UserLibrary::load() {
    return manager_->loadAutoTextData(storeWasDamaged_);
}

DataManager::Dependencies UserLibrary::dependencies(const Options& options) {
    const auto offer = [report = options.report, also = options.offerBackup](const auto& newest) {
        report(newest ? "The newest backup is " + newest->string() + "; plume restore latest brings it back."
                      : std::string("There is no backup of it."));
        if (also) also(newest);
    };
    return {.settings = store_->settings(),
            .storage = store_->library(),
            .files = files_,
            .watcher = watcher_,
            .loop = options.loop,
            .places = places(),
            .import = [this](const Files::Path& path) { return importLibrary(path, files_); },
            .convertOldSnippet = convertOldSnippet,
            .report = options.report,
            .inBackground = options.inBackground,
            .loadPreferences = options.loadPreferences,
            .offerBackup = offer,
            .askFirst = options.askFirst};
}

}  // namespace plume
