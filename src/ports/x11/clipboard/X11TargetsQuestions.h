// Programs that ask what is on offer as soon as the clipboard has another owner, and paste nothing before they know.
//
// VTE terminals do it. A paste into such a program waits for that question; a program that has not been met yet is
// given a moment to ask, once. Belongs to the tap thread.
#pragma once

#include <xcb/xcb.h>

#include <functional>
#include <map>
#include <set>

#include "ports/x11/X11Session.h"

namespace plume {

class X11TargetsQuestions {
  public:
    // The session outlives it.
    explicit X11TargetsQuestions(X11Session& session) : session_(session) {}
    X11TargetsQuestions(const X11TargetsQuestions&) = delete;
    X11TargetsQuestions& operator=(const X11TargetsQuestions&) = delete;

    // The clipboard has another owner: nobody knows what is on offer.
    void ownerChanged();
    // A window asked, and the answer is on its way.
    void wasAnswered(xcb_window_t requestor);
    // Calls `paste` when the program in front knows what it wants to know: now, or from the run loop, at most 0.2 s
    // later. A call that still waits is dropped.
    void whenAnswered(std::function<void()> paste);

  private:
    void giveUp();
    void proceed();

    X11Session& session_;
    std::set<xcb_window_t> answered_;    // clients, since the owner changed
    std::map<xcb_window_t, bool> asks_;  // what is known of clients
    double changed_ = 0;                 // when the owner changed
    bool hasPasted_ = false;             // since then: questions are part of the paste from then on
    xcb_window_t awaited_ = XCB_WINDOW_NONE;
    std::function<void()> paste_;
    Timer waiting_;
};

}  // namespace plume
