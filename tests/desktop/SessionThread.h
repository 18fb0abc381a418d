// The tap thread of a test: a run loop with the session's connection.
#pragma once

#include <exception>
#include <future>
#include <memory>
#include <string>
#include <thread>
#include <type_traits>
#include <utility>

#include "ports/posix/PollRunLoop.h"
#include "ports/x11/X11Session.h"
#include "testing/rig/RigError.h"

namespace plume::rig {

class SessionThread {
  public:
    explicit SessionThread(const std::string& display) : session_(open(display, loop_)) {
        thread_ = std::thread([this] { loop_.run(); });
    }
    ~SessionThread() { end(); }
    SessionThread(const SessionThread&) = delete;
    SessionThread& operator=(const SessionThread&) = delete;

    // Made before anything runs there; to be used in run() only.
    X11Session& session() { return *session_; }
    PollRunLoop& loop() { return loop_; }

    // Calls there and waits for the result.
    template <typename Call>
    auto run(Call call) {
        std::promise<std::invoke_result_t<Call>> promise;
        loop_.perform([&] {
            try {
                if constexpr (std::is_void_v<std::invoke_result_t<Call>>) {
                    call();
                    promise.set_value();
                } else {
                    promise.set_value(call());
                }
            } catch (...) {
                promise.set_exception(std::current_exception());
            }
        });
        return promise.get_future().get();
    }

    // Stops the loop: from here on the caller's thread may do what belongs to it.
    void end() {
        if (!thread_.joinable()) return;
        loop_.stop();
        thread_.join();
    }

  private:
    static std::unique_ptr<X11Session> open(const std::string& display, PollRunLoop& loop) {
        auto session = X11Session::open(display, loop);
        if (!session) throw RigError(session.error().message);
        return std::move(session).value();
    }

    PollRunLoop loop_;
    std::unique_ptr<X11Session> session_;
    std::thread thread_;
};

}  // namespace plume::rig
