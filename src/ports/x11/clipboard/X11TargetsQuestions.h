// Programs that have to learn that the clipboard has another owner before they paste what it holds.
//
// VTE terminals ask what is on offer as soon as the owner changes, and paste nothing before they know. A paste into
// such a program waits for that question; a program that has not been met yet is given a moment to ask, once. A program
// that had the clipboard itself pastes its own content until it has heard of the change and, LibreOffice with GTK,
// asked what is on offer: it is sent a ping, and the paste waits for that question or the answer. Belongs to the tap
// thread.
#pragma once

#include <xcb/xcb.h>

#include <functional>
#include <map>
#include <set>

#include "ports/x11/X11Session.h"
#include "ports/x11/clipboard/X11FrontPrograms.h"
#include "ports/x11/clipboard/X11Ping.h"

namespace plume {

class X11TargetsQuestions {
  public:
    // The session outlives it.
    explicit X11TargetsQuestions(X11Session& session);
    X11TargetsQuestions(const X11TargetsQuestions&) = delete;
    X11TargetsQuestions& operator=(const X11TargetsQuestions&) = delete;

    // The clipboard has another owner, or none: nobody knows what is on offer.
    void ownerChanged(xcb_window_t owner);
    // A window asked, and the answer is on its way.
    void wasAnswered(xcb_window_t requestor);
    // Whether its program asked since the owner changed.
    bool isAnswered(xcb_window_t requestor) const { return answered_.contains(clientOf(session_, requestor)); }
    // Calls with what is in front, when that program knows what it wants to know: now, or from the run loop, at most
    // 0.2 s later, or one second if it had the clipboard. A call that still waits is dropped.
    using Paste = std::function<void(const X11FrontWindows& front)>;
    void whenAnswered(Paste paste);

  private:
    double longestWait(xcb_window_t active);
    void giveUp();
    void proceed();
    void proceed(const X11FrontWindows& front);

    X11Session& session_;
    xcb_window_t owner_ = XCB_WINDOW_NONE;   // client, as the next two
    xcb_window_t former_ = XCB_WINDOW_NONE;  // the owner before
    std::set<xcb_window_t> answered_;        // since the owner changed
    std::map<xcb_window_t, bool> asks_;      // what is known of clients, other than former owners
    double changed_ = 0;                     // when the owner changed
    bool hasPasted_ = false;                 // since then: questions are part of the paste from then on
    xcb_window_t awaited_ = XCB_WINDOW_NONE;
    Paste paste_;
    X11Ping ping_;  // of a former owner
    Timer waiting_;
};

}  // namespace plume
