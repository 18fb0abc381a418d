// Which program is in front and which part of it has the focus: found by asking, on the accessibility thread, and read
// by all without waiting.
#pragma once

#include <sys/types.h>

#include <atomic>
#include <chrono>
#include <cstddef>
#include <cstdint>
#include <functional>
#include <mutex>
#include <string>
#include <utility>

#include "ports/atspi/AtspiFocusFinder.h"
#include "ports/posix/OwedAnswer.h"

namespace plume {

// What is known of the focus.
class AtspiFocus {
  public:
    // A program for as long as it is in front: what was found for an earlier one no longer holds.
    struct Front {
        pid_t process = 0;  // 0: not known
        std::uint64_t turn = 0;
    };

    Front front() const {
        const std::scoped_lock lock(mutex_);
        return front_;
    }
    AtspiPart part() const {
        const std::scoped_lock lock(mutex_);
        return part_;
    }
    bool isKnown() const { return isKnown_; }
    bool isPassword() const { return isPassword_; }
    pid_t process() const { return process_; }

    // Whether that is another one. Its focus is not known at first.
    bool setFront(pid_t process) {
        const std::scoped_lock lock(mutex_);
        if (front_.process == process) return false;
        front_ = {process, front_.turn + 1};
        change({}, false, 0);
        return true;
    }
    void set(const Front& front, AtspiPart part, bool isPassword, pid_t process) {
        const std::scoped_lock lock(mutex_);
        if (front.turn == front_.turn) change(std::move(part), isPassword, process);
    }
    void forget(const Front& front) { set(front, {}, false, 0); }

  private:
    void change(AtspiPart part, bool isPassword, pid_t process) {
        isKnown_ = static_cast<bool>(part);
        isPassword_ = isPassword;
        process_ = process;
        part_ = std::move(part);
    }

    mutable std::mutex mutex_;  // held to copy two strings, never longer
    Front front_;
    AtspiPart part_;
    std::atomic<bool> isKnown_ = false;
    std::atomic<bool> isPassword_ = false;
    std::atomic<pid_t> process_ = 0;
};

// Asks what has the focus when somebody says that it may have moved, and while somebody types. With nothing going on it
// does nothing, and sets no timer.
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

    // ---- On the tap thread ----
    // Waits for the first look at a program that has come to the front, 50 ms at most and once a program.
    void awaitFirstLook();

    // ---- On the accessibility thread ----
    // What has the focus now, or a moment ago.
    AtspiPart focusedNow();

  private:
    using Clock = std::chrono::steady_clock;

    void lookSeveralTimes();
    void lookAfter(std::size_t step);
    void look();
    void lookAt(const AtspiFocus::Front& front);
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
    std::size_t misses_ = 0;  // looks in a row that found nothing, without those of a series
    Timer nextOfSeries_;      // of looks after a move; none after the last one
    OwedAnswer firstLook_;
    // From when on a key makes for a look.
    std::atomic<Clock::rep> nextLook_ = 0;
};

}  // namespace plume
