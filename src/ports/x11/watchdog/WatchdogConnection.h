// The watchdog's own connection to the X server: by it the watchdog hears that a key went down, and frees the keyboard.
#pragma once

#include <xcb/xcb.h>

#include <deque>
#include <memory>
#include <vector>

#include "ports/x11/XcbConnection.h"
#include "ports/x11/keyboard/InputDevices.h"
#include "ports/x11/keyboard/TapProgress.h"

namespace plume {

class WatchdogConnection {
  public:
    // The error names what the server lacks.
    static Result<std::unique_ptr<WatchdogConnection>> open(const std::string& display);

    int descriptor() const { return connection_->descriptor(); }
    bool isBroken() const { return connection_->isBroken(); }

    // From the return of this on, every key of every keyboard, whoever holds it, is heard or no longer heard. Waits for
    // the server.
    void listen(bool on);
    // Whether a key went down since the last call. Those that the tap has not handled are remembered. `now`, here and
    // below, is in seconds of a clock that only goes forward.
    bool takeKeys(const TapProgress& progress, double now);

    // Ends the connection that made the window, if there still is one. Types the keys that it has held without handling
    // them, and releases every key that is pressed on the keyboard through which programs press keys: pressed by the
    // tap, they would repeat for ever.
    void freeKeyboard(xcb_window_t window, TapProgress& progress, double now);

  private:
    struct Key {
        KeyMoment moment;
        double heardAt = 0;     // seconds
        unsigned sequence = 0;  // the last of our requests before it
        std::uint16_t device = 0;
        std::uint8_t keycode = 0;
        bool down = false;
    };

    WatchdogConnection(std::unique_ptr<XcbConnection> connection, std::uint8_t inputOpcode)
        : connection_(std::move(connection)), inputOpcode_(inputOpcode) {}

    void selectKeys(std::uint32_t events);
    void remember(const Key& key);
    void passOn(const std::vector<std::uint16_t>& devices, unsigned freed, const TapProgress& progress, double now);
    std::vector<std::uint16_t> heldKeyboards() const;
    void releaseKeysOf(std::uint16_t device);

    std::unique_ptr<XcbConnection> connection_;
    const std::uint8_t inputOpcode_;
    bool listening_ = false;
    std::deque<Key> keys_;  // not yet handled, as far as is known
    KeyMoments moments_;
};

}  // namespace plume
