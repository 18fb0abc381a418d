// The files and the library in memory keep what their interfaces promise, and fail when they are told to.
#include <gmock/gmock.h>

#include "ports/simulated/SimulatedFileWatcher.h"
#include "ports/simulated/SimulatedLibraryStorage.h"
#include "ports/simulated/SimulatedRunLoop.h"
#include "tests/contract/ContractFiles.h"
#include "tests/contract/ContractStorage.h"

namespace plume {

namespace {

class SimulatedFilesBench final : public ContractFiles {
  public:
    SimulatedFilesBench() { (void)files_.createFolder(folder()); }
    Files& files() override { return files_; }
    FileWatcher& watcher() override { return watcher_; }
    std::filesystem::path folder() override { return "/home/user"; }
    bool runUntil(const std::function<bool()>& condition) override {
        loop_.runReady();
        return condition();
    }
    void removeAll(const std::filesystem::path& folder) override { files_.vanish(folder); }

  private:
    SimulatedFiles files_;
    SimulatedRunLoop loop_;
    SimulatedFileWatcher watcher_{files_, loop_};
};

class SimulatedStorageBench final : public ContractStorage {
  public:
    LibraryStorage& open() override {
        return *processes_.emplace_back(std::make_unique<SimulatedLibraryStorage>(loop_, disk_));
    }
    bool runUntil(const std::function<bool()>& condition) override {
        loop_.runReady();
        return condition();
    }

  private:
    SimulatedRunLoop loop_;
    const std::shared_ptr<SimulatedLibraryStorage::Disk> disk_ = std::make_shared<SimulatedLibraryStorage::Disk>();
    std::vector<std::unique_ptr<SimulatedLibraryStorage>> processes_;
};

const ContractPort<ContractStorage> Storage{"Simulated", [] { return std::make_unique<SimulatedStorageBench>(); }};
const ContractPort<ContractFiles> Port{"Simulated", [] { return std::make_unique<SimulatedFilesBench>(); }};

}  // namespace

INSTANTIATE_TEST_SUITE_P(Simulated, FilesContract, testing::Values(Port));
INSTANTIATE_TEST_SUITE_P(Simulated, FileWatcherContract, testing::Values(Port));
INSTANTIATE_TEST_SUITE_P(Simulated, LibraryStorageContract, testing::Values(Storage));

TEST(SimulatedFilesTest, FailsAsItIsTold) {
    SimulatedFiles files;
    ASSERT_TRUE(files.write("/file", "old"));
    files.setFreeBytes(4);
    EXPECT_FALSE(files.write("/file", "longer"));
    EXPECT_EQ(files.read("/file").value(), "old");
    EXPECT_TRUE(files.write("/file", "four"));
    EXPECT_FALSE(files.write("/file", "x"));
    files.setUnreadable("/file", true);
    EXPECT_FALSE(files.read("/file"));
    files.setModified("/file", std::nullopt);
    EXPECT_EQ(files.list("/").value().at(0).modified, std::nullopt);
    EXPECT_TRUE(files.moveToTrash("/file"));
    EXPECT_EQ(files.trash().at(0).bytes, "four");
}

}  // namespace plume
