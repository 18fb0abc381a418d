// Tells of changes of simulated files.
#pragma once

#include <map>

#include "Foundation/Observers.h"
#include "platform/FileWatcher.h"
#include "platform/RunLoop.h"
#include "ports/simulated/SimulatedFiles.h"

namespace plume {

// The files and the loop outlive it; files have one watcher at a time. Files that are watched are written on the loop's
// thread.
class SimulatedFileWatcher final : public FileWatcher {
  public:
    SimulatedFileWatcher(SimulatedFiles& files, RunLoop& loop);
    ~SimulatedFileWatcher() override;
    SimulatedFileWatcher(const SimulatedFileWatcher&) = delete;
    SimulatedFileWatcher& operator=(const SimulatedFileWatcher&) = delete;

    [[nodiscard]] Subscription watch(const std::filesystem::path& file, std::function<void()> changed) override;

    // Tells of a change at this path, or of all below a folder, though nothing has changed.
    void fire(const std::filesystem::path& path);

  private:
    struct Watched {
        Observers observers;
        Timer telling;
    };

    SimulatedFiles& files_;
    RunLoop& loop_;
    std::map<std::filesystem::path, Watched> watched_;
};

}  // namespace plume
