// Which part of which program has the focus: written by the accessibility thread, read by all without waiting.
#pragma once

#include <sys/types.h>

#include <atomic>
#include <mutex>

#include "platform/desktop/AtspiObjects.h"

namespace plume {

class AtspiFocus {
  public:
    AtspiPart part() const {
        const std::scoped_lock lock(mutex_);
        return part_;
    }
    bool isPassword() const { return isPassword_; }
    pid_t process() const { return process_; }

    void set(AtspiPart part, bool isPassword, pid_t process) {
        isPassword_ = isPassword;
        process_ = process;
        const std::scoped_lock lock(mutex_);
        part_.swap(part);
    }
    void clear() { set(nullptr, false, 0); }

  private:
    mutable std::mutex mutex_;  // held to copy a pointer, never longer
    AtspiPart part_;
    std::atomic<bool> isPassword_ = false;
    std::atomic<pid_t> process_ = 0;
};

}  // namespace plume
