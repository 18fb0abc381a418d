// The way from a bus's thread to the main thread, until it is cut: a thread that hangs may outlive who started it.
#pragma once

#include <mutex>
#include <utility>

#include "platform/RunLoop.h"

namespace plume {

// All from any thread.
class MainLoopLink {
  public:
    // The loop lives until cut() has returned.
    explicit MainLoopLink(RunLoop& loop) : loop_(&loop) {}
    MainLoopLink(const MainLoopLink&) = delete;
    MainLoopLink& operator=(const MainLoopLink&) = delete;

    // Nothing once it is cut.
    void perform(RunLoop::Call call) {
        const std::scoped_lock lock(mutex_);
        if (loop_ != nullptr) loop_->perform(std::move(call));
    }
    void cut() {
        const std::scoped_lock lock(mutex_);
        loop_ = nullptr;
    }

  private:
    std::mutex mutex_;
    RunLoop* loop_;  // guarded by mutex_
};

}  // namespace plume
