// The program that the last paste was for: whether it has got to the keystroke, and which of its requests still belong
// to that paste when the clipboard holds something else by then.
//
// A program that hangs or is stopped answers no ping; it is asked 0.3 s after the keystroke, because a program that
// pastes has been heard of by then. Belongs to the tap thread.
#pragma once

#include <xcb/xcb.h>

#include <optional>

#include "ports/x11/X11Session.h"
#include "ports/x11/clipboard/X11FrontPrograms.h"

namespace plume {

class X11PasteTarget {
  public:
    // The session outlives it.
    explicit X11PasteTarget(X11Session& session);
    X11PasteTarget(const X11PasteTarget&) = delete;
    X11PasteTarget& operator=(const X11PasteTarget&) = delete;

    // The keystroke was sent: the program in front is the target from now on.
    void begin();
    // The paste is of no interest any more.
    void end();
    // It has taken something: what it asks from now on, but for a moment, is no part of the paste.
    void wasTaken();
    // The clipboard holds something else from this moment of the server's on.
    void contentWasReplaced(xcb_timestamp_t time) { replaced_ = time; }

    // The keystroke was sent, and nothing has been taken, nor was anything else put on the clipboard.
    bool isToTake() const { return windows_.focus != XCB_WINDOW_NONE && replaced_ == 0; }
    bool isOf(xcb_window_t requestor) const;
    // It is in front, and was asked whether it is there, and has not answered.
    bool isAwaited() const;
    // Whether a request that comes now is part of the paste: it comes before the answer to the ping, or, from programs
    // that answer none, is for a moment before the content was replaced.
    bool isLate(xcb_window_t requestor, xcb_timestamp_t time);

  private:
    void ping();
    bool understandsPing() const;
    void noteAnswer(const xcb_generic_event_t& event);
    bool hasAnswered() const;

    X11Session& session_;
    X11FrontWindows windows_;
    xcb_timestamp_t replaced_ = 0;
    bool asked_ = false;
    std::optional<double> answered_;   // when
    std::optional<double> firstLate_;  // when it first asked after the content was replaced
    Timer ping_;
    X11Session::WindowEvents rootEvents_;  // while an answer is awaited
    Subscription answerHandler_;
};

}  // namespace plume
