// The run loop of a real thread: delayed calls, calls handed over, and descriptors that wake it.
//
// Sleeps in one poll() until something is due, so that a program in which nothing happens never wakes up. Made on any
// thread; run() decides which one it belongs to.
#pragma once

#include <poll.h>

#include <atomic>
#include <cstdint>
#include <deque>
#include <functional>
#include <map>
#include <memory>
#include <mutex>
#include <vector>

#include "ports/posix/DelayedCalls.h"
#include "ports/posix/DescriptorLoop.h"

namespace plume {

class PollRunLoop final : public DescriptorLoop {
  public:
    PollRunLoop();
    ~PollRunLoop() override;
    PollRunLoop(const PollRunLoop&) = delete;
    PollRunLoop& operator=(const PollRunLoop&) = delete;

    double now() const override;
    void perform(Call call) override;

    // Runs until stop(), also when that came first. What is not due by then stays undone.
    void run();
    // From any thread, and from signal handlers.
    void stop();

    // Drains before every wait, too: a library that reads ahead may hold input that no poll() would tell of.
    [[nodiscard]] Subscription addSource(int descriptor, Call drain) override;
    // A paused source is left alone: what arrives waits in the system's buffers, in order.
    void setSourcePaused(int descriptor, bool paused);

  private:
    struct Source {
        Call drain;
        bool paused = false;
        bool ended = false;
    };
    CallId schedule(double delay, Call call) override;
    void cancel(CallId id) override;

    void drainSources();
    void runHandedOver();
    void runDue();
    void wait();
    double secondsToWait() const;

    const int wakeUp_;  // an eventfd
    std::atomic<bool> stopped_ = false;
    DelayedCalls delayed_;
    std::map<int, std::shared_ptr<Source>> sources_;
    std::vector<pollfd> polled_;  // kept for its memory
    std::mutex mutex_;
    std::deque<Call> handedOver_;  // guarded by mutex_
};

}  // namespace plume
