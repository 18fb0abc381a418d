// A stored library in memory. Two of these over one state play two processes.
#pragma once

#include <map>
#include <memory>
#include <mutex>
#include <set>

#include "Foundation/Observers.h"
#include "platform/LibraryStorage.h"
#include "platform/RunLoop.h"

namespace plume {

class SimulatedLibraryStorage final : public LibraryStorage {
  public:
    // What the processes share: the disk. From any thread.
    class Disk {
      public:
        // Every further operation fails with this error; nothing: none does any more.
        void setFailure(std::optional<Error> failure);

      private:
        friend class SimulatedLibraryStorage;
        std::mutex mutex_;
        std::optional<Error> failure_;  // guarded by mutex_, as is all below
        std::optional<std::string> archive_;
        std::map<Generation, std::string> journal_;
        Generation generation_ = 0;
        std::set<SimulatedLibraryStorage*> users_;
    };

    // The loop outlives it.
    explicit SimulatedLibraryStorage(RunLoop& loop, std::shared_ptr<Disk> disk = std::make_shared<Disk>());
    ~SimulatedLibraryStorage() override;
    SimulatedLibraryStorage(const SimulatedLibraryStorage&) = delete;
    SimulatedLibraryStorage& operator=(const SimulatedLibraryStorage&) = delete;

    Result<Stored> load() override;
    Written append(std::string_view journalEntry, Generation basedOn) override;
    Written save(std::string_view archive, Generation basedOn) override;
    [[nodiscard]] Subscription addObserver(std::function<void()> changedByAnotherProcess) override;

    Disk& disk() { return *disk_; }

  private:
    // With the disk's lock held.
    bool isOutdated(Generation basedOn) const;
    Generation noteWrite();

    RunLoop& loop_;
    const std::shared_ptr<Disk> disk_;
    std::set<Generation> own_;  // guarded by the disk's lock
    Generation savedUpTo_ = 0;  // the same
    const std::shared_ptr<Observers> observers_ = std::make_shared<Observers>();
};

}  // namespace plume
