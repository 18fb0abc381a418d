// The event loop of one thread: delayed calls, and calls handed over from other threads.
#pragma once

#include <cstdint>
#include <functional>

namespace plume {

class RunLoop {
  public:
    using Call = std::function<void()>;
    // Names a delayed call for cancelling; 0 names none.
    using CallId = std::uint64_t;

    virtual ~RunLoop() = default;

    // Seconds since some fixed moment; never goes back.
    virtual double now() const = 0;

    // Calls once, `delay` seconds from now at the earliest, from the loop and never from inside this operation, also
    // for a delay of 0. Calls due at the same moment run in the order they were asked for. Only on the loop's own
    // thread.
    virtual CallId performAfterDelay(double delay, Call call) = 0;
    // Forgets a delayed call; one that has run, or was forgotten already, is no error. Only on the loop's own thread.
    virtual void cancel(CallId id) = 0;

    // Calls on this loop's thread as soon as it can, after what was handed over before. From any thread; never waits.
    virtual void perform(Call call) = 0;
};

}  // namespace plume
