// Work that takes longer than the main thread should stand still, one piece at a time on a thread of its own.
#pragma once

#include <functional>
#include <thread>

#include "platform/RunLoop.h"

namespace plume {

// Belongs to the main thread; the loop is its own.
class BackgroundWork {
  public:
    explicit BackgroundWork(RunLoop& loop) : loop_(loop) {}
    // Waits for the work that is under way; its `done` is not called any more unless the loop goes on.
    ~BackgroundWork() { finish(); }
    BackgroundWork(const BackgroundWork&) = delete;
    BackgroundWork& operator=(const BackgroundWork&) = delete;

    // Calls `done` on the main loop afterwards. Waits for the piece before, should that still be under way.
    void begin(std::function<void()> work, std::function<void()> done) {
        finish();
        thread_ = std::thread([this, work = std::move(work), done = std::move(done)] {
            work();
            loop_.perform(done);
        });
    }
    void finish() {
        if (thread_.joinable()) thread_.join();
    }

  private:
    RunLoop& loop_;
    std::thread thread_;
};

}  // namespace plume
