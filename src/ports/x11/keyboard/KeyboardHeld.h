// Whether another program keeps the keyboard to itself: a screen locker, a password prompt, an open menu.
//
// The server is asked to hand over the keyboard for a window that is not shown, which it refuses with one reason or the
// other and without an effect. The question goes behind a key that comes up and its answer is read at the next press,
// so that typing never waits for it. Belongs to the tap thread.
#pragma once

#include <xcb/xcb.h>

#include <optional>

#include "ports/x11/keyboard/TapConnection.h"

namespace plume {

class KeyboardHeld {
  public:
    explicit KeyboardHeld(TapConnection& connection) : connection_(connection) {}
    ~KeyboardHeld();
    KeyboardHeld(const KeyboardHeld&) = delete;
    KeyboardHeld& operator=(const KeyboardHeld&) = delete;

    // Asks, without flushing, unless a question is unanswered. `now`: the run loop's time.
    void ask(double now);
    // By the latest answer; when the latest question is older than 0.3 s, asks and waits for it.
    bool isHeld(double now);

  private:
    bool isHeldBy(const xcb_grab_keyboard_reply_t* reply) const;

    TapConnection& connection_;
    std::optional<xcb_grab_keyboard_cookie_t> asked_;
    double askedAt_ = 0;
    bool held_ = false;
};

}  // namespace plume
