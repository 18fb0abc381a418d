// Watches files by inotify: the folder of each, and the folders above it and those that links on the way lead to.
//
// A file is looked at every few seconds where inotify cannot watch all of these, or does not see what others write:
// without any watches left, in folders that cannot be read, and on the network.
#pragma once

#include <filesystem>
#include <list>
#include <memory>
#include <optional>
#include <set>
#include <string>
#include <vector>

#include "Foundation/Observers.h"
#include "platform/FileWatcher.h"
#include "ports/posix/DescriptorLoop.h"
#include "ports/posix/FileDescriptor.h"

namespace plume {

class InotifyFileWatcher final : public FileWatcher {
  public:
    static constexpr double TimeBetweenLooks = 3;  // seconds

    // The loop outlives it, and is the thread's own.
    explicit InotifyFileWatcher(DescriptorLoop& loop, double timeBetweenLooks = TimeBetweenLooks);

    [[nodiscard]] Subscription watch(const std::filesystem::path& file, std::function<void()> changed) override;

  private:
    // By which a file is known to have changed when nothing else tells.
    struct Look;
    // A name that leads to the file, in a folder that is watched.
    struct Step {
        int folder = -1;  // inotify's number of it
        std::string name;
        bool isLast = false;
    };
    struct Watched {
        std::filesystem::path file;
        Observers observers;
        std::vector<Step> steps;
        std::shared_ptr<const Look> look;
        bool isLookedAt = false;
        bool hasChanged = false;
    };

    void drain();
    void noteEvent(int folder, const std::string& name, bool isOverflow);
    void tellChanges();
    void watchWay(Watched& watched);
    void addStep(Watched& watched, const std::filesystem::path& folder, const std::string& name, bool isLast);
    static bool noteLook(Watched& watched);
    void forgetUnused();
    void lookAgainLater();
    void lookAtAll();

    DescriptorLoop& loop_;
    const double timeBetweenLooks_;
    FileDescriptor inotify_;
    Subscription source_;
    std::list<Watched> watched_;
    std::set<int> folders_;
    bool isTelling_ = false;
    Timer looking_;
};

}  // namespace plume
