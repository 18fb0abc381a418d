// Moments in time, and where the present one comes from.
#pragma once

#include <chrono>
#include <functional>

namespace plume {

// A moment, to the microsecond, in UTC.
using Date = std::chrono::sys_time<std::chrono::microseconds>;

// Now: the system's clock, or the source that a ScopedDateSource has put in its place. From any thread.
Date currentDate();

// Replaces the source of currentDate() while it lives; scenarios and tests run on virtual time through it. Made and
// destroyed on one thread while no other asks for the date. Scopes nest.
class ScopedDateSource {
  public:
    explicit ScopedDateSource(std::function<Date()> source);
    ~ScopedDateSource();
    ScopedDateSource(const ScopedDateSource&) = delete;
    ScopedDateSource& operator=(const ScopedDateSource&) = delete;

  private:
    std::function<Date()> previous_;
};

}  // namespace plume
