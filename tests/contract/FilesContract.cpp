#include <gmock/gmock.h>

#include "tests/contract/ContractFiles.h"

namespace plume {

namespace {

std::vector<std::string> namesIn(const Files& files, const Files::Path& folder) {
    std::vector<std::string> names;
    const auto entries = files.list(folder);
    for (const Files::Entry& entry : entries ? entries.value() : std::vector<Files::Entry>()) {
        names.push_back(entry.name + (entry.isFolder ? "/" : ""));
    }
    return names;
}

}  // namespace

TEST_P(FilesContract, ReadsWhatWasWritten) {
    const std::string bytes = std::string("a\0b\n", 4) + std::string(100'000, 'x');
    for (const std::string& written : {bytes, std::string("short"), std::string()}) {
        ASSERT_TRUE(files_.write(folder_ / "file", written));
        EXPECT_EQ(files_.read(folder_ / "file").value(), written);
    }
    EXPECT_TRUE(files_.exists(folder_ / "file"));
    EXPECT_FALSE(files_.isFolder(folder_ / "file"));
    EXPECT_THAT(namesIn(files_, folder_), testing::ElementsAre("file")) << "something was left beside the file";
}

TEST_P(FilesContract, ReplacesOnlyWhatIsExpected) {
    const auto file = folder_ / "file";
    EXPECT_FALSE(files_.replace(file, "1", "2").value());
    EXPECT_TRUE(files_.replace(file, std::nullopt, "1").value());
    for (const std::optional<std::string>& other : {std::optional<std::string>("0"), std::optional<std::string>()}) {
        EXPECT_FALSE(files_.replace(file, other, "2").value());
    }
    EXPECT_EQ(files_.read(file).value(), "1");
    EXPECT_TRUE(files_.replace(file, "1", "2").value());
    EXPECT_EQ(files_.read(file).value(), "2");
    EXPECT_THAT(namesIn(files_, folder_), testing::ElementsAre("file")) << "something was left beside the file";
}

TEST_P(FilesContract, MakesFoldersWithThoseAboveThem) {
    ASSERT_TRUE(files_.createFolder(folder_ / "a/b/c"));
    EXPECT_TRUE(files_.createFolder(folder_ / "a/b")) << "one that is there";
    EXPECT_TRUE(files_.isFolder(folder_ / "a/b/c"));
    ASSERT_TRUE(files_.write(folder_ / "a/b/c/file", "1"));
    EXPECT_THAT(namesIn(files_, folder_ / "a/b"), testing::ElementsAre("c/"));
    const auto entries = files_.list(folder_ / "a/b/c");
    ASSERT_TRUE(entries);
    EXPECT_LE(entries.value().at(0).modified, currentDate());
}

TEST_P(FilesContract, RemovesAndTrashes) {
    ASSERT_TRUE(files_.createFolder(folder_ / "empty"));
    for (const char* name : {"one", "two"}) ASSERT_TRUE(files_.write(folder_ / name, name));
    EXPECT_TRUE(files_.remove(folder_ / "one"));
    EXPECT_TRUE(files_.moveToTrash(folder_ / "two"));
    EXPECT_TRUE(files_.remove(folder_ / "empty"));
    EXPECT_THAT(namesIn(files_, folder_), testing::IsEmpty());
}

TEST_P(FilesContract, ErrorsNameTheFileAndChangeNothing) {
    ASSERT_TRUE(files_.createFolder(folder_ / "full"));
    ASSERT_TRUE(files_.write(folder_ / "full/file", "1"));
    const auto expectError = [](const auto& result, const Files::Path& path) {
        ASSERT_FALSE(result) << path;
        EXPECT_THAT(result.error().message, testing::HasSubstr(path.string()));
    };
    expectError(files_.read(folder_ / "none"), folder_ / "none");
    expectError(files_.read(folder_ / "full"), folder_ / "full");
    expectError(files_.write(folder_ / "full", "x"), folder_ / "full");
    expectError(files_.write(folder_ / "none/file", "x"), folder_ / "none/file");
    expectError(files_.replace(folder_ / "none/file", std::nullopt, "x"), folder_ / "none/file");
    expectError(files_.createFolder(folder_ / "full/file"), folder_ / "full/file");
    expectError(files_.list(folder_ / "none"), folder_ / "none");
    expectError(files_.list(folder_ / "full/file"), folder_ / "full/file");
    expectError(files_.remove(folder_ / "none"), folder_ / "none");
    expectError(files_.remove(folder_ / "full"), folder_ / "full");
    expectError(files_.moveToTrash(folder_ / "none"), folder_ / "none");
    EXPECT_EQ(files_.read(folder_ / "full/file").value(), "1");
    EXPECT_FALSE(files_.exists(folder_ / "none"));
}

TEST_P(FileWatcherContract, TellsOfAFileThatComesChangesAndGoes) {
    const auto file = folder_ / "file";
    const Subscription watched = watch(file);
    ASSERT_TRUE(files_.write(file, "1"));
    EXPECT_TRUE(hears()) << "came";
    ASSERT_TRUE(files_.write(file, "2"));
    EXPECT_TRUE(hears()) << "changed";
    ASSERT_TRUE(files_.remove(file));
    EXPECT_TRUE(hears()) << "went";
}

TEST_P(FileWatcherContract, TellsOfFoldersAboveThatComeAndGo) {
    const auto file = folder_ / "a/b/file";
    const Subscription watched = watch(file);
    for (int round = 0; round < 3; ++round) {
        ASSERT_TRUE(files_.createFolder(folder_ / "a/b"));
        ASSERT_TRUE(files_.write(file, "1"));
        EXPECT_TRUE(hears()) << "came";
        ASSERT_TRUE(files_.write(file, "2"));
        EXPECT_TRUE(hears()) << "changed";
        bench_->removeAll(folder_ / "a");
        EXPECT_TRUE(hears()) << "went";
    }
}

TEST_P(FileWatcherContract, TellsEachWatcherOfItsOwnFileWhileItWantsTo) {
    Subscription first = watch(folder_ / "first");
    int others = 0;
    const Subscription second = bench_->watcher().watch(folder_ / "second", [&] { ++others; });
    ASSERT_TRUE(files_.write(folder_ / "first", "1"));
    EXPECT_TRUE(hears());
    EXPECT_EQ(others, 0);
    const int before = calls_;
    first.end();
    ASSERT_TRUE(files_.write(folder_ / "first", "2"));
    ASSERT_TRUE(files_.write(folder_ / "second", "2"));
    EXPECT_TRUE(bench_->runUntil([&] { return others > 0; }));
    EXPECT_EQ(calls_, before);
}

}  // namespace plume
