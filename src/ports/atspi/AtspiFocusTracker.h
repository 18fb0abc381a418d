// Knows what has the focus by asking for it: when somebody says that it may have moved, and while somebody types. With
// nothing going on it does nothing, and sets no timer.
#pragma once

#include <sys/types.h>

#include <atomic>
#include <chrono>
#include <cstddef>
#include <functional>
#include <string>

#include "ports/atspi/AtspiFocus.h"
#include "ports/atspi/AtspiFocusFinder.h"
#include "ports/atspi/AtspiFocusListener.h"
#include "ports/posix/PollRunLoop.h"

namespace plume {

class AtspiFocusTracker {
  public:
    // `address` makes sure that the bus is connected, and tells where it is: nothing when it cannot be.
    using BusAddressSource = std::function<const std::string*()>;
    AtspiFocusTracker(PollRunLoop& loop, AtspiBus& bus, BusAddressSource address);
    AtspiFocusTracker(const AtspiFocusTracker&) = delete;
    AtspiFocusTracker& operator=(const AtspiFocusTracker&) = delete;

    // ---- From any thread, never waiting ----
    const AtspiFocus& focus() const { return focus_; }
    void setFrontProcess(pid_t process);
    void focusMayHaveMoved();
    void userTypes();

    // ---- On the accessibility thread ----
    // What has the focus now, or a moment ago.
    AtspiPart focusedNow();

  private:
    using Clock = std::chrono::steady_clock;

    void lookSeveralTimes();
    void lookAfter(std::size_t step);
    void look();
    void search(const AtspiFocus::Front& front);
    void becomeFocused(const AtspiFocus::Front& front, const AtspiPart& part, pid_t process);
    void listenWhereItHelps(const AtspiFocus::Front& front, const AtspiFocusFinder::Found& found);
    void setPause(std::chrono::milliseconds pause);

    PollRunLoop& loop_;
    AtspiBus& bus_;
    const BusAddressSource address_;
    AtspiFocusFinder finder_;
    AtspiFocusListener listener_;
    AtspiFocus::Front listenedFront_;  // whose focus the listener tells
    pid_t listenedProcess_ = 0;
    AtspiFocus focus_;
    int connection_ = 0;  // the one on which it was found
    Clock::time_point lookedAt_{};
    std::size_t misses_ = 0;            // looks in a row that found nothing, without those of a series
    RunLoop::CallId nextOfSeries_ = 0;  // of looks after a move; 0 after the last one
    // From when on a key makes for a look.
    std::atomic<Clock::rep> nextLook_ = 0;
};

}  // namespace plume
