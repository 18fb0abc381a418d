// Who has the keyboard, as the window manager tells it.
//
// Belongs to the tap thread. Everything is asked of the X server, never of a program, and kept until the server tells
// of a change: in between, an answer costs no round trip. Without a window manager the input focus decides.
#pragma once

#include <atomic>
#include <functional>
#include <map>
#include <memory>
#include <string>
#include <vector>

#include "platform/ProcessManager.h"
#include "ports/x11/X11Session.h"
#include "ports/x11/windows/DesktopFiles.h"

namespace plume {

class X11ProcessManager final : public ProcessManager {
  public:
    // The session outlives the process manager.
    X11ProcessManager(X11Session& session, std::shared_ptr<const DesktopFiles> desktopFiles);
    X11ProcessManager(const X11ProcessManager&) = delete;
    X11ProcessManager& operator=(const X11ProcessManager&) = delete;

    // Another window or program may be in front than the last answer said. Called while events are read, so it may only
    // take note; not called again until somebody has asked.
    std::function<void()> frontMayHaveChanged;

    ProcessSerialNumber currentProcess() const override;
    std::optional<ProcessSerialNumber> frontProcess() const override;
    std::uint32_t frontWindow() const override;
    std::optional<Rectangle> frontWindowBounds() const override;
    void activateWindow(std::uint32_t window) override;
    bool keysArriveIn(std::uint32_t window) const override;
    std::optional<RunningApplication> runningApplication(ProcessSerialNumber process) const override;
    std::vector<RunningApplication> runningApplications() const override;
    void bringToFront(ProcessSerialNumber process) override;
    // X does not tell who takes keys: those programs that are known to do it.
    std::vector<EventTapInformation> eventTaps() const override;

    // The windows of this process count as this program's own; 0: of none. From any thread.
    void setHelperProcess(pid_t process) { helperProcess_ = process; }

    // How often something had to be asked of the server since the start: for tests and measurements.
    int lookUps() const { return lookUps_; }

  private:
    struct Application {
        RunningApplication description;
        xcb_window_t window = XCB_WINDOW_NONE;  // where it was seen last
    };

    void hear(const xcb_generic_event_t& event);
    void forgetFront();
    void lookUp();
    xcb_window_t activeWindow();
    xcb_window_t focusedWindow();
    xcb_window_t focusedApplicationWindow();
    void watch(X11Session::WindowEvents& events, xcb_window_t window, std::uint32_t eventMask);
    std::optional<ProcessSerialNumber> processOf(xcb_window_t window);
    ProcessSerialNumber numberOf(const RunningApplication& application, xcb_window_t window);
    std::uint32_t clientOf(xcb_window_t window) const;
    std::vector<xcb_window_t> windowsInStackingOrder() const;
    xcb_window_t windowOf(ProcessSerialNumber process);

    X11Session& session_;
    const std::shared_ptr<const DesktopFiles> desktopFiles_;
    const std::string hostName_;
    bool isKnown_ = false;  // frontProcess_ is up to date
    std::optional<ProcessSerialNumber> frontProcess_;
    X11Session::WindowEvents root_;
    X11Session::WindowEvents manager_;  // the window manager's own window
    X11Session::WindowEvents front_;    // the active window
    X11Session::WindowEvents focus_;    // the focused window, when there is no active one
    mutable std::map<ProcessSerialNumber, Application> applications_;
    std::atomic<pid_t> helperProcess_ = 0;
    int lookUps_ = 0;
    std::vector<Subscription> observers_;
};

}  // namespace plume
