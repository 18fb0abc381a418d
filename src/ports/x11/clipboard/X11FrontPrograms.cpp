#include "ports/x11/clipboard/X11FrontPrograms.h"

#include <cstring>

namespace plume {

X11FrontWindows windowsInFront(X11Session& session) {
    xcb_connection_t* const connection = session.get();
    const auto focusCookie = xcb_get_input_focus(connection);
    const auto activeCookie = xcb_get_property(connection, 0, session.connection().root(),
                                               session.connection().atom("_NET_ACTIVE_WINDOW"), XCB_ATOM_WINDOW, 0, 1);
    const XcbOwned<xcb_get_input_focus_reply_t> focus(xcb_get_input_focus_reply(connection, focusCookie, nullptr));
    const XcbOwned<xcb_get_property_reply_t> active(xcb_get_property_reply(connection, activeCookie, nullptr));
    X11FrontWindows front;
    if (focus) front.focus = focus->focus;
    if (active && xcb_get_property_value_length(active.get()) == sizeof front.active) {
        std::memcpy(&front.active, xcb_get_property_value(active.get()), sizeof front.active);
    }
    return front;
}

xcb_window_t clientOf(X11Session& session, xcb_window_t window) {
    return window & ~xcb_get_setup(session.get())->resource_id_mask;
}

bool isInFront(X11Session& session, xcb_window_t window) {
    const X11FrontWindows front = windowsInFront(session);
    const xcb_window_t client = clientOf(session, window);
    return clientOf(session, front.focus) == client || clientOf(session, front.active) == client;
}

}  // namespace plume
