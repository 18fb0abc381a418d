// The library in the store: its archive is the row "Data" of the settings, its journal a table of its own.
#pragma once

#include <mutex>
#include <set>

#include "Foundation/Observers.h"
#include "platform/LibraryStorage.h"
#include "ports/posix/store/StoreTransaction.h"

namespace plume {

class SqliteLibraryStorage final : public LibraryStorage {
  public:
    // All of them outlive it; only save() uses `saving`.
    SqliteLibraryStorage(SqliteConnection& connection, SqliteConnection& saving, const FileIdentity& file);

    Result<Stored> load() override;
    Written append(std::string_view journalEntry, Generation basedOn) override;
    Written save(std::string_view archive, Generation basedOn) override;
    [[nodiscard]] Subscription addObserver(std::function<void()> changedByAnotherProcess) override;

    // Something has written: tells the observers when it was another process.
    Result<void> takeOver();

  private:
    using Write = std::function<void(Generation next)>;
    Written write(SqliteConnection& connection, StoreTransaction::Durability durability, Generation basedOn,
                  const Write& write);
    bool isOutdated(Generation basedOn, Generation stored) const;
    bool isOwn(Generation generation) const;
    void setOwn(Generation generation, bool isOwn);

    SqliteConnection& connection_;
    SqliteConnection& saving_;
    const FileIdentity& file_;
    Observers observers_;
    Generation lastSeen_ = 0;
    mutable std::mutex mutex_;
    std::set<Generation> own_;  // guarded by mutex_, as is what follows; those after savedUpTo_
    Generation savedUpTo_ = 0;
};

}  // namespace plume
