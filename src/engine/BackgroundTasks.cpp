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

bool BackgroundTasks::run(Call work, Call finish) {
    Call counted = [this, finish = std::move(finish)] {
        --pending_;
        finish();
    };
    const std::lock_guard lock(mutex_);
    const bool allBusy = busy_ + waiting_.size() >= threads_.size();
    if (allBusy && threads_.size() < MaximumThreads) {
        try {
            threads_.emplace_back([this] { runTasks(); });
        } catch (const std::system_error&) {
            // The threads that are there get to it later.
            if (threads_.empty()) return false;
        }
    }
    waiting_.push_back({std::move(work), std::move(counted)});
    taskWaits_.notify_one();
    ++pending_;
    return true;
}

void BackgroundTasks::waitUntilIdle() const {
    std::unique_lock lock(mutex_);
    becameIdle_.wait(lock, [this] { return isIdleLocked(); });
}

void BackgroundTasks::runTasks() {
    std::unique_lock lock(mutex_);
    for (;;) {
        taskWaits_.wait(lock, [this] { return ends_ || !waiting_.empty(); });
        if (ends_) return;
        Task task = std::move(waiting_.front());
        waiting_.pop_front();
        ++busy_;
        lock.unlock();
        task.work();
        // What it shares with the finish belongs to the loop's thread from here on, to the last reference.
        task.work = nullptr;
        handOver(std::exchange(task.finish, nullptr));
        lock.lock();
        --busy_;
        if (isIdleLocked()) becameIdle_.notify_all();
    }
}

void BackgroundTasks::handOver(Call finish) {
    {
        const std::lock_guard lock(finished_->mutex);
        finished_->calls.push_back(std::move(finish));
    }
    loop_.perform([held = std::weak_ptr(finished_)] {
        const auto finished = held.lock();
        if (!finished) return;
        std::unique_lock lock(finished->mutex);
        const Call next = std::move(finished->calls.front());
        finished->calls.pop_front();
        lock.unlock();
        next();
    });
}

}  // namespace plume
