// What a port has to show for the suites of files and of their watcher to be run on it.
#pragma once

#include <filesystem>
#include <functional>

#include "platform/FileWatcher.h"
#include "platform/Files.h"
#include "tests/contract/ContractDesk.h"

namespace plume {

class ContractFiles {
  public:
    virtual ~ContractFiles() = default;
    virtual Files& files() = 0;
    virtual FileWatcher& watcher() = 0;
    // An empty folder for the test.
    virtual std::filesystem::path folder() = 0;
    // Lets the main loop work until the condition holds; false when it does not in good time.
    virtual bool runUntil(const std::function<bool()>& condition) = 0;
    // A folder with all that is in it goes, or gets another name.
    virtual void removeAll(const std::filesystem::path& folder) = 0;
};

class FilesContract : public testing::TestWithParam<ContractPort<ContractFiles>> {
  protected:
    std::unique_ptr<ContractFiles> bench_ = GetParam().make();
    Files& files_ = bench_->files();
    const std::filesystem::path folder_ = bench_->folder();
};

class FileWatcherContract : public FilesContract {
  protected:
    // Waits until the watcher has told once more.
    bool hears() {
        const int before = calls_;
        return bench_->runUntil([&] { return calls_ > before; });
    }
    Subscription watch(const std::filesystem::path& file) {
        return bench_->watcher().watch(file, [this] { ++calls_; });
    }
    int calls_ = 0;
};

}  // namespace plume
