// Runs what may take long on threads of its own, and what follows from it on its owner's run loop.
//
// Tasks run at once, side by side; beyond MaximumThreads they wait for each other. Threads are made when they are first
// needed and then kept. Everything here belongs to the loop's thread. Destroying it drops the tasks that have not begun
// and what was still to follow, and waits for tasks that run: whoever can end them does so first.
#pragma once

#include <condition_variable>
#include <cstddef>
#include <deque>
#include <functional>
#include <memory>
#include <mutex>
#include <thread>
#include <vector>

#include "platform/RunLoop.h"

namespace plume {

class BackgroundTasks {
  public:
    using Call = std::function<void()>;

    static constexpr std::size_t MaximumThreads = 8;

    // The loop is not owned and outlives the tasks.
    explicit BackgroundTasks(RunLoop& loop) : loop_(loop) {}
    ~BackgroundTasks();
    BackgroundTasks(const BackgroundTasks&) = delete;
    BackgroundTasks& operator=(const BackgroundTasks&) = delete;

    // `work` on another thread, then `finish` on the loop; what both hold belongs to the loop's thread again by then.
    // False when the system gives no thread, and nothing is run.
    [[nodiscard]] bool run(Call work, Call finish);
    // Tasks were begun that are not finished: they run, wait, or are about to finish on the loop.
    bool arePending() const { return pending_ > 0; }
    // Blocks until no task runs or waits; all that is left of them is with the loop then.
    void waitUntilIdle() const;

  private:
    struct Task {
        Call work;
        Call finish;
    };
    // What is to be called on the loop. The loop's calls hold it weakly: it goes with its owner.
    struct Finished {
        std::mutex mutex;
        std::deque<Call> calls;  // guarded by mutex
    };

    void runTasks();
    void handOver(Call finish);
    bool isIdleLocked() const { return waiting_.empty() && busy_ == 0; }

    RunLoop& loop_;
    std::size_t pending_ = 0;
    const std::shared_ptr<Finished> finished_ = std::make_shared<Finished>();

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
