// Whether the program in front is a terminal in which a prompt hides what is typed: sudo, ssh, passwd, `read -s`.
//
// The terminals' devices are asked, never a program; which ones there are is found out on a thread of its own. A
// program with several windows or tabs does not tell which of them takes the keys, so a prompt in any of them counts.
#pragma once

#include <sys/types.h>

#include <atomic>
#include <chrono>
#include <cstddef>
#include <mutex>
#include <string>
#include <thread>
#include <vector>

#include "ports/posix/OwedAnswer.h"
#include "ports/posix/PollRunLoop.h"

namespace plume {

class HiddenPrompts {
  public:
    HiddenPrompts();
    ~HiddenPrompts();
    HiddenPrompts(const HiddenPrompts&) = delete;
    HiddenPrompts& operator=(const HiddenPrompts&) = delete;

    // ---- From any thread, never waiting ----
    // 0 when it is not known.
    void setFrontProcess(pid_t process);
    // After a click, a Return, a shortcut: what waits for keys may be something else than before.
    void promptMayHaveCome();
    // At every other key: looks when nobody did lately.
    void userTypes();
    // As far as is known.
    bool isWaiting() const { return waiting_; }

    // ---- On the tap thread ----
    // The same; but at the first key after what may have brought a prompt the devices are asked anew. The first one in
    // a program that has just come to the front waits until they are known, 30 ms at most.
    bool isWaitingForKey();

  private:
    using Clock = std::chrono::steady_clock;

    void collect();
    void collectAfter(std::size_t step);
    bool hides() const;

    std::atomic<bool> waiting_ = false;
    std::atomic<bool> hasTerminals_ = false;
    std::atomic<bool> unsure_ = false;  // nobody looked since a prompt may have come
    std::atomic<Clock::rep> nextLook_ = 0;
    std::atomic<Clock::rep> inFrontSince_ = 0;
    std::atomic<pid_t> front_ = 0;
    OwedAnswer collected_;
    mutable std::mutex mutex_;
    std::vector<std::string> devices_;  // guarded by mutex_, which is held for microseconds

    // On the thread.
    PollRunLoop loop_;
    Clock::time_point collectedAt_{};
    Timer nextOfSeries_;  // of looks after a change
    std::thread thread_;
};

}  // namespace plume
