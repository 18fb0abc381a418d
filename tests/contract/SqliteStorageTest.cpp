// The library in the store keeps what platform/LibraryStorage.h promises.
#include "ports/posix/InotifyFileWatcher.h"
#include "ports/posix/store/SqliteStore.h"
#include "tests/contract/ContractStorage.h"
#include "tests/support/RunUntil.h"
#include "tests/support/TemporaryFolder.h"

namespace plume {

namespace {

class SqliteStorageBench final : public ContractStorage {
  public:
    LibraryStorage& open() override {
        return stores_.emplace_back(std::move(SqliteStore::open(folder_.path(), &watcher_).value().store))->library();
    }
    bool runUntil(const std::function<bool()>& condition) override { return test::runUntil(loop_, condition); }

  private:
    TemporaryFolder folder_;
    PollRunLoop loop_;
    InotifyFileWatcher watcher_{loop_};
    std::vector<std::unique_ptr<SqliteStore>> stores_;
};

const ContractPort<ContractStorage> Storage{"Sqlite", [] { return std::make_unique<SqliteStorageBench>(); }};

}  // namespace

INSTANTIATE_TEST_SUITE_P(Sqlite, LibraryStorageContract, testing::Values(Storage));

}  // namespace plume
