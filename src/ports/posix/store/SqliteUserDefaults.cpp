#include "ports/posix/store/SqliteUserDefaults.h"

#include <set>
#include <utility>

#include "Foundation/archive/PropertyListReader.h"
#include "Foundation/archive/PropertyListWriter.h"

namespace plume {

SqliteUserDefaults::SqliteUserDefaults(SqliteConnection& connection, const FileIdentity& file)
    : connection_(connection), file_(file), own_(readRows()) {}

PropertyList::Dictionary SqliteUserDefaults::readRows() {
    PropertyList::Dictionary rows;
    unreadableKeys_.clear();
    SqliteStatement select(connection_, "SELECT key, value FROM settings WHERE key <> ?");
    select.bindText(1, LibraryKey);
    while (select.step()) {
        auto value = readPropertyList(select.bytes(1));
        if (value) {
            rows.emplace(select.bytes(0), std::move(value).value());
        } else {
            unreadableKeys_.push_back(select.bytes(0));
        }
    }
    return rows;
}

std::optional<PropertyList> SqliteUserDefaults::find(std::string_view key) const {
    for (const auto* values : {&own_, &registered_}) {
        if (const auto found = values->find(key); found != values->end()) return found->second;
    }
    return std::nullopt;
}

std::optional<PropertyList> SqliteUserDefaults::objectForKey(std::string_view key) const {
    const std::lock_guard lock(mutex_);
    return find(key);
}

void SqliteUserDefaults::registerDefaults(const PropertyList::Dictionary& defaults) {
    const std::lock_guard lock(mutex_);
    for (const auto& [key, value] : defaults) registered_.insert_or_assign(key, value);
}

Result<void> SqliteUserDefaults::refuseLibrary(std::string_view key) const {
    if (key != LibraryKey) return {};
    return Error{connection_.file().string() + ": \"" + LibraryKey + "\" is the library, and no setting"};
}

Result<void> SqliteUserDefaults::setObject(std::string_view key, PropertyList value) {
    if (auto refused = refuseLibrary(key); !refused) return refused;
    auto written = sqliteResult([&] {
        const std::string bytes = binaryPropertyList(value);
        StoreTransaction transaction(connection_, file_, StoreTransaction::Durability::Disk);
        SqliteStatement(connection_, "INSERT OR REPLACE INTO settings VALUES(?, ?)")
            .bindText(1, key)
            .bindBytes(2, bytes)
            .step();
        transaction.commit();
    });
    if (!written) return written;
    PropertyList::Dictionary own = own_;
    own.insert_or_assign(std::string(key), std::move(value));
    replaceOwn(std::move(own), false);
    return {};
}

Result<void> SqliteUserDefaults::removeObject(std::string_view key) {
    if (auto refused = refuseLibrary(key); !refused) return refused;
    auto removed = sqliteResult([&] {
        StoreTransaction transaction(connection_, file_, StoreTransaction::Durability::Disk);
        SqliteStatement(connection_, "DELETE FROM settings WHERE key = ?").bindText(1, key).step();
        transaction.commit();
    });
    if (!removed) return removed;
    PropertyList::Dictionary own = own_;
    if (const auto found = own.find(key); found != own.end()) own.erase(found);
    replaceOwn(std::move(own), false);
    return {};
}

std::vector<std::string> SqliteUserDefaults::ownKeys() const {
    const std::lock_guard lock(mutex_);
    std::vector<std::string> keys;
    keys.reserve(own_.size());
    for (const auto& [key, value] : own_) keys.push_back(key);
    return keys;
}

Result<void> SqliteUserDefaults::takeOver() {
    return sqliteResult([this] { replaceOwn(readRows(), true); });
}

void SqliteUserDefaults::replaceOwn(PropertyList::Dictionary own, bool byAnotherProcess) {
    UserDefaultsChange change{.keys = {}, .byAnotherProcess = byAnotherProcess};
    {
        const std::lock_guard lock(mutex_);
        std::map<std::string, std::optional<PropertyList>> before;
        for (const auto* values : {&own_, &own}) {
            for (const auto& [key, value] : *values) before.try_emplace(key, find(key));
        }
        own_ = std::move(own);
        for (const auto& [key, value] : before) {
            if (find(key) != value) change.keys.push_back(key);
        }
    }
    if (!change.keys.empty()) changedEvent.raise(change);
}

}  // namespace plume
