#include "ports/posix/store/SqliteLibraryStorage.h"

#include <utility>

#include "ports/posix/store/SqliteUserDefaults.h"

namespace plume {

namespace {

using Durability = StoreTransaction::Durability;

constexpr const char* StoredGeneration = "SELECT generation FROM state";

}  // namespace

SqliteLibraryStorage::SqliteLibraryStorage(SqliteConnection& connection, SqliteConnection& saving,
                                           const FileIdentity& file)
    : connection_(connection), saving_(saving), file_(file), lastSeen_(connection.integer(StoredGeneration)) {}

Result<LibraryStorage::Stored> SqliteLibraryStorage::load() {
    return sqliteResult([this] {
        Stored stored;
        // One moment for all three.
        connection_.run("BEGIN");
        try {
            stored.generation = connection_.integer(StoredGeneration);
            SqliteStatement archive(connection_, "SELECT value FROM settings WHERE key = ?");
            if (archive.bindText(1, LibraryKey).step()) stored.archive = archive.bytes(0);
            SqliteStatement journal(connection_, "SELECT entry FROM journal ORDER BY generation");
            while (journal.step()) stored.journal.push_back(journal.bytes(0));
        } catch (const SqliteError&) {
            sqlite3_exec(connection_.handle(), "ROLLBACK", nullptr, nullptr, nullptr);
            throw;
        }
        connection_.run("COMMIT");
        connection_.freePages();
        return stored;
    });
}

bool SqliteLibraryStorage::isOutdated(Generation basedOn, Generation stored) const {
    const std::lock_guard lock(mutex_);
    if (basedOn > stored || basedOn < savedUpTo_) return true;
    const auto later = std::distance(own_.upper_bound(basedOn), own_.upper_bound(stored));
    return later != stored - basedOn;
}

bool SqliteLibraryStorage::isOwn(Generation generation) const {
    const std::lock_guard lock(mutex_);
    return own_.contains(generation) || generation <= savedUpTo_;
}

LibraryStorage::Written SqliteLibraryStorage::write(SqliteConnection& connection, Durability durability,
                                                    Generation basedOn, const Write& write) {
    return sqliteResult([&]() -> Outcome {
        StoreTransaction transaction(connection, file_, durability);
        const Generation stored = connection.integer(StoredGeneration);
        if (isOutdated(basedOn, stored)) return Outdated();
        const Generation next = stored + 1;
        SqliteStatement(connection, "UPDATE state SET generation = ?").bind(1, next).step();
        write(next);
        // Before it can be seen: this process's other thread must not take it for another process's.
        setOwn(next, true);
        try {
            transaction.commit();
        } catch (const SqliteError&) {
            setOwn(next, false);
            throw;
        }
        return next;
    });
}

void SqliteLibraryStorage::setOwn(Generation generation, bool isOwn) {
    const std::lock_guard lock(mutex_);
    if (isOwn) {
        own_.insert(generation);
    } else {
        own_.erase(generation);
    }
}

LibraryStorage::Written SqliteLibraryStorage::append(std::string_view journalEntry, Generation basedOn) {
    return write(connection_, Durability::Process, basedOn, [&](Generation next) {
        SqliteStatement(connection_, "INSERT INTO journal VALUES(?, ?)")
            .bind(1, next)
            .bindBytes(2, journalEntry)
            .step();
    });
}

LibraryStorage::Written SqliteLibraryStorage::save(std::string_view archive, Generation basedOn) {
    auto saved = write(saving_, Durability::Disk, basedOn, [&](Generation) {
        SqliteStatement(saving_, "INSERT OR REPLACE INTO settings VALUES(?, ?)")
            .bindText(1, LibraryKey)
            .bindBytes(2, archive)
            .step();
        SqliteStatement(saving_, "DELETE FROM journal WHERE generation <= ?").bind(1, basedOn).step();
    });
    saving_.freePages();
    if (saved && std::holds_alternative<Generation>(saved.value())) {
        const std::lock_guard lock(mutex_);
        savedUpTo_ = basedOn;
        own_.erase(own_.begin(), own_.upper_bound(basedOn));
    }
    return saved;
}

Subscription SqliteLibraryStorage::addObserver(std::function<void()> changedByAnotherProcess) {
    return observers_.add(std::move(changedByAnotherProcess));
}

Result<void> SqliteLibraryStorage::takeOver() {
    const auto stored = sqliteResult([this] { return connection_.integer(StoredGeneration); });
    if (!stored) return stored.error();
    bool byAnother = false;
    for (; lastSeen_ < stored.value() && !byAnother; ++lastSeen_) byAnother = !isOwn(lastSeen_ + 1);
    lastSeen_ = stored.value();
    if (byAnother) observers_.call();
    return {};
}

}  // namespace plume
