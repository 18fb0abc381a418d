// A thread for what is asked of a bus: a service that hangs holds up nobody but this thread.
//
// A Session is what lives there: run() returns after end(), which any thread may call. It is shared with the thread,
// which is left behind when it hangs.
#pragma once

#include <dbus/dbus.h>

#include <chrono>
#include <future>
#include <memory>
#include <thread>
#include <utility>

namespace plume {

template <typename Session>
class BusThread {
  public:
    explicit BusThread(std::shared_ptr<Session> session) : session_(std::move(session)) {
        std::promise<void> ended;
        ended_ = ended.get_future();
        thread_ = std::thread([kept = session_, ended = std::move(ended)]() mutable {
            dbus_threads_init_default();  // an earlier session's thread may still be leaving
            kept->run();
            ended.set_value();
        });
    }
    // Waits for its thread a few hundredths of a second at most.
    ~BusThread() {
        constexpr std::chrono::milliseconds LongestGoodbye{50};
        session_->end();
        if (ended_.wait_for(LongestGoodbye) == std::future_status::ready) {
            thread_.join();
        } else {
            thread_.detach();
        }
    }
    BusThread(const BusThread&) = delete;
    BusThread& operator=(const BusThread&) = delete;

    const std::shared_ptr<Session>& session() const { return session_; }
    Session* operator->() const { return session_.get(); }

  private:
    const std::shared_ptr<Session> session_;
    std::future<void> ended_;
    std::thread thread_;
};

}  // namespace plume
