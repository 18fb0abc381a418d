// Whether another program has grabbed the keyboard: a screen locker, a password prompt, an open menu.
//
// The server is asked to grab the keyboard for a window that is not shown. It always refuses, without any effect, and
// its reason tells. The question is sent after the release of a key and its answer is read at the next press, so that
// typing never waits for it. Belongs to the tap thread.
#pragma once

#include <xcb/xcb.h>

#include <optional>

#include "ports/x11/keyboard/TapConnection.h"

namespace plume {

// What the server's refusal means.
bool tellsOfGrab(const xcb_grab_keyboard_reply_t& refusal);

class KeyboardGrabCheck {
  public:
    explicit KeyboardGrabCheck(TapConnection& connection) : connection_(connection) {}
    ~KeyboardGrabCheck();
    KeyboardGrabCheck(const KeyboardGrabCheck&) = delete;
    KeyboardGrabCheck& operator=(const KeyboardGrabCheck&) = delete;

    // Asks, without flushing, unless a question is unanswered. `now`: the run loop's time.
    void ask(double now);
    // By the latest answer; when the latest question is older than 0.3 s, asks and waits for it.
    bool isGrabbed(double now);

  private:
    TapConnection& connection_;
    std::optional<xcb_grab_keyboard_cookie_t> asked_;
    double askedAt_ = 0;
    bool grabbed_ = false;
};

}  // namespace plume
