#include "engine/BackgroundTasks.h"

#include <system_error>
#include <utility>

namespace plume {

BackgroundTasks::~BackgroundTasks() {
    {
        const std::lock_guard lock(mutex_);
        ends_ = true;
        waiting_.clear();
    }
    taskWaits_.notify_all();
    for (std::thread& thread : threads_) thread.join();
}

bool BackgroundTasks::run(Task task) {
    const std::lock_guard lock(mutex_);
    const bool allBusy = busy_ + waiting_.size() >= threads_.size();
    if (allBusy && threads_.size() < MaximumThreads) {
        try {
            threads_.emplace_back([this] { work(); });
        } catch (const std::system_error&) {
            // The threads that are there get to it later.
            if (threads_.empty()) return false;
        }
    }
    waiting_.push_back(std::move(task));
    taskWaits_.notify_one();
    return true;
}

bool BackgroundTasks::isIdle() const {
    const std::lock_guard lock(mutex_);
    return isIdleLocked();
}

void BackgroundTasks::waitUntilIdle() const {
    std::unique_lock lock(mutex_);
    becameIdle_.wait(lock, [this] { return isIdleLocked(); });
}

void BackgroundTasks::work() {
    std::unique_lock lock(mutex_);
    for (;;) {
        taskWaits_.wait(lock, [this] { return ends_ || !waiting_.empty(); });
        if (ends_) return;
        Task task = std::move(waiting_.front());
        waiting_.pop_front();
        ++busy_;
        lock.unlock();
        task();
        task = nullptr;
        lock.lock();
        --busy_;
        if (isIdleLocked()) becameIdle_.notify_all();
    }
}

}  // namespace plume
