// Asks a window's program to say when it has handled everything that was sent to it so far (_NET_WM_PING).
//
// Belongs to the tap thread. Never waits: a program that hangs or is stopped does not answer.
#pragma once

#include <xcb/xcb.h>

#include <functional>

#include "ports/x11/X11Session.h"

namespace plume {

class X11Ping {
  public:
    // Called from the run loop for each answer; `isLatest`: to what was sent last. The session outlives it.
    X11Ping(X11Session& session, std::function<void(bool isLatest)> answered);
    X11Ping(const X11Ping&) = delete;
    X11Ping& operator=(const X11Ping&) = delete;

    // False for a window whose program answers no pings.
    bool send(xcb_window_t window);
    // No answer is of interest any more.
    void end();
    // Since the last end.
    bool wasSent() const { return window_ != XCB_WINDOW_NONE; }

  private:
    bool isUnderstoodBy(xcb_window_t window) const;
    void noteAnswer(const xcb_generic_event_t& event);

    X11Session& session_;
    const std::function<void(bool isLatest)> answered_;
    xcb_window_t window_ = XCB_WINDOW_NONE;
    xcb_timestamp_t first_ = 0;  // of this window's, by their times
    xcb_timestamp_t latest_ = 0;
    X11Session::WindowEvents rootEvents_;  // while an answer is awaited
    Subscription answerHandler_;
};

}  // namespace plume
