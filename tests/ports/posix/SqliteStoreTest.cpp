#include "ports/posix/store/SqliteStore.h"

#include <fcntl.h>
#include <gmock/gmock.h>
#include <sys/resource.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <array>
#include <csignal>
#include <cstdio>
#include <thread>

#include "ports/posix/InotifyFileWatcher.h"
#include "ports/posix/PosixFiles.h"
#include "tests/support/RunUntil.h"
#include "tests/support/TemporaryFolder.h"

namespace plume {

namespace {

namespace fs = std::filesystem;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

class SqliteStoreTest : public testing::Test {
  protected:
    SqliteStore::Opened openStore(FileWatcher* watcher = nullptr) {
        auto opened = SqliteStore::open(folder_, watcher);
        EXPECT_TRUE(opened) << opened.error().message;
        return std::move(opened).value();
    }
    std::string openError() {
        const auto opened = SqliteStore::open(folder_, nullptr);
        return opened ? "none" : opened.error().message;
    }
    bool runUntil(const std::function<bool()>& condition) { return test::runUntil(loop_, condition); }
    std::vector<std::string> names() {
        std::vector<std::string> names;
        for (const auto& entry : fs::directory_iterator(folder_)) names.push_back(entry.path().filename());
        return names;
    }
    static mode_t modeOf(const fs::path& path) {
        struct stat status {};
        return stat(path.c_str(), &status) == 0 ? status.st_mode & 0777 : 0;
    }

    TemporaryFolder home_;
    const fs::path folder_ = home_.path() / "config/plume";
    const fs::path file_ = folder_ / "plume.sqlite3";
    PollRunLoop loop_;
    InotifyFileWatcher watcher_{loop_};
};

struct Changes {
    explicit Changes(WritableUserDefaults& defaults)
        : subscription(defaults.changedEvent.addObserver(this, &Changes::add)) {}
    void add(UserDefaultsChange& change) {
        for (const std::string& key : change.keys) keys.push_back(key + (change.byAnotherProcess ? " elsewhere" : ""));
    }
    std::vector<std::string> keys;
    Subscription subscription;
};

// A process that counts in the store; its counts are read from a pipe.
class StoreProcess {
  public:
    explicit StoreProcess(const fs::path& folder) {
        const fs::path program = fs::read_symlink("/proc/self/exe").parent_path() / "plume_store_process";
        std::array<int, 2> pipe{};
        if (pipe2(pipe.data(), O_CLOEXEC) != 0) return;
        process_ = fork();
        if (process_ == 0) {
            dup2(pipe[1], STDOUT_FILENO);
            execl(program.c_str(), program.c_str(), folder.c_str(), nullptr);
            _exit(127);
        }
        close(pipe[1]);
        counts_ = fdopen(pipe[0], "r");
    }
    ~StoreProcess() {
        (void)kill();
        if (counts_) (void)fclose(counts_);
    }
    StoreProcess(const StoreProcess&) = delete;
    StoreProcess& operator=(const StoreProcess&) = delete;

    // 0 at the end.
    long nextCount() {
        std::array<char, 32> line{};
        return counts_ && fgets(line.data(), line.size(), counts_) ? std::stol(line.data()) : 0;
    }
    // Gives the last count that it has told.
    long kill() {
        if (process_ > 0) {
            ::kill(process_, SIGKILL);
            waitpid(process_, nullptr, 0);
        }
        process_ = 0;
        long last = 0;
        while (const long count = nextCount()) last = count;
        return last;
    }

  private:
    pid_t process_ = 0;
    FILE* counts_ = nullptr;
};

}  // namespace

TEST_F(SqliteStoreTest, KeepsSettingsOfEveryKind) {
    const PropertyList::Dictionary values{
        {"boolean", true},
        {"integer", std::int64_t{-5}},
        {"number", 0.4},
        {"text", std::u16string(u"a\U0001F600")},
        {"list", PropertyList::Array{std::u16string(u"x"), false}},
        {"dictionary", PropertyList::Dictionary{{"inside", std::int64_t{1}}}},
        {"date", Date(std::chrono::seconds(1'700'000'000))},
        {"data", ArchivedData{std::string("\0\1", 2)}},
    };
    {
        const auto opened = openStore();
        for (const auto& [key, value] : values) EXPECT_TRUE(opened.store->settings().setObject(key, value));
        EXPECT_TRUE(opened.store->settings().setObject("removed", true));
        EXPECT_TRUE(opened.store->settings().removeObject("removed"));
        EXPECT_FALSE(opened.store->settings().setObject("Data", true)) << "the library is no setting";
    }
    const auto opened = openStore();
    EXPECT_THAT(opened.problems, IsEmpty());
    EXPECT_EQ(opened.store->settings().ownKeys().size(), values.size());
    for (const auto& [key, value] : values) EXPECT_EQ(opened.store->settings().objectForKey(key), value) << key;
    opened.store->settings().registerDefaults({{"boolean", false}, {"other", true}});
    EXPECT_TRUE(opened.store->settings().boolForKey("boolean"));
    EXPECT_TRUE(opened.store->settings().boolForKey("other"));
}

TEST_F(SqliteStoreTest, TellsWhatAnotherHasChanged) {
    const auto mine = openStore(&watcher_);
    const auto other = openStore(&watcher_);
    mine.store->settings().registerDefaults({{"changed", std::int64_t{1}}});
    Changes here(mine.store->settings());
    Changes there(other.store->settings());
    for (const bool on : {true, false}) {
        ASSERT_TRUE(other.store->settings().setObject("switch", on));
        EXPECT_TRUE(runUntil([&] { return here.keys.size() == 1; }));
        EXPECT_THAT(here.keys, ElementsAre("switch elsewhere"));
        EXPECT_EQ(mine.store->settings().boolForKey("switch"), on);
        here.keys.clear();
    }
    ASSERT_TRUE(other.store->settings().setObject("changed", std::int64_t{1}));  // what is registered here
    ASSERT_TRUE(other.store->settings().removeObject("switch"));
    EXPECT_TRUE(runUntil([&] { return !here.keys.empty(); }));
    EXPECT_THAT(here.keys, ElementsAre("switch elsewhere"));
    EXPECT_THAT(there.keys, ElementsAre("switch", "switch", "changed", "switch"));
}

TEST_F(SqliteStoreTest, FilesAreTheUsersAlone) {
    const auto opened = openStore();
    ASSERT_TRUE(opened.store->settings().setObject("key", true));
    EXPECT_EQ(modeOf(folder_), 0700U);
    EXPECT_THAT(names(), testing::Contains("plume.sqlite3-wal"));
    for (const std::string& name : names()) EXPECT_EQ(modeOf(folder_ / name), 0600U) << name;
}

TEST_F(SqliteStoreTest, PutsDamagedFilesAside) {
    PosixFiles files;
    const auto zeroed = [](std::string bytes, std::size_t page, char with) {
        return bytes.replace(page * 4096, 4096, 4096, with);
    };
    { (void)openStore().store->library().save(std::string(300'000, 'a'), 0); }
    const std::string whole = files.read(file_).value();
    const struct {
        const char* what;
        std::string bytes;
    } cases[] = {
        {"no database", "This is no database."},
        {"empty", ""},
        {"cut in half", whole.substr(0, whole.size() / 2)},
        {"cut within its first page", whole.substr(0, 50)},
        {"cut within a page", whole.substr(0, whole.size() - 4000)},
        {"first page zeroed", zeroed(whole, 0, '\0')},
        {"a page zeroed", zeroed(whole, 20, '\0')},
        {"garbage in a page", zeroed(whole, 20, '\xA5')},
        {"garbage in the header", "SQLite format 3" + std::string(1, '\0') + zeroed(whole, 0, '\xA5').substr(16)},
    };
    for (const auto& [what, bytes] : cases) {
        SCOPED_TRACE(what);
        ASSERT_TRUE(files.write(file_, bytes));
        const auto opened = openStore();
        ASSERT_TRUE(opened.damagedFile);
        EXPECT_THAT(opened.damagedFile->string(), testing::MatchesRegex(file_.string() + ".damaged-[-0-9]+"));
        EXPECT_EQ(files.read(*opened.damagedFile).value(), bytes);
        EXPECT_THAT(opened.problems, ElementsAre(HasSubstr(opened.damagedFile->filename().string())));
        EXPECT_EQ(opened.store->library().load().value().archive, std::nullopt);
        EXPECT_TRUE(opened.store->settings().setObject("works", true));
    }
    fs::remove(file_);
    ASSERT_TRUE(files.write(file_.string() + "-wal", "left alone"));
    const auto orphaned = openStore();
    EXPECT_EQ(files.read(orphaned.damagedFile->string() + "-wal").value(), "left alone");
    EXPECT_THAT(openStore().problems, IsEmpty());
}

TEST_F(SqliteStoreTest, TellsOfASettingThatCannotBeRead) {
    ASSERT_TRUE(openStore().store->settings().setObject("good", true));
    SqliteConnection(file_, 1).run("INSERT INTO settings VALUES('bad', x'00')");
    const auto opened = openStore();
    EXPECT_THAT(opened.problems, ElementsAre(HasSubstr("the setting bad cannot be read")));
    EXPECT_THAT(opened.store->settings().ownKeys(), ElementsAre("good"));
}

TEST_F(SqliteStoreTest, RefusesWhatANewerPlumeHasWritten) {
    ASSERT_TRUE(openStore().store->settings().setObject("key", true));
    SqliteConnection(file_, 1).run("PRAGMA user_version = 7");
    EXPECT_THAT(openError(), HasSubstr("a newer Plume has written it (its form is 7, this Plume reads up to 1)"));
    SqliteConnection(file_, 1).run("PRAGMA user_version = 1");
    EXPECT_TRUE(openStore().store->settings().boolForKey("key"));
}

TEST_F(SqliteStoreTest, WhatCannotBeWrittenIsToldAndLosesNothing) {
    const auto opened = openStore();
    WritableUserDefaults& settings = opened.store->settings();
    LibraryStorage& library = opened.store->library();
    ASSERT_TRUE(settings.setObject("key", std::int64_t{1}));
    const auto saved = library.save("archive", 0);
    const auto generation = std::get<LibraryStorage::Generation>(saved.value());

    SqliteConnection locking(file_, 1);
    locking.run("BEGIN IMMEDIATE");
    EXPECT_THAT(library.append("entry", generation).error().message, HasSubstr("another program keeps it locked"));
    locking.run("ROLLBACK");

    rlimit before{};
    getrlimit(RLIMIT_FSIZE, &before);
    const auto handler = std::signal(SIGXFSZ, SIG_IGN);
    const rlimit small{4096, before.rlim_max};
    setrlimit(RLIMIT_FSIZE, &small);
    EXPECT_THAT(settings.setObject("key", std::int64_t{2}).error().message, HasSubstr(file_.string()));
    EXPECT_FALSE(library.append(std::string(100'000, 'e'), generation));
    EXPECT_FALSE(library.save(std::string(100'000, 'a'), generation));
    setrlimit(RLIMIT_FSIZE, &before);
    (void)std::signal(SIGXFSZ, handler);

    EXPECT_EQ(settings.integerForKey("key"), 1);
    EXPECT_EQ(library.load().value().archive, "archive");
    EXPECT_THAT(library.load().value().journal, IsEmpty());
    EXPECT_TRUE(settings.setObject("key", std::int64_t{3}));
    EXPECT_TRUE(library.append("entry", generation));

    fs::rename(file_, folder_ / "moved");
    EXPECT_THAT(settings.setObject("key", std::int64_t{4}).error().message, HasSubstr("removed or replaced"));
}

TEST_F(SqliteStoreTest, KeepsWhatProcessesHaveWrittenThatAreKilled) {
    constexpr int Kills = 30;
    long told = 0;
    for (int number = 0; number < Kills; ++number) {
        StoreProcess process(folder_);
        // Somewhere in the middle of something.
        for (int count = 0; count < 1 + number % 9; ++count) told = std::max(told, process.nextCount());
        std::this_thread::sleep_for(std::chrono::microseconds(137 * number));
        told = std::max(told, process.kill());
        ASSERT_GT(told, 0);
        const auto opened = openStore();
        ASSERT_THAT(opened.problems, IsEmpty());
        const auto stored = opened.store->library().load().value();
        const long kept = std::stol(stored.archive.value_or("0")) + static_cast<long>(stored.journal.size());
        EXPECT_TRUE(kept == told || kept == told + 1) << kept << " of " << told;
        EXPECT_LE(opened.store->settings().integerForKey("count"), kept);
        told = kept;
    }
}

TEST_F(SqliteStoreTest, HearsOfAProcessAtWork) {
    const auto opened = openStore(&watcher_);
    int calls = 0;
    const Subscription observer = opened.store->library().addObserver([&] { ++calls; });
    Changes changes(opened.store->settings());
    StoreProcess process(folder_);
    EXPECT_TRUE(runUntil([&] { return calls >= 3 && changes.keys.size() >= 2; }));
    (void)process.kill();
    EXPECT_EQ(changes.keys.front(), "count elsewhere");
}

}  // namespace plume
