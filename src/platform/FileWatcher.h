// Tells when the file at a path becomes another.
#pragma once

#include <filesystem>
#include <functional>

#include "Foundation/Subscription.h"

namespace plume {

class FileWatcher {
  public:
    virtual ~FileWatcher() = default;
    // Calls from the main loop when the file at this path is written, replaced, removed or appears, also when a folder
    // above it is replaced, vanishes or comes back; several changes may be told by one call, and a call need not mean
    // that the contents differ. Watches until the subscription ends. Nothing need stand at the path. Belongs to the
    // main thread. Where the system cannot watch, the file is looked at every few seconds.
    [[nodiscard]] virtual Subscription watch(const std::filesystem::path& file, std::function<void()> changed) = 0;
};

}  // namespace plume
