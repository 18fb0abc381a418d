// Where a running Plume has its snippets and settings from: the user's library and settings, or files that were named.
//
// Belongs to the main thread. What it gives away is for the thread that hears the keys, which has records of its own.
#pragma once

#include <functional>
#include <memory>
#include <optional>
#include <string>

#include "Foundation/Result.h"
#include "app/cli/BackgroundWork.h"
#include "app/cli/FollowedLibrary.h"
#include "app/cli/UserLibrary.h"
#include "library/LibraryFeed.h"
#include "platform/Notices.h"

namespace plume {

class RunSources {
  public:
    struct Options {
        FollowedLibrary* file = nullptr;                   // null: the user's library
        std::shared_ptr<const UserDefaults> fileSettings;  // null: the user's settings
        DescriptorLoop& loop;
        Notices& notices;
        std::function<void(const std::string& sentence)> report;
    };

    // The error says why the user's library cannot be opened. Everything outlives this.
    static Result<std::unique_ptr<RunSources>> open(Options options);
    ~RunSources();
    RunSources(const RunSources&) = delete;
    RunSources& operator=(const RunSources&) = delete;

    // What has happened in the library since the last call, the first time all of it; nothing when nothing has.
    std::optional<LibraryUpdate> libraryUpdate() { return feed_.changesTo(groups()); }
    // Every setting that has a value.
    PropertyList::Dictionary settings() const;
    // Where the user's answers can be kept; null when the settings are a file's.
    WritableUserDefaults* writableSettings();
    const UserDefaults& userDefaults() const { return *settings_; }
    // "12 snippets from library.json".
    std::string description() const;

    // From now on changes are told, backups made, and the library is kept in step with the sync folder.
    void begin(std::function<void()> groupsChanged, std::function<void()> settingsChanged);

  private:
    explicit RunSources(Options options);
    Result<void> openLibrary();
    void openSettings();
    const SnippetGroups& groups() const;
    void offerBackup(const std::optional<Files::Path>& newest);
    void libraryReplaced(LibraryEvent&) { groupsChanged_(); }
    void settingsReplaced(UserDefaultsChange& change);

    const Options options_;
    InotifyFileWatcher watcher_;
    BackgroundWork background_;
    std::unique_ptr<UserLibrary> own_;    // null when the library is a file
    std::unique_ptr<SqliteStore> store_;  // for settings alone, when the library is a file
    std::shared_ptr<const UserDefaults> settings_;
    LibraryFeed feed_;
    std::function<void()> groupsChanged_;
    std::function<void()> settingsChanged_;
    Subscription imported_;
    Subscription synced_;
    Subscription settingsObserver_;
};

}  // namespace plume
