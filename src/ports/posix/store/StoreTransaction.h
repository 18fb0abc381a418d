// A change of the store: all of it, or nothing when it goes before commit().
#pragma once

#include <sys/types.h>

#include <filesystem>

#include "ports/posix/store/SqliteConnection.h"

namespace plume {

// Which file stands at the store's path. One that was put into its place by somebody else is not written to.
class FileIdentity {
  public:
    explicit FileIdentity(const std::filesystem::path& path);
    bool operator==(const FileIdentity&) const = default;

  private:
    dev_t disk_ = 0;
    ino_t number_ = 0;
};

class StoreTransaction {
  public:
    // What a change outlives: the end of this process, also one by force; or a power cut, too, which takes the disk's
    // time.
    enum class Durability { Process, Disk };

    // Throws SqliteError, also when the file is not the one that the connection was made to. No other statement of the
    // connection is at work.
    StoreTransaction(SqliteConnection& connection, const FileIdentity& file, Durability durability);
    ~StoreTransaction();
    StoreTransaction(const StoreTransaction&) = delete;
    StoreTransaction& operator=(const StoreTransaction&) = delete;

    // And has other processes look at the file.
    void commit();

  private:
    SqliteConnection& connection_;
    bool isOpen_ = true;
};

}  // namespace plume
