#include "ports/posix/store/SqliteStore.h"

#include "ports/posix/store/StoreFile.h"

namespace plume {

namespace {

// The main thread is not kept waiting for long; a save is worth more.
constexpr double MainBusySeconds = 2;
constexpr double SavingBusySeconds = 10;

// Grows when another connection has written.
constexpr const char* DataVersion = "PRAGMA data_version";

}  // namespace

Result<SqliteStore::Opened> SqliteStore::open(const std::filesystem::path& folder, FileWatcher* watcher) {
    const Result<StoreFile> file = prepareStoreFile(folder);
    if (!file) return file.error();
    return sqliteResult([&] {
        Opened opened;
        opened.store.reset(new SqliteStore(file.value().path, watcher));
        opened.damagedFile = file.value().damaged;
        if (opened.damagedFile) {
            opened.problems.push_back(file.value().path.string() + " was damaged; it is kept as " +
                                      opened.damagedFile->filename().string() + ", and a fresh one takes its place.");
        }
        for (const std::string& key : opened.store->settings_.unreadableKeys()) {
            opened.problems.push_back(file.value().path.string() + ": the setting " + key +
                                      " cannot be read; its default holds.");
        }
        return opened;
    });
}

SqliteStore::SqliteStore(const std::filesystem::path& file, FileWatcher* watcher)
    : connection_(file, MainBusySeconds),
      saving_(file, SavingBusySeconds),
      identity_(file),
      settings_(connection_, identity_),
      library_(connection_, saving_, identity_),
      dataVersion_(connection_.integer(DataVersion)) {
    // What a large archive has made of it is given back.
    saving_.run("PRAGMA journal_size_limit = 4194304");
    if (!watcher) return;
    for (const char* ending : {"", "-wal"}) {
        watching_.push_back(watcher->watch(file.string() + ending, [this] { lookAtChanges(); }));
    }
}

void SqliteStore::lookAtChanges() {
    const auto version = sqliteResult([this] { return connection_.integer(DataVersion); });
    if (!version || version.value() == dataVersion_) return;
    // What cannot be read now is looked at with the next change.
    const bool taken = settings_.takeOver().ok() && library_.takeOver().ok();
    if (taken) dataVersion_ = version.value();
}

}  // namespace plume
