// Who is running, and who has the keyboard.
#pragma once

#include <compare>
#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "platform/Accessibility.h"

namespace plume {

// Names a process for as long as the session lives; 0/0 names none.
struct ProcessSerialNumber {
    std::uint32_t highLongOfPSN = 0;
    std::uint32_t lowLongOfPSN = 0;

    auto operator<=>(const ProcessSerialNumber&) const = default;
};

// What the system knows of a running application.
struct RunningApplication {
    std::int64_t processIdentifier = 0;
    std::optional<std::u16string> bundleIdentifier;
    std::optional<std::u16string> localizedName;
    std::optional<std::u16string> executableURL;  // where its program lies, as a path
};

// A program that listens to the keyboard.
struct EventTapInformation {
    bool isActiveFilter = false;  // it can swallow keys
    RunningApplication tappingProcess;
};

// Called on the tap thread for every key, so answers come from what is already known and never wait for a program.
class ProcessManager {
  public:
    virtual ~ProcessManager() = default;
    virtual ProcessSerialNumber currentProcess() const = 0;
    // The process that has the keyboard, or nothing.
    virtual std::optional<ProcessSerialNumber> frontProcess() const = 0;
    // Which of its windows has the keyboard: another number, another window; 0 when the port does not tell.
    virtual std::uint32_t frontWindow() const { return 0; }
    // Where that window stands, in the pixels of the screen from its top left, without its frame; nothing when that is
    // not known. Asks the system.
    virtual std::optional<Rectangle> frontWindowBounds() const { return std::nullopt; }
    // Asks for this window, as frontWindow() names it, to get the keyboard; that may take a moment, or never happen.
    virtual void activateWindow(std::uint32_t window) = 0;
    // Whether a key that is pressed now would arrive in this window. Asks the system, and is no question for a key.
    virtual bool keysArriveIn(std::uint32_t window) const = 0;
    // Nothing when the process is gone or is no application.
    virtual std::optional<RunningApplication> runningApplication(ProcessSerialNumber process) const = 0;
    // Those that have windows, without Plume itself; none when the port cannot tell. May take milliseconds.
    virtual std::vector<RunningApplication> runningApplications() const = 0;
    // Asks for the process to be brought to the front; a port may take a moment to do it.
    virtual void bringToFront(ProcessSerialNumber process) = 0;
    // Who else listens to the keyboard, as far as the system tells; at most 10. May take milliseconds: not for a key.
    virtual std::vector<EventTapInformation> eventTaps() const = 0;
};

}  // namespace plume
