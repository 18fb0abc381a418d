#include "app/cli/RunSources.h"

#include <algorithm>
#include <filesystem>
#include <numeric>
#include <utility>

#include "library/KnownSettings.h"
#include "library/SettingsFile.h"

namespace plume {

namespace {

bool isSyncSetting(const std::string& key) {
    return key == "SyncEnabled" || key == "SyncDirectory" || key == "SyncDirectoryType";
}

}  // namespace

RunSources::RunSources(Options options)
    : options_(std::move(options)), watcher_(options_.loop), background_(options_.loop) {}

Result<std::unique_ptr<RunSources>> RunSources::open(Options options) {
    std::unique_ptr<RunSources> sources(new RunSources(std::move(options)));
    if (!sources->options_.file) {
        if (const auto opened = sources->openLibrary(); !opened) return opened.error();
    }
    sources->openSettings();
    return sources;
}

RunSources::~RunSources() {
    background_.finish();
    if (!own_) return;
    if (const auto saved = own_->manager().saveRest(); !saved) options_.report(saved.error().message);
}

Result<void> RunSources::openLibrary() {
    auto opened = UserLibrary::open({
        .loop = options_.loop,
        .report = options_.report,
        .inBackground = [this](std::function<void()> work,
                               std::function<void()> done) { background_.begin(std::move(work), std::move(done)); },
        .loadPreferences =
            [this] {
                if (settingsChanged_) settingsChanged_();
            },
        .offerBackup = [this](const std::optional<Files::Path>& newest) { offerBackup(newest); },
    });
    if (!opened) return opened.error();
    own_ = std::move(opened).value();
    return {};
}

void RunSources::openSettings() {
    settings_ = options_.fileSettings;
    if (settings_) return;
    if (!own_) {
        auto opened = openUserStore(watcher_);
        if (!opened) {
            options_.report(opened.error().message);
        } else {
            for (const std::string& problem : opened.value().problems) options_.report(problem);
            store_ = std::move(opened.value().store);
        }
    }
    if (WritableUserDefaults* own = writableSettings()) {
        settings_ = std::shared_ptr<const UserDefaults>(own, [](const UserDefaults*) {});
    } else {
        settings_ = SettingsFile::registeredDefaults();
    }
}

const SnippetGroups& RunSources::groups() const {
    return options_.file ? options_.file->groups() : own_->manager().snippetGroups();
}

PropertyList::Dictionary RunSources::settings() const {
    PropertyList::Dictionary values;
    for (const KnownSetting& setting : knownSettings()) {
        if (auto value = settings_->objectForKey(setting.name)) values.emplace(setting.name, *std::move(value));
    }
    return values;
}

WritableUserDefaults* RunSources::writableSettings() {
    if (options_.fileSettings) return nullptr;
    if (own_) return &own_->settings();
    return store_ ? &store_->settings() : nullptr;
}

std::string RunSources::description() const {
    const SnippetGroups& all = groups();
    const std::size_t count =
        std::accumulate(all.begin(), all.end(), std::size_t{0},
                        [](std::size_t sum, const auto& group) { return sum + group->items().size(); });
    return std::to_string(count) + " snippets from " + (options_.file ? options_.file->path() : own_->path()).string();
}

void RunSources::begin(std::function<void()> groupsChanged, std::function<void()> settingsChanged) {
    groupsChanged_ = std::move(groupsChanged);
    settingsChanged_ = std::move(settingsChanged);
    if (WritableUserDefaults* settings = writableSettings()) {
        settingsObserver_ = settings->changedEvent.addObserver(this, &RunSources::settingsReplaced);
    }
    if (options_.file) return options_.file->follow(watcher_, groupsChanged_, options_.report);
    DataManager& manager = own_->manager();
    imported_ = manager.didImportDataEvent.addObserver(this, &RunSources::libraryReplaced);
    synced_ = manager.didSyncDataEvent.addObserver(this, &RunSources::libraryReplaced);
    // Another process may have been faster than the start.
    groupsChanged_();
    manager.sync().loadSyncPreferences(false);
    manager.backups().startAutoBackupTimer();
}

void RunSources::settingsReplaced(UserDefaultsChange& change) {
    if (own_ && own_->manager().sync().updatingPreferences()) return;
    settingsChanged_();
    const bool syncChanged = std::any_of(change.keys.begin(), change.keys.end(), isSyncSetting);
    if (own_ && syncChanged) own_->manager().sync().loadSyncPreferences(false);
}

void RunSources::offerBackup(const std::optional<Files::Path>& newest) {
    if (!newest) return;
    options_.notices.show(
        {"The library was damaged",
         "The newest backup is " + newest->filename().string() +
             ". What could not be read is kept beside it. \"plume restore latest\" restores it later, "
             "too.",
         {{"Restore", [this, newest] {
               const auto restored = own_->manager().restoreFile(*newest);
               if (!restored) options_.report(restored.error().message);
           }}}});
}

}  // namespace plume
