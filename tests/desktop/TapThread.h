#pragma once

#include <functional>
#include <future>
#include <memory>
#include <string>
#include <thread>
#include <type_traits>
#include <utility>
#include <vector>

#include "ports/posix/PollRunLoop.h"
#include "ports/x11/X11Session.h"
#include "ports/x11/keyboard/TapConnection.h"
#include "ports/x11/keyboard/X11InputSources.h"
#include "ports/x11/keyboard/X11KeyboardTap.h"
#include "ports/x11/keyboard/X11MouseTap.h"
#include "ports/x11/keyboard/XkbKeyboard.h"

namespace plume::rig {

// Plume's ears on a rig's display, on a thread of their own as in the program. The display outlives it.
class TapThread {
  public:
    explicit TapThread(const std::string& display);  // throws RigError
    ~TapThread();
    TapThread(const TapThread&) = delete;
    TapThread& operator=(const TapThread&) = delete;

    // All of it belongs to the thread: to be used inside call().
    struct Parts {
        PollRunLoop loop;
        std::unique_ptr<X11Session> session;
        std::unique_ptr<XkbKeyboard> keyboard;
        std::unique_ptr<X11InputSources> inputSources;
        std::unique_ptr<TapConnection> connection;
        std::unique_ptr<X11KeyboardTap> tap;
        std::unique_ptr<X11MouseTap> mouse;
    };

    // Runs it on the thread and returns what it returns.
    template <typename Work>
    auto call(Work work) -> std::invoke_result_t<Work, Parts&> {
        std::promise<std::invoke_result_t<Work, Parts&>> promise;
        parts_.loop.perform([&] {
            if constexpr (std::is_void_v<std::invoke_result_t<Work, Parts&>>) {
                work(parts_);
                promise.set_value();
            } else {
                promise.set_value(work(parts_));
            }
        });
        return promise.get_future().get();
    }

    // From inside what the thread calls.
    Parts& parts() { return parts_; }

  private:
    Parts parts_;
    std::thread thread_;
};

}  // namespace plume::rig
