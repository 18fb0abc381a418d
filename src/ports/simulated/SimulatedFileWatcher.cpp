#include "ports/simulated/SimulatedFileWatcher.h"

#include <algorithm>
#include <utility>

namespace plume {

SimulatedFileWatcher::SimulatedFileWatcher(SimulatedFiles& files, RunLoop& loop) : files_(files), loop_(loop) {
    files_.setListener([this](const std::filesystem::path& path) { fire(path); });
}

SimulatedFileWatcher::~SimulatedFileWatcher() {
    files_.setListener({});
}

Subscription SimulatedFileWatcher::watch(const std::filesystem::path& file, std::function<void()> changed) {
    return watched_[file.lexically_normal()].observers.add(std::move(changed));
}

void SimulatedFileWatcher::fire(const std::filesystem::path& path) {
    for (auto& [file, watched] : watched_) {
        if (std::mismatch(path.begin(), path.end(), file.begin(), file.end()).first != path.end()) continue;
        // Changes that come together are told once.
        watched.telling = loop_.performAfterDelay(0, [&told = watched.observers] { told.call(); });
    }
}

}  // namespace plume
