// The user's settings in the store: a row for each, whose value is a binary property list.
#pragma once

#include <mutex>

#include "platform/UserDefaults.h"
#include "ports/posix/store/StoreTransaction.h"

namespace plume {

// Where the library is kept, which is no setting: it is neither told nor set here.
inline constexpr const char* LibraryKey = "Data";

// Belongs to the main thread, but for reading, which any thread may do.
class SqliteUserDefaults final : public WritableUserDefaults {
  public:
    // The connection outlives it. Throws SqliteError.
    SqliteUserDefaults(SqliteConnection& connection, const FileIdentity& file);

    std::optional<PropertyList> objectForKey(std::string_view key) const override;
    void registerDefaults(const PropertyList::Dictionary& defaults) override;
    Result<void> setObject(std::string_view key, PropertyList value) override;
    Result<void> removeObject(std::string_view key) override;
    std::vector<std::string> ownKeys() const override;

    // Settings whose rows cannot be read; their registered values hold.
    const std::vector<std::string>& unreadableKeys() const { return unreadableKeys_; }
    // Another process may have written: tells what it has changed.
    Result<void> takeOver();

  private:
    PropertyList::Dictionary readRows();
    // With the lock held.
    std::optional<PropertyList> find(std::string_view key) const;
    Result<void> refuseLibrary(std::string_view key) const;
    void replaceOwn(PropertyList::Dictionary own, bool byAnotherProcess);

    SqliteConnection& connection_;
    const FileIdentity& file_;
    std::vector<std::string> unreadableKeys_;
    mutable std::mutex mutex_;
    PropertyList::Dictionary own_;  // guarded by mutex_, as is what follows
    PropertyList::Dictionary registered_;
};

}  // namespace plume
