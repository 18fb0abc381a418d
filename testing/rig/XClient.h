#pragma once

#include <xcb/xcb.h>

#include <cstdint>
#include <functional>
#include <string>
#include <vector>

#include "testing/rig/RigError.h"

namespace plume::rig {

// A test's own connection to the X server: it looks at what windows there are and which one has the focus, and asks the
// window manager to bring one to the front. One thread.
class XClient {
  public:
    explicit XClient(const std::string& display);  // throws RigError
    ~XClient();
    XClient(const XClient&) = delete;
    XClient& operator=(const XClient&) = delete;

    xcb_connection_t* connection() const { return connection_; }
    xcb_window_t root() const { return screen_->root; }
    const xcb_screen_t& screen() const { return *screen_; }

    xcb_atom_t atom(const std::string& name);

    // The bytes of a property of any type, empty when it is not there.
    std::string property(xcb_window_t window, const std::string& name);

    // The window manager's active window, and the window that the server sends keys to; 0 when there is none.
    xcb_window_t activeWindow();
    xcb_window_t focusedWindow();

    // Whether the server still has a button press to give to a program, or the release that follows it.
    bool isButtonDown();

    // The window that owns a selection such as CLIPBOARD; 0 when nobody does.
    xcb_window_t selectionOwner(const std::string& selection);
    // Takes it away from whoever has it.
    void emptySelection(const std::string& selection);
    bool exists(xcb_window_t window);

    // Whether two windows were made by the same connection, which almost always means by the same program.
    bool areOfSameClient(xcb_window_t one, xcb_window_t other) const;

    // The top-level windows that the window manager manages, oldest first.
    std::vector<xcb_window_t> managedWindows();

    // The keys that are down for programs, by their keycodes, and the modifiers, locked ones included.
    std::vector<int> keysDown();
    std::uint16_t modifiers();

    // Where a window is on the screen, in pixels, without its frame.
    struct Place {
        int x = 0;
        int y = 0;
        int width = 0;
        int height = 0;
    };
    Place placeOf(xcb_window_t window);

    // The window and everything in it.
    std::vector<xcb_window_t> treeOf(xcb_window_t window);
    bool isInside(xcb_window_t window, xcb_window_t ancestor);

    // Asks the window manager to activate a top-level window, and waits until it is the active window and has the
    // keyboard focus; throws RigError when that does not happen.
    void activate(xcb_window_t window);

    // Waits until the condition holds; it is asked again at every change of the root window's properties and every few
    // milliseconds. Throws RigError saying `what` did not happen.
    void await(const std::string& what, Milliseconds bound, const std::function<bool()>& condition);

  private:
    xcb_window_t windowProperty(xcb_window_t window, const std::string& name);

    xcb_connection_t* connection_;
    xcb_screen_t* screen_ = nullptr;
};

}  // namespace plume::rig
