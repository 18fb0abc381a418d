// The connection through which keys go to programs: those the tap passes on and those the poster sends, in the order
// of the calls.
//
// Keys are pressed on the server's XTEST keyboard. What is down on it is kept here, so that nobody has to ask. Belongs
// to the tap thread. Somebody else may end the connection (that is how the watchdog frees the keyboard): then nothing
// has an effect until reopen().
#pragma once

#include <xcb/xcb.h>

#include <bitset>
#include <cstdint>
#include <functional>
#include <memory>
#include <string>

#include "Foundation/Result.h"
#include "ports/x11/XcbConnection.h"
#include "ports/x11/keyboard/TapProgress.h"
#include "ports/x11/keyboard/XkbKeyboard.h"

namespace plume {

class TapConnection {
  public:
    // An empty name means $DISPLAY. The error says what the server lacks and what to do. The keyboard outlives it.
    static Result<std::unique_ptr<TapConnection>> open(const std::string& display, const XkbKeyboard& keyboard);
    // Whether open() would succeed, and whether there is a keyboard to tap. From any thread.
    static Result<void> check(const std::string& display);
    TapConnection(const TapConnection&) = delete;
    TapConnection& operator=(const TapConnection&) = delete;

    bool isBroken() const { return connection_->isBroken(); }
    // A new connection to the same display in place of the old one, whose windows and grabs are gone. Keys that the
    // old one left down on the XTEST keyboard are released.
    Result<void> reopen();

    // Until reopen().
    XcbConnection& connection() const { return *connection_; }
    // Never mapped. For the watchdog, which ends the connection by it, and for questions that need a window.
    xcb_window_t window() const { return window_; }
    // Called with the new window after every reopen(), before the tap takes the keyboard.
    void setReopenedListener(std::function<void(xcb_window_t)> listener) { reopened_ = std::move(listener); }

    std::uint8_t inputOpcode() const { return inputOpcode_; }
    std::uint16_t masterKeyboard() const { return masterKeyboard_; }
    std::uint16_t testKeyboard() const { return testKeyboard_; }
    const XkbKeyboard& keyboard() const { return keyboard_; }

    // Presses or releases a key on the XTEST keyboard. Sent with the next flush(), or when xcb's buffer is full.
    void sendKey(xcb_keycode_t keycode, bool down);
    void flush() const { connection_->flush(); }
    // Whether the server tells of presses on the XTEST keyboard, by raw events.
    void setHearsPresses(bool hears);
    // Whether sendKey() caused this press on the XTEST keyboard, which was told when our request with this number was
    // the latest; to be asked of each press once.
    bool isOwnPress(unsigned sequence);
    // For as long as it lives, of presses nothing is told: those of a long text would keep the server, and us, busy.
    class Unheard {
      public:
        explicit Unheard(TapConnection& connection) : connection_(connection), heard_(connection.hearsPresses_) {
            if (heard_) connection_.setHearsPresses(false);
        }
        ~Unheard() {
            if (heard_) connection_.setHearsPresses(true);
        }
        Unheard(const Unheard&) = delete;
        Unheard& operator=(const Unheard&) = delete;

      private:
        TapConnection& connection_;
        const bool heard_;
    };
    // What is down on the XTEST keyboard once everything sent has been dealt with, and the real modifiers that it
    // holds.
    const KeycodeSet& keysDown() const { return keysDown_; }
    std::uint8_t modifiersDown() const;
    void releaseAll();
    // Alt or Super pressed and released with nothing in between opens a menu or an overview. While one of them is down,
    // this keeps them shut by pressing and releasing Control, which does nothing by itself.
    void keepMenusClosed();

    // How far the tap has come; nothing is handled at the start and after reopen().
    TapProgress& progress() { return progress_; }

    // The keys that the user holds on the keyboards the tap has; filled by the tap while it hears them.
    KeycodeSet userKeys;

  private:
    TapConnection(std::unique_ptr<XcbConnection> connection, const XkbKeyboard& keyboard)
        : connection_(std::move(connection)), keyboard_(keyboard) {}

    Result<void> begin();
    Result<void> findDevices();

    std::unique_ptr<XcbConnection> connection_;
    const XkbKeyboard& keyboard_;
    xcb_window_t window_ = XCB_WINDOW_NONE;
    std::uint8_t inputOpcode_ = 0;
    std::uint16_t masterKeyboard_ = 0;
    std::uint16_t testKeyboard_ = 0;
    KeycodeSet keysDown_;
    bool hearsPresses_ = false;
    std::bitset<65536> ownPresses_;  // the numbers, as far as they matter, of the requests that press a key, if heard
    TapProgress progress_;
    std::function<void(xcb_window_t)> reopened_;
};

}  // namespace plume
