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
    // Whether a process that is told to come to the front does; it may be busy, or a window manager may refuse.
    void setFollowsActivation(bool follows) { followsActivation_ = follows; }

    // Of whichever is in front.
    void setFrontWindowBounds(std::optional<Rectangle> bounds) { frontWindowBounds_ = bounds; }

    // Whichever process is in front, a dialog of its has the keyboard.
    void setDialogIsInFront(bool isInFront) { dialogIsInFront_ = isInFront; }

    void setEventTaps(std::vector<EventTapInformation> taps) { eventTaps_ = std::move(taps); }

    // How often somebody asked what a process is.
    int queries() const { return queries_; }

    ProcessSerialNumber currentProcess() const override { return own_; }
    std::optional<ProcessSerialNumber> frontProcess() const override { return front_; }
    std::optional<RunningApplication> runningApplication(ProcessSerialNumber process) const override;
    std::vector<RunningApplication> runningApplications() const override;
    // Each process has one window that can be activated, and perhaps a dialog in front of it.
    std::uint32_t frontWindow() const override {
        constexpr std::uint32_t Dialogs = 1000;
        return front_ ? windowOf(*front_) + (dialogIsInFront_ ? Dialogs : 0) : 0;
    }
    std::optional<Rectangle> frontWindowBounds() const override { return frontWindowBounds_; }
    static std::uint32_t windowOf(ProcessSerialNumber process) { return process.lowLongOfPSN; }
    void activateWindow(std::uint32_t window) override;
    bool keysArriveIn(std::uint32_t window) const override { return window != 0 && frontWindow() == window; }
    void bringToFront(ProcessSerialNumber process) override { front_ = process; }
    std::vector<EventTapInformation> eventTaps() const override { return eventTaps_; }

  private:
    std::map<ProcessSerialNumber, RunningApplication> running_;
    std::uint32_t launched_ = 0;
    ProcessSerialNumber own_;
    std::optional<ProcessSerialNumber> front_;
    bool followsActivation_ = true;
    bool dialogIsInFront_ = false;
    std::optional<Rectangle> frontWindowBounds_;
    std::vector<EventTapInformation> eventTaps_;
    mutable int queries_ = 0;
};

}  // namespace plume
