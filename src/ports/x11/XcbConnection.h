// One connection to the X server: what is common to all that the X11 port does.
//
// Belongs to one thread. Broken connections (the server is gone, somebody had it killed) answer nothing and never end
// the program: isBroken() tells.
#pragma once

#include <xcb/xcb.h>

#include <cstdlib>
#include <map>
#include <memory>
#include <string>
#include <string_view>

#include "Foundation/Result.h"

namespace plume {

struct XcbFree {
    void operator()(void* memory) const { std::free(memory); }
};
// Replies, errors and events, which are the caller's to free.
template <typename Type>
using XcbOwned = std::unique_ptr<Type, XcbFree>;

class XcbConnection {
  public:
    // An empty name means $DISPLAY. The error names the display and what to do.
    static Result<std::unique_ptr<XcbConnection>> open(const std::string& display);
    ~XcbConnection();
    XcbConnection(const XcbConnection&) = delete;
    XcbConnection& operator=(const XcbConnection&) = delete;

    xcb_connection_t* get() const { return connection_; }
    const std::string& displayName() const { return display_; }
    const xcb_screen_t& screen() const { return *screen_; }
    xcb_window_t root() const { return screen_->root; }
    int descriptor() const;
    bool isBroken() const;

    // Asked of the server once per name.
    xcb_atom_t atom(std::string_view name);
    std::string atomName(xcb_atom_t atom);
    // Null when the server lacks the extension.
    const xcb_query_extension_reply_t* extension(xcb_extension_t& extension) const;

    // The next event that has arrived; null when there is none. Never waits.
    XcbOwned<xcb_generic_event_t> pollEvent() const;
    void flush() const;
    // Waits until the server has dealt with everything sent so far.
    void sync() const;

  private:
    XcbConnection(std::string display, xcb_connection_t* connection, int screenNumber);

    std::string display_;
    xcb_connection_t* connection_;
    xcb_screen_t* screen_;
    std::map<std::string, xcb_atom_t, std::less<>> atoms_;
    std::map<xcb_atom_t, std::string> names_;
};

}  // namespace plume
