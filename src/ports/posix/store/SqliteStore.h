// Everything that Plume keeps: the settings and the library, in one file, "plume.sqlite3", of the user's alone.
//
// Several processes may work with the same store: each sees at once what another has written. What is written outlives
// the end of the process at any moment. Belongs to the main thread; what its parts allow others says their header.
#pragma once

#include <filesystem>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "Foundation/Result.h"
#include "platform/FileWatcher.h"
#include "ports/posix/store/SqliteLibraryStorage.h"
#include "ports/posix/store/SqliteUserDefaults.h"

namespace plume {

class SqliteStore {
  public:
    struct Opened {
        std::unique_ptr<SqliteStore> store;
        // Sentences for the user: a damaged file was put aside, a setting cannot be read.
        std::vector<std::string> problems;
        // Where the damaged file is.
        std::optional<std::filesystem::path> damagedFile;
    };

    // Makes the folder and the file when they are not there. The watcher outlives the store; without one, other
    // processes' changes are not noticed. Blocks.
    static Result<Opened> open(const std::filesystem::path& folder, FileWatcher* watcher);
    SqliteStore(const SqliteStore&) = delete;
    SqliteStore& operator=(const SqliteStore&) = delete;

    WritableUserDefaults& settings() { return settings_; }
    LibraryStorage& library() { return library_; }
    const std::filesystem::path& file() const { return connection_.file(); }

  private:
    SqliteStore(const std::filesystem::path& file, FileWatcher* watcher);
    void lookAtChanges();

    SqliteConnection connection_;
    SqliteConnection saving_;
    const FileIdentity identity_;
    SqliteUserDefaults settings_;
    SqliteLibraryStorage library_;
    std::int64_t dataVersion_;
    std::vector<Subscription> watching_;
};

}  // namespace plume
