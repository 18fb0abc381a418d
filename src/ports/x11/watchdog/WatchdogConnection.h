// The watchdog's own connection to the X server: by it the watchdog hears that a key went down, and frees the keyboard.
#pragma once

#include <xcb/xcb.h>

#include <memory>

#include "ports/x11/XcbConnection.h"

namespace plume {

class WatchdogConnection {
  public:
    // The error names what the server lacks.
    static Result<std::unique_ptr<WatchdogConnection>> open(const std::string& display);

    int descriptor() const { return connection_->descriptor(); }
    bool isBroken() const { return connection_->isBroken(); }

    // From the return of this on, every key that goes down, on any keyboard and whoever holds it, is heard or no longer
    // heard. Waits for the server.
    void listen(bool on);
    // Whether a key went down since the last call. Which one it was is not looked at.
    bool takeKey();

    // Ends the connection that made the window, if there still is one, and releases every key that is pressed on the
    // keyboard through which programs press keys: pressed by the tap, they would repeat for ever.
    void freeKeyboard(xcb_window_t window);

  private:
    WatchdogConnection(std::unique_ptr<XcbConnection> connection, std::uint8_t inputOpcode)
        : connection_(std::move(connection)), inputOpcode_(inputOpcode) {}

    void releaseKeysOf(std::uint16_t device);

    std::unique_ptr<XcbConnection> connection_;
    const std::uint8_t inputOpcode_;
};

}  // namespace plume
