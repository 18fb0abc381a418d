// The program that the last paste was for: whether it has got to the keystroke, and which of its requests still belong
// to that paste when the clipboard holds something else by then.
//
// A program that hangs or is stopped answers no ping; it is asked 0.3 s after the keystroke, because a program that
// pastes has been heard of by then. Some read the content twice, and paste what they get the second time: a program
// that has read it is asked, too, and what it reads before it answers is waited for. Belongs to the tap thread.
#pragma once

#include <xcb/xcb.h>

#include <functional>
#include <optional>

#include "ports/x11/X11Session.h"
#include "ports/x11/clipboard/X11FrontPrograms.h"
#include "ports/x11/clipboard/X11Ping.h"

namespace plume {

class X11PasteTarget {
  public:
    // The session outlives it.
    explicit X11PasteTarget(X11Session& session);
    X11PasteTarget(const X11PasteTarget&) = delete;
    X11PasteTarget& operator=(const X11PasteTarget&) = delete;

    // The keystroke is sent: the program in front is the target from now on.
    void begin(const X11FrontWindows& front);
    // The paste is of no interest any more.
    void end();
    // It is given something.
    void isGiven() { readsOn_ = true; }
    // It has taken something: `tell` is called when it reads no more, 0.3 s later at most. What it asks after that is
    // no part of the paste.
    void wasTaken(std::function<void()> tell);
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
    bool ask();
    void settle();
    void noteAnswer(bool isLatest);
    bool hasAnswered() const;

    X11Session& session_;
    X11FrontWindows windows_;
    xcb_timestamp_t replaced_ = 0;
    std::optional<double> answered_;   // when
    std::optional<double> firstLate_;  // when it first asked after the content was replaced
    X11Ping ping_;
    Timer asking_;
    std::function<void()> tell_;  // that it has taken something
    bool readsOn_ = false;        // after that
    Timer settling_;
};

}  // namespace plume
