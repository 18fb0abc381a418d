// The system's files and inotify keep what their interfaces promise, and what Linux asks of them besides.
#include <gmock/gmock.h>
#include <sys/resource.h>
#include <sys/stat.h>

#include <csignal>
#include <cstdlib>

#include "ports/posix/InotifyFileWatcher.h"
#include "ports/posix/PosixFiles.h"
#include "tests/contract/ContractFiles.h"
#include "tests/support/RunUntil.h"
#include "tests/support/TemporaryFolder.h"

namespace plume {

namespace {

namespace fs = std::filesystem;
using testing::HasSubstr;

enum class Inotify { There, UsedUp };

// The process cannot open more files while it lives.
class NoDescriptors {
  public:
    NoDescriptors() {
        getrlimit(RLIMIT_NOFILE, &before_);
        const rlimit none{0, before_.rlim_max};
        setrlimit(RLIMIT_NOFILE, &none);
    }
    ~NoDescriptors() { setrlimit(RLIMIT_NOFILE, &before_); }
    NoDescriptors(const NoDescriptors&) = delete;
    NoDescriptors& operator=(const NoDescriptors&) = delete;

  private:
    rlimit before_{};
};

class PosixFilesBench final : public ContractFiles {
  public:
    explicit PosixFilesBench(Inotify inotify) {
        setenv("XDG_DATA_HOME", (home_.path() / "data").c_str(), 1);
        constexpr double LooksOften = 0.01;
        // A sanitizer that meets the class for the first time needs a descriptor itself.
        watcher_ = std::make_unique<InotifyFileWatcher>(loop_, LooksOften);
        watcher_.reset();
        std::unique_ptr<NoDescriptors> none;
        if (inotify == Inotify::UsedUp) none = std::make_unique<NoDescriptors>();
        watcher_ = std::make_unique<InotifyFileWatcher>(loop_, LooksOften);
    }
    Files& files() override { return files_; }
    FileWatcher& watcher() override { return *watcher_; }
    fs::path folder() override { return work_.path(); }
    bool runUntil(const std::function<bool()>& condition) override { return test::runUntil(loop_, condition); }
    void removeAll(const fs::path& folder) override { fs::remove_all(folder); }

  private:
    TemporaryFolder home_;
    TemporaryFolder work_;
    PosixFiles files_;
    PollRunLoop loop_;
    std::unique_ptr<InotifyFileWatcher> watcher_;
};

ContractPort<ContractFiles> port(const char* name, Inotify inotify) {
    return {name, [inotify] { return std::make_unique<PosixFilesBench>(inotify); }};
}

mode_t modeOf(const fs::path& path) {
    struct stat status {};
    stat(path.c_str(), &status);
    return status.st_mode & 07777;
}

class PosixFilesTest : public testing::Test {
  protected:
    std::string trashed(const std::string& name) { return files_.read(home_.path() / "data/Trash" / name).value(); }
    TemporaryFolder home_;
    TemporaryFolder work_;
    const fs::path folder_ = work_.path();
    PosixFiles files_;
};

class InotifyFileWatcherTest : public FileWatcherContract {};

}  // namespace

INSTANTIATE_TEST_SUITE_P(Posix, FilesContract, testing::Values(port("Posix", Inotify::There)));
INSTANTIATE_TEST_SUITE_P(Posix, FileWatcherContract,
                         testing::Values(port("Inotify", Inotify::There), port("Looking", Inotify::UsedUp)));
INSTANTIATE_TEST_SUITE_P(Posix, InotifyFileWatcherTest,
                         testing::Values(port("Inotify", Inotify::There), port("Looking", Inotify::UsedUp)));

TEST_F(PosixFilesTest, NewFilesAndFoldersAreTheUsersAloneAndOthersKeepTheirModes) {
    ASSERT_TRUE(files_.createFolder(folder_ / "a/b"));
    ASSERT_TRUE(files_.write(folder_ / "a/b/file", "1"));
    EXPECT_EQ(modeOf(folder_ / "a"), 0700U);
    EXPECT_EQ(modeOf(folder_ / "a/b/file"), 0600U);
    fs::permissions(folder_ / "a/b/file", fs::perms(0640));
    ASSERT_TRUE(files_.write(folder_ / "a/b/file", "2"));
    EXPECT_EQ(modeOf(folder_ / "a/b/file"), 0640U);
}

TEST_F(PosixFilesTest, LinksStayAndWhatTheyLeadToIsWritten) {
    ASSERT_TRUE(files_.createFolder(folder_ / "real"));
    fs::create_symlink("real/file", folder_ / "second");
    fs::create_symlink(folder_ / "second", folder_ / "first");
    for (const char* text : {"new", "again"}) {
        ASSERT_TRUE(files_.write(folder_ / "first", text));
        EXPECT_EQ(files_.read(folder_ / "real/file").value(), text);
    }
    EXPECT_TRUE(fs::is_symlink(folder_ / "first") && fs::is_symlink(folder_ / "second"));
    fs::create_symlink("loop", folder_ / "loop");
    EXPECT_FALSE(files_.write(folder_ / "loop", "x"));
}

TEST_F(PosixFilesTest, WhatCannotBeWrittenWholeLeavesTheOldFile) {
    ASSERT_TRUE(files_.write(folder_ / "file", "old"));
    rlimit before{};
    getrlimit(RLIMIT_FSIZE, &before);
    const auto handler = std::signal(SIGXFSZ, SIG_IGN);
    const rlimit small{10, before.rlim_max};
    setrlimit(RLIMIT_FSIZE, &small);
    const auto written = files_.write(folder_ / "file", "longer than ten bytes");
    setrlimit(RLIMIT_FSIZE, &before);
    (void)std::signal(SIGXFSZ, handler);
    ASSERT_FALSE(written);
    EXPECT_THAT(written.error().message, HasSubstr("file cannot be written: File too large"));
    EXPECT_EQ(files_.read(folder_ / "file").value(), "old");
    EXPECT_EQ(files_.list(folder_).value().size(), 1U);
}

TEST_F(PosixFilesTest, ReadsOnlyRegularFiles) {
    ASSERT_EQ(mkfifo((folder_ / "pipe").c_str(), 0600), 0);
    EXPECT_THAT(files_.read(folder_ / "pipe").error().message, HasSubstr("no regular file"));
}

TEST_F(PosixFilesTest, TrashTellsWhereFilesWere) {
    setenv("XDG_DATA_HOME", (home_.path() / "data").c_str(), 1);
    for (const char* text : {"one", "two"}) {
        ASSERT_TRUE(files_.write(folder_ / "a b%ü", text));
        ASSERT_TRUE(files_.moveToTrash(folder_ / "a b%ü"));
    }
    EXPECT_EQ(trashed("files/a b%ü"), "one");
    EXPECT_EQ(trashed("files/a b%ü 2"), "two");
    EXPECT_THAT(trashed("info/a b%ü.trashinfo"),
                testing::MatchesRegex("\\[Trash Info\\]\nPath=" + folder_.string() +
                                      "/a%20b%25%C3%BC\nDeletionDate=....-..-..T..:..:..\n"));
    EXPECT_EQ(modeOf(home_.path() / "data/Trash/info"), 0700U);
}

TEST_P(InotifyFileWatcherTest, FollowsLinksAndFoldersThatAreReplaced) {
    ASSERT_TRUE(files_.createFolder(folder_ / "real/sub"));
    ASSERT_TRUE(files_.createFolder(folder_ / "other/sub"));
    fs::create_directory_symlink("real", folder_ / "link");
    const Subscription watched = watch(folder_ / "link/../link/sub/file");
    ASSERT_TRUE(files_.write(folder_ / "real/sub/file", "1"));
    EXPECT_TRUE(hears()) << "behind the link";
    ASSERT_TRUE(files_.write(folder_ / "other/sub/file", "2"));
    fs::create_directory_symlink("other", folder_ / "new");
    fs::rename(folder_ / "new", folder_ / "link");
    EXPECT_TRUE(hears()) << "another link";
    ASSERT_TRUE(files_.write(folder_ / "other/sub/file", "33"));
    EXPECT_TRUE(hears()) << "behind the other link";
    fs::rename(folder_ / "other", folder_ / "gone");
    EXPECT_TRUE(hears()) << "the folder has gone";
    fs::rename(folder_ / "real", folder_ / "other");
    EXPECT_TRUE(hears()) << "another folder has come";
    ASSERT_TRUE(files_.write(folder_ / "other/sub/file", "4"));
    EXPECT_TRUE(hears()) << "in that folder";
}

TEST_P(InotifyFileWatcherTest, ObserversMayEndAndBeginWatching) {
    int others = 0;
    Subscription other;
    Subscription watched;
    watched = bench_->watcher().watch(folder_ / "file", [&] {
        watched.end();
        other = bench_->watcher().watch(folder_ / "other", [&] { ++others; });
    });
    ASSERT_TRUE(files_.write(folder_ / "file", "1"));
    ASSERT_TRUE(bench_->runUntil([&] { return bench_->files().write(folder_ / "other", "1") && others > 0; }));
}

}  // namespace plume
