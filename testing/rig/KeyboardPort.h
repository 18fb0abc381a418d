#pragma once

#include <functional>
#include <memory>
#include <string>
#include <string_view>
#include <utility>

#include "platform/KeyboardTap.h"
#include "ports/x11/keyboard/TapConnection.h"
#include "ports/x11/keyboard/X11EventPoster.h"
#include "ports/x11/keyboard/X11KeyboardTap.h"
#include "ports/x11/keyboard/XkbKeyboard.h"
#include "ports/x11/watchdog/Watchdog.h"
#include "testing/rig/SessionThread.h"

namespace plume::rig {

// The keyboard's half of the X11 port, put together as the program does it, on a tap thread of its own: tap, poster
// and, if asked for, the watchdog. The tap hears keys when the constructor returns; it is enabled again whenever it was
// disabled.
class KeyboardPort final : private KeyboardTapListener {
  public:
    // What the tap's listener answers, on the tap thread: true swallows the key.
    using Decide = std::function<bool(const TapEvent&)>;

    struct Options {
        Decide decide;
        bool watchdog = false;
        std::function<void()> disabled;  // called on the tap thread when the tap was disabled
    };

    KeyboardPort(const std::string& display, Options options);  // throws RigError
    ~KeyboardPort() override;
    KeyboardPort(const KeyboardPort&) = delete;
    KeyboardPort& operator=(const KeyboardPort&) = delete;

    // Calls on the tap thread, waits, and gives what the call gives.
    template <typename Call>
    auto run(Call call) {
        return thread_.run(std::move(call));
    }

    // Types a text as one batch.
    void type(std::u16string_view text);

    // For use on the tap thread.
    PollRunLoop& loop() { return thread_.loop(); }
    X11EventPoster& poster() { return *poster_; }
    TapConnection& connection() { return *connection_; }
    Watchdog& watchdog() { return *watchdog_; }

  private:
    void putTogether(const std::string& display);
    bool keyboardEvent(const TapEvent& event) override { return options_.decide && options_.decide(event); }
    void tapDisabledByTimeout() override;
    void tapDisabledByUserInput() override {}

    Options options_;
    SessionThread thread_;
    std::unique_ptr<Watchdog> watchdog_;
    std::unique_ptr<XkbKeyboard> keyboard_;
    std::unique_ptr<TapConnection> connection_;
    std::unique_ptr<X11KeyboardTap> tap_;
    std::unique_ptr<X11EventPoster> poster_;
    Timer enabling_;
};

}  // namespace plume::rig
