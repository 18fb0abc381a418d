// Runs what may take long on threads of its own.
//
// Tasks run at once, side by side; beyond MaximumThreads they wait for each other. Threads are made when they are first
// needed and then kept. Destroying it drops the tasks that have not begun and waits for those that run: whoever can end
// them does so first. All operations may be called from any thread but that of a task.
#pragma once

#include <condition_variable>
#include <cstddef>
#include <deque>
#include <functional>
#include <mutex>
#include <thread>
#include <vector>

namespace plume {

class BackgroundTasks {
  public:
    using Task = std::function<void()>;

    static constexpr std::size_t MaximumThreads = 8;

    BackgroundTasks() = default;
    ~BackgroundTasks();
    BackgroundTasks(const BackgroundTasks&) = delete;
    BackgroundTasks& operator=(const BackgroundTasks&) = delete;

    // False when the system gives no thread, and the task is dropped.
    [[nodiscard]] bool run(Task task);
    bool isIdle() const;
    void waitUntilIdle() const;

  private:
    void work();
    bool isIdleLocked() const { return waiting_.empty() && busy_ == 0; }

    mutable std::mutex mutex_;
    std::condition_variable taskWaits_;
    mutable std::condition_variable becameIdle_;
    // All below guarded by mutex_.
    std::deque<Task> waiting_;
    std::size_t busy_ = 0;
    bool ends_ = false;
    std::vector<std::thread> threads_;
};

}  // namespace plume
