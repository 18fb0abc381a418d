// Which program is in front and which part of it has the focus: found by the accessibility thread, read by all without
// waiting.
#pragma once

#include <sys/types.h>

#include <atomic>
#include <cstdint>
#include <mutex>
#include <utility>

#include "ports/atspi/AtspiBus.h"

namespace plume {

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

}  // namespace plume
