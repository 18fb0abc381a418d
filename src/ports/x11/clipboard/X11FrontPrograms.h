// Which program is in front, as far as pasting minds it. One program is one client of the X server: it numbers the
// windows of one client alike.
//
// Belongs to the tap thread; asks the server each time, never a program.
#pragma once

#include <xcb/xcb.h>

#include "ports/x11/X11Session.h"

namespace plume {

struct X11FrontWindows {
    xcb_window_t focus = XCB_WINDOW_NONE;   // has the keyboard
    xcb_window_t active = XCB_WINDOW_NONE;  // the window manager's active window
};

X11FrontWindows windowsInFront(X11Session& session);
// What the windows of one client have in common.
xcb_window_t clientOf(X11Session& session, xcb_window_t window);
bool isInFront(X11Session& session, xcb_window_t window);

}  // namespace plume
