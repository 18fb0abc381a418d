#pragma once

#include <poll.h>

#include <algorithm>
#include <chrono>

#include "testing/rig/RigError.h"

namespace plume::rig {

// The end of a bounded wait.
class Deadline {
  public:
    explicit Deadline(Milliseconds bound) : end_(std::chrono::steady_clock::now() + bound) {}

    bool passed() const { return std::chrono::steady_clock::now() >= end_; }

    // Waits until the descriptor can be read (a closed other end counts) or the deadline has passed; true: can be read.
    // Waits at most `atMost` at a time, for conditions that the descriptor does not tell about.
    bool waitReadable(int fd, Milliseconds atMost = Milliseconds::max()) const {
        const auto left = std::chrono::duration_cast<Milliseconds>(end_ - std::chrono::steady_clock::now());
        const auto wait = std::clamp(std::min(left, atMost), Milliseconds(0), Milliseconds(3'600'000));
        pollfd entry{fd, POLLIN, 0};
        return ::poll(&entry, 1, static_cast<int>(wait.count())) > 0;
    }

  private:
    std::chrono::steady_clock::time_point end_;
};

// Waits for a condition that nothing tells about; false when it still does not hold after the bound.
template <typename Condition>
bool waitUntil(Condition holds, Milliseconds bound = Milliseconds(10'000)) {
    const Deadline deadline(bound);
    while (!holds()) {
        if (deadline.passed()) return false;
        poll(nullptr, 0, 5);
    }
    return true;
}

}  // namespace plume::rig
