// The user's own library and settings, opened from where they are kept.
#pragma once

#include <filesystem>
#include <functional>
#include <memory>
#include <optional>
#include <string>

#include "Foundation/Result.h"
#include "library/DataManager.h"
#include "ports/posix/DescriptorLoop.h"
#include "ports/posix/InotifyFileWatcher.h"
#include "ports/posix/PosixFiles.h"
#include "ports/posix/store/SqliteStore.h"

namespace plume {

class UserLibrary {
  public:
    struct Options {
        DescriptorLoop& loop;
        std::function<void(const std::string& sentence)> report;
        // See DataManager::Dependencies.
        std::function<void(std::function<void()> work, std::function<void()> done)> inBackground = {};
        std::function<void()> loadPreferences = {};
        std::function<void(const std::optional<Files::Path>& newestBackup)> offerBackup = {};
        std::function<void(const std::string& folderName)> askFirst = {};
    };

    // With the library loaded. The error says why there is none. The loop outlives it. A library that was damaged is
    // reported, together with the way back.
    static Result<std::unique_ptr<UserLibrary>> open(Options options);
    // The same in two steps: the settings can be used, and the library is there, but empty; then it is loaded.
    static Result<std::unique_ptr<UserLibrary>> openSettings(Options options);
    Result<void> load();
    UserLibrary(const UserLibrary&) = delete;
    UserLibrary& operator=(const UserLibrary&) = delete;

    DataManager& manager() { return *manager_; }
    WritableUserDefaults& settings() { return store_->settings(); }
    Files& files() { return files_; }
    // For messages.
    const std::filesystem::path& path() const { return store_->file(); }

  private:
    explicit UserLibrary(DescriptorLoop& loop) : watcher_(loop) {}
    DataManager::Dependencies dependencies(const Options& options);

    PosixFiles files_;
    InotifyFileWatcher watcher_;
    std::unique_ptr<SqliteStore> store_;
    std::unique_ptr<DataManager> manager_;
    bool storeWasDamaged_ = false;
};

// The store where the user's is, with what holds where the user has set nothing. The watcher outlives it.
Result<SqliteStore::Opened> openUserStore(FileWatcher& watcher);

}  // namespace plume
