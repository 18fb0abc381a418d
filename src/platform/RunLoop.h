// The event loop of one thread: delayed calls, and calls handed over from other threads.
#pragma once

#include <cstdint>
#include <functional>
#include <utility>

namespace plume {

class RunLoop;

// A delayed call that has been asked for: it is forgotten when the timer goes, is cancelled or is given another call.
// Belongs to the loop's thread; the loop outlives it.
class Timer {
  public:
    using Id = std::uint64_t;

    Timer() = default;
    Timer(Timer&& other) noexcept : loop_(other.loop_), id_(std::exchange(other.id_, 0)) {}
    inline Timer& operator=(Timer&& other) noexcept;
    ~Timer() { cancel(); }

    // One whose call has run is no error.
    inline void cancel();
    // Asked for and not cancelled. The timer does not notice that its call has run: a call that wants this to be false
    // from then on cancels its own timer.
    explicit operator bool() const { return id_ != 0; }

  private:
    friend class RunLoop;
    Timer(RunLoop& loop, Id id) : loop_(&loop), id_(id) {}

    RunLoop* loop_ = nullptr;
    Id id_ = 0;
};

class RunLoop {
  public:
    using Call = std::function<void()>;
    // Names a delayed call for cancelling; 0 names none.
    using CallId = Timer::Id;

    virtual ~RunLoop() = default;

    // Seconds since some fixed moment; never goes back.
    virtual double now() const = 0;

    // Calls once, `delay` seconds from now at the earliest, from the loop and never from inside this operation, also
    // for a delay of 0. Calls due at the same moment run in the order they were asked for. Only on the loop's own
    // thread.
    [[nodiscard]] Timer performAfterDelay(double delay, Call call) { return {*this, schedule(delay, std::move(call))}; }

    // Calls on this loop's thread as soon as it can, after what was handed over before. From any thread; never waits.
    virtual void perform(Call call) = 0;

  protected:
    friend class Timer;
    // What performAfterDelay() asks for, and forgetting it again; a call that has run, or was forgotten already, is no
    // error.
    virtual CallId schedule(double delay, Call call) = 0;
    virtual void cancel(CallId id) = 0;
};

inline Timer& Timer::operator=(Timer&& other) noexcept {
    if (this != &other) {
        cancel();
        loop_ = other.loop_;
        id_ = std::exchange(other.id_, 0);
    }
    return *this;
}

inline void Timer::cancel() {
    if (id_ != 0) loop_->cancel(std::exchange(id_, 0));
}

}  // namespace plume
