#include "ports/simulated/SimulatedProcessManager.h"

#include <utility>

namespace plume {

SimulatedProcessManager::SimulatedProcessManager() : own_(launch(u"org.plume.Plume", u"Plume")) {}

ProcessSerialNumber SimulatedProcessManager::launch(std::optional<std::u16string> bundleIdentifier,
                                                    std::optional<std::u16string> localizedName) {
    ++launched_;
    const ProcessSerialNumber process{0, launched_};
    running_[process] = {1000 + static_cast<std::int64_t>(launched_), std::move(bundleIdentifier),
                         std::move(localizedName), std::nullopt};
    return process;
}

void SimulatedProcessManager::terminate(ProcessSerialNumber process) {
    running_.erase(process);
    if (front_ == process) front_.reset();
}

void SimulatedProcessManager::activateWindow(std::uint32_t window) {
    const ProcessSerialNumber process{0, window};
    if (followsActivation_ && running_.contains(process)) front_ = process;
}

std::optional<RunningApplication> SimulatedProcessManager::runningApplication(ProcessSerialNumber process) const {
    ++queries_;
    const auto found = running_.find(process);
    if (found == running_.end()) return std::nullopt;
    return found->second;
}

std::vector<RunningApplication> SimulatedProcessManager::runningApplications() const {
    std::vector<RunningApplication> others;
    for (const auto& [process, application] : running_) {
        if (process != own_) others.push_back(application);
    }
    return others;
}

}  // namespace plume
