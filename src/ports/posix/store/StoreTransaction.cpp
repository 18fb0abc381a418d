#include "ports/posix/store/StoreTransaction.h"

#include <fcntl.h>
#include <sys/stat.h>

namespace plume {

FileIdentity::FileIdentity(const std::filesystem::path& path) {
    struct stat status {};
    if (stat(path.c_str(), &status) != 0) return;
    disk_ = status.st_dev;
    number_ = status.st_ino;
}

StoreTransaction::StoreTransaction(SqliteConnection& connection, const FileIdentity& file, Durability durability)
    : connection_(connection) {
    if (FileIdentity(connection.file()) != file) {
        throw SqliteError(connection.file(), SQLITE_READONLY,
                          "it was removed or replaced while Plume was running; start Plume again");
    }
    connection.run(durability == Durability::Disk ? "PRAGMA synchronous = FULL" : "PRAGMA synchronous = NORMAL");
    connection.run("BEGIN IMMEDIATE");
}

StoreTransaction::~StoreTransaction() {
    // Where a failure has ended it already, there is nothing to take back.
    if (isOpen_) sqlite3_exec(connection_.handle(), "ROLLBACK", nullptr, nullptr, nullptr);
}

void StoreTransaction::commit() {
    connection_.run("COMMIT");
    isOpen_ = false;
    // What makes a change visible to others is written to shared memory, of which nobody is told.
    utimensat(AT_FDCWD, connection_.file().c_str(), nullptr, 0);
}

}  // namespace plume
