// An answer that one thread owes to another, which may wait for it a little, once.
#pragma once

#include <atomic>
#include <chrono>
#include <condition_variable>
#include <mutex>

namespace plume {

class OwedAnswer {
  public:
    // From now on one is owed. From any thread.
    void owe() {
        const std::scoped_lock lock(mutex_);
        owed_ = true;
    }
    // What was owed by now is there. On the thread that answers.
    void give() {
        {
            const std::scoped_lock lock(mutex_);
            owed_ = false;
        }
        given_.notify_all();
    }
    bool isOwed() const { return owed_; }
    // Waits while it is owed, and gives it up when it does not come in time: the next one to ask waits no more.
    void await(std::chrono::milliseconds bound) {
        if (!owed_) return;
        std::unique_lock lock(mutex_);
        given_.wait_for(lock, bound, [this] { return !owed_; });
        owed_ = false;
    }

  private:
    std::mutex mutex_;
    std::condition_variable given_;
    std::atomic<bool> owed_ = false;  // written with the mutex held
};

}  // namespace plume
