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

// What a part of the port was opened with; throws RigError with what the port says when it was not.
template <typename Value>
Value valueOrThrow(Result<Value> result) {
    if (!result) throw RigError(result.error().message);
    if constexpr (!std::is_void_v<Value>) return std::move(result).value();
}

// The tap thread of Plume's X11 port: a run loop with the session's connection to the server. The parts of the port
// that a test puts onto it are made, used and ended inside run(). The display outlives it.
class SessionThread {
  public:
    explicit SessionThread(const std::string& display)  // throws RigError
        : session_(valueOrThrow(X11Session::open(display, loop_))) {
        thread_ = std::thread([this] { loop_.run(); });
    }
    ~SessionThread() { end(); }
    SessionThread(const SessionThread&) = delete;
    SessionThread& operator=(const SessionThread&) = delete;

    X11Session& session() { return *session_; }
    PollRunLoop& loop() { return loop_; }

    // Calls there, waits, and gives what the call gives or throws.
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
    PollRunLoop loop_;
    std::unique_ptr<X11Session> session_;
    std::thread thread_;
};

}  // namespace plume::rig
