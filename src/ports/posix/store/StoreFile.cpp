#include "ports/posix/store/StoreFile.h"

#include <fcntl.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <chrono>
#include <cstdio>
#include <cstring>
#include <ctime>
#include <thread>

#include "Foundation/Date.h"
#include "ports/posix/FileDescriptor.h"
#include "ports/posix/PosixFiles.h"
#include "ports/posix/store/SqliteConnection.h"

namespace plume {

namespace {

using Path = std::filesystem::path;

// The form of the tables below. A newer form gets a higher number, and a step that leads to it from this one.
constexpr std::int64_t Version = 1;
constexpr double BusySeconds = 5;

// "Plum", by which the file is known as Plume's.
constexpr const char* Tables = R"(
PRAGMA journal_mode = WAL;
PRAGMA application_id = 0x506C756D;
BEGIN;
CREATE TABLE settings(key TEXT PRIMARY KEY NOT NULL, value BLOB NOT NULL);
CREATE TABLE journal(generation INTEGER PRIMARY KEY, entry BLOB NOT NULL);
CREATE TABLE state(generation INTEGER NOT NULL);
INSERT INTO state VALUES(0);
PRAGMA user_version = 1;
COMMIT)";
constexpr std::int64_t PlumesId = 0x506C756D;

Path with(const Path& path, const char* ending) {
    return path.string() + ending;
}

SqliteError systemError(const Path& path, int problem) {
    return {path, SQLITE_IOERR, std::strerror(problem)};
}

// Held while the file is examined and put in place; not while it is worked with.
FileDescriptor lockFolder(const Path& folder) {
    const Path path = folder / (std::string(StoreFile::Name) + ".lock");
    FileDescriptor lock(open(path.c_str(), O_RDWR | O_CREAT | O_CLOEXEC, 0600));
    if (!lock.isOpen()) throw systemError(folder / StoreFile::Name, errno);
    constexpr int Tries = 250;
    constexpr std::chrono::milliseconds Pause(20);
    for (int number = 0; flock(lock.get(), LOCK_EX | LOCK_NB) != 0; ++number) {
        if (number == Tries)
            throw SqliteError(folder / StoreFile::Name, SQLITE_BUSY, "another program keeps it locked");
        std::this_thread::sleep_for(Pause);
    }
    return lock;
}

bool isThere(const Path& path) {
    struct stat status {};
    return lstat(path.c_str(), &status) == 0;
}

// An empty file is none of Plume's: a fresh one comes to its place with its tables.
bool isEmpty(const Path& path) {
    struct stat status {};
    return stat(path.c_str(), &status) == 0 && status.st_size == 0;
}

void refuseNewer(const Path& path, std::int64_t version) {
    if (version <= Version) return;
    throw SqliteError(path, SQLITE_MISMATCH,
                      "a newer Plume has written it (its form is " + std::to_string(version) +
                          ", this Plume reads up to " + std::to_string(Version) + "); start that one");
}

// Without what is still to be written into the file, all of its pages are there. SQLite reads the rest of the last one
// as zeros.
bool endsWithinPage(const Path& path, std::int64_t pageSize) {
    struct stat file {};
    struct stat log {};
    const bool isComplete = stat(with(path, "-wal").c_str(), &log) != 0 || log.st_size == 0;
    return isComplete && stat(path.c_str(), &file) == 0 && file.st_size % pageSize != 0;
}

// Throws an error that tells of damage, or of what keeps the file from being read.
void examine(const Path& path) {
    if (isEmpty(path)) throw SqliteError(path, SQLITE_NOTADB, "it is empty");
    SqliteConnection connection(path, BusySeconds);
    connection.leaveAsItIs();
    const std::int64_t version = connection.integer("PRAGMA user_version");
    if (connection.integer("PRAGMA application_id") != PlumesId || version < 1) {
        throw SqliteError(path, SQLITE_NOTADB, "it is no store of Plume's");
    }
    refuseNewer(path, version);
    if (endsWithinPage(path, connection.integer("PRAGMA page_size"))) {
        throw SqliteError(path, SQLITE_CORRUPT, "it ends within a page");
    }
    SqliteStatement check(connection, "PRAGMA quick_check(1)");
    const std::string found = check.step() ? check.bytes(0) : std::string();
    if (found != "ok") throw SqliteError(path, SQLITE_CORRUPT, found);
    constexpr std::int64_t AllTables = 3;
    if (connection.integer("SELECT count(*) FROM sqlite_schema WHERE name IN ('settings', 'journal', 'state')") !=
            AllTables ||
        connection.integer("SELECT count(*) FROM state") != 1) {
        throw SqliteError(path, SQLITE_CORRUPT, "its tables are not all there");
    }
}

Path nameForDamaged(const Path& path) {
    const std::time_t now = std::chrono::system_clock::to_time_t(currentDate());
    std::tm local{};
    localtime_r(&now, &local);
    std::array<char, 64> date{};
    (void)std::strftime(date.data(), date.size(), ".damaged-%Y-%m-%d-%H-%M-%S", &local);
    const Path name = with(path, date.data());
    Path free = name;
    for (int number = 2; isThere(free) || isThere(with(free, "-wal")); ++number) {
        free = with(name, ("-" + std::to_string(number)).c_str());
    }
    return free;
}

// With what was written to it last, which SQLite then finds beside it.
Path putAside(const Path& path) {
    Path aside = nameForDamaged(path);
    for (const char* ending : {"", "-wal"}) {
        const Path from = with(path, ending);
        if (isThere(from) && rename(from.c_str(), with(aside, ending).c_str()) != 0) throw systemError(from, errno);
    }
    unlink(with(path, "-shm").c_str());
    return aside;
}

// Comes to its name with all tables: whatever happens meanwhile, no half of a file is there.
void makeFresh(const Path& path) {
    const Path draft = with(path, ".new");
    for (const char* ending : {"", "-wal", "-shm", "-journal"}) unlink(with(draft, ending).c_str());
    const FileDescriptor made(open(draft.c_str(), O_RDWR | O_CREAT | O_EXCL | O_CLOEXEC, 0600));
    if (!made.isOpen()) throw systemError(path, errno);
    {
        SqliteConnection connection(draft, BusySeconds);
        connection.run(Tables);
    }
    if (rename(draft.c_str(), path.c_str()) != 0) throw systemError(path, errno);
}

// A file that others could read is the user's alone from now on.
void closeToOthers(const Path& path) {
    for (const char* ending : {"", "-wal", "-shm"}) (void)chmod(with(path, ending).c_str(), 0600);
}

StoreFile prepare(const Path& folder) {
    StoreFile file{.path = folder / StoreFile::Name, .damaged = std::nullopt};
    const FileDescriptor lock = lockFolder(folder);
    // What was written to a file that has gone would be taken for a part of the fresh one.
    const bool isOrphaned = !isThere(file.path) && isThere(with(file.path, "-wal"));
    if (isOrphaned) file.damaged = putAside(file.path);
    if (isThere(file.path)) {
        closeToOthers(file.path);
        try {
            examine(file.path);
            return file;
        } catch (const SqliteError& error) {
            if (!error.isDamage()) throw;
        }
        file.damaged = putAside(file.path);
    }
    makeFresh(file.path);
    return file;
}

}  // namespace

Result<StoreFile> prepareStoreFile(const Path& folder) {
    if (auto made = PosixFiles().createFolder(folder); !made) return made.error();
    return sqliteResult([&] { return prepare(folder); });
}

}  // namespace plume
