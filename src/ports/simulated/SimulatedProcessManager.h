// The simulated desktop's running applications. Plume itself is one of them from the start, and none is in front.
#pragma once

#include <map>
#include <utility>
#include <vector>

#include "platform/ProcessManager.h"

namespace plume {

class SimulatedProcessManager final : public ProcessManager {
  public:
    SimulatedProcessManager();

    // Starts an application and names its process. Its process identifier is chosen here.
    ProcessSerialNumber launch(std::optional<std::u16string> bundleIdentifier,
                               std::optional<std::u16string> localizedName = std::nullopt);
    // The process is known no more; when it was in front, none is.
    void terminate(ProcessSerialNumber process);
    void setFrontProcess(std::optional<ProcessSerialNumber> process) { front_ = process; }

    void setEventTaps(std::vector<EventTapInformation> taps) { eventTaps_ = std::move(taps); }

    // How often somebody asked what a process is.
    int queries() const { return queries_; }

    ProcessSerialNumber currentProcess() const override { return own_; }
    std::optional<ProcessSerialNumber> frontProcess() const override { return front_; }
    std::optional<RunningApplication> runningApplication(ProcessSerialNumber process) const override;
    std::vector<RunningApplication> runningApplications() const override;
    void bringToFront(ProcessSerialNumber process) override { front_ = process; }
    std::vector<EventTapInformation> eventTaps() const override { return eventTaps_; }

  private:
    std::map<ProcessSerialNumber, RunningApplication> running_;
    std::uint32_t launched_ = 0;
    ProcessSerialNumber own_;
    std::optional<ProcessSerialNumber> front_;
    std::vector<EventTapInformation> eventTaps_;
    mutable int queries_ = 0;
};

}  // namespace plume
