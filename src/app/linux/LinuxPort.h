// Everything that Plume uses of a Linux desktop with X11: the ports, in the order in which they need each other, and
// the run loop of the thread that hears the keys.
//
// Owned by whoever runs the program. Opened before either loop runs; then the ports belong to the thread that runs the
// tap loop, but for secure input, which belongs to the one that runs the main loop. Destroyed when neither runs any
// more and nobody uses the ports.
#pragma once

#include <filesystem>
#include <functional>
#include <memory>
#include <string>
#include <utility>

#include "Foundation/Result.h"
#include "app/Composition.h"
#include "ports/atspi/AtspiAccessibility.h"
#include "ports/dbus/DesktopNotices.h"
#include "ports/dbus/InputMethodWatch.h"
#include "ports/dbus/SystemSleep.h"
#include "ports/posix/CanberraSounds.h"
#include "ports/posix/HiddenPrompts.h"
#include "ports/posix/PollRunLoop.h"
#include "ports/posix/PosixProcessLauncher.h"
#include "ports/x11/X11Session.h"
#include "ports/x11/clipboard/SharedClipboardCopy.h"
#include "ports/x11/clipboard/X11Pasteboard.h"
#include "ports/x11/keyboard/TapConnection.h"
#include "ports/x11/keyboard/X11EventPoster.h"
#include "ports/x11/keyboard/X11InputSources.h"
#include "ports/x11/keyboard/X11KeyboardTap.h"
#include "ports/x11/keyboard/X11MouseTap.h"
#include "ports/x11/keyboard/X11SecureInput.h"
#include "ports/x11/keyboard/X11SystemHotKeys.h"
#include "ports/x11/keyboard/XkbKeyboard.h"
#include "ports/x11/watchdog/Watchdog.h"
#include "ports/x11/windows/X11ProcessManager.h"

namespace plume {

class LinuxPort {
  public:
    // An empty display means $DISPLAY; `ownSounds` is the folder with Plume's sounds, if there is one. The error says
    // what the desktop lacks, and what to install or to switch on.
    // The main thread's loop outlives the port.
    static Result<std::unique_ptr<LinuxPort>> open(DescriptorLoop& mainLoop, const std::string& display,
                                                   const std::filesystem::path& ownSounds = {});
    // The watchdog, without which the keyboard must not be taken. On the tap thread, or before its loop runs.
    Result<void> startWatchdog();
    LinuxPort(const LinuxPort&) = delete;
    LinuxPort& operator=(const LinuxPort&) = delete;

    Composition::Ports ports();
    AtspiAccessibility& accessibility() { return accessibility_; }
    PollRunLoop& tapLoop() { return tapLoop_; }
    DescriptorLoop& mainLoop() { return mainLoop_; }

    // Told, on the main thread, what a desktop without notices cannot show. Before the loops run.
    void setCannotShowNotice(DesktopNotices::CannotShow cannotShow) { notices_.setCannotShow(std::move(cannotShow)); }
    // What notices say in place of a text. Before the loops run.
    void setNoticeWords(DesktopNotices::Words words) { notices_.setWords(std::move(words)); }
    // Told, on the main thread, when the machine goes to sleep and when it has woken up.
    void setSleepListener(SystemSleep::Listener listener) {
        sleep_ = std::make_unique<SystemSleep>(mainLoop_, std::move(listener));
    }
    // Asked on the main thread: whether a menu of the program's own is open, and holds the keyboard.
    void setKeyboardHeldByUs(std::function<bool()> heldByUs) { secureInput_->setHeldByUs(std::move(heldByUs)); }
    // The program that draws forms runs, with this process number, or does not: 0. From any thread.
    void setFormProcess(std::int64_t process) { processManager_->setHelperProcess(static_cast<pid_t>(process)); }
    // Called once, on the tap thread, when the X server is gone.
    void setServerGone(std::function<void()> listener) { session_->serverGone = std::move(listener); }
    // Last of all, on the tap thread, when its loop has ended: what Plume offers on the clipboard stays there.
    void leave() { pasteboard_->handOver(); }

  private:
    LinuxPort(DescriptorLoop& mainLoop, const std::filesystem::path& ownSounds)
        : mainLoop_(mainLoop), sounds_(ownSounds) {}
    Result<void> begin(const std::string& display);
    Result<void> openKeyboard(const std::string& display);
    Result<void> openDesktop(const std::string& display);
    void connectParts();
    void followFocus();
    void followScreen();
    void tellFrontProcess();
    void focusMayHaveMoved();
    void userMovesFocus(FocusMover mover);

    DescriptorLoop& mainLoop_;
    PollRunLoop tapLoop_;
    PosixProcessLauncher processLauncher_;
    CanberraSounds sounds_;
    DesktopNotices notices_{mainLoop_};
    std::unique_ptr<SystemSleep> sleep_;
    AtspiAccessibility accessibility_;
    HiddenPrompts hiddenPrompts_;
    SharedClipboardCopy clipboardCopy_;
    std::unique_ptr<X11Session> session_;
    X11Session::WindowEvents rootEvents_;
    Subscription screenResized_;
    std::unique_ptr<XkbKeyboard> keyboard_;
    std::unique_ptr<Watchdog> watchdog_;
    std::unique_ptr<TapConnection> tapConnection_;
    std::unique_ptr<InputMethodWatch> inputMethod_;
    std::unique_ptr<X11KeyboardTap> keyboardTap_;
    std::unique_ptr<X11EventPoster> poster_;
    std::unique_ptr<X11MouseTap> mouseTap_;
    std::unique_ptr<X11ProcessManager> processManager_;
    std::unique_ptr<X11Pasteboard> pasteboard_;
    std::unique_ptr<X11InputSources> inputSources_;
    std::unique_ptr<X11SecureInput> secureInput_;
    std::unique_ptr<X11SystemHotKeys> systemHotKeys_;
};

}  // namespace plume
