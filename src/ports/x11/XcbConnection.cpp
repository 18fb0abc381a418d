#include "ports/x11/XcbConnection.h"

#include <xcb/xcbext.h>

#include <utility>

namespace plume {

namespace {

xcb_screen_t* screenOf(xcb_connection_t* connection, int number) {
    auto screens = xcb_setup_roots_iterator(xcb_get_setup(connection));
    for (; number > 0 && screens.rem > 1; --number) xcb_screen_next(&screens);
    return screens.data;
}

}  // namespace

Result<std::unique_ptr<XcbConnection>> XcbConnection::open(const std::string& display) {
    int screenNumber = 0;
    xcb_connection_t* connection = xcb_connect(display.empty() ? nullptr : display.c_str(), &screenNumber);
    const char* const variable = std::getenv("DISPLAY");
    const std::string name = !display.empty() ? display : variable ? variable : "";
    if (xcb_connection_has_error(connection) != 0) {
        xcb_disconnect(connection);
        if (name.empty()) return Error{"There is no X display: set DISPLAY, or start Plume from an X11 session."};
        return Error{"The X display \"" + name + "\" cannot be opened: is the X server running, and may you use it?"};
    }
    return std::unique_ptr<XcbConnection>(new XcbConnection(name, connection, screenNumber));
}

XcbConnection::XcbConnection(std::string display, xcb_connection_t* connection, int screenNumber)
    : display_(std::move(display)), connection_(connection), screen_(screenOf(connection, screenNumber)) {}

XcbConnection::~XcbConnection() {
    xcb_disconnect(connection_);
}

int XcbConnection::descriptor() const {
    return xcb_get_file_descriptor(connection_);
}

bool XcbConnection::isBroken() const {
    return xcb_connection_has_error(connection_) != 0;
}

xcb_atom_t XcbConnection::atom(std::string_view name) {
    const auto known = atoms_.find(name);
    if (known != atoms_.end()) return known->second;
    const auto cookie = xcb_intern_atom(connection_, 0, static_cast<std::uint16_t>(name.size()), name.data());
    const XcbOwned<xcb_intern_atom_reply_t> reply(xcb_intern_atom_reply(connection_, cookie, nullptr));
    if (!reply) return XCB_ATOM_NONE;
    atoms_.emplace(name, reply->atom);
    names_.emplace(reply->atom, name);
    return reply->atom;
}

std::string XcbConnection::atomName(xcb_atom_t atom) {
    const auto known = names_.find(atom);
    if (known != names_.end()) return known->second;
    const auto cookie = xcb_get_atom_name(connection_, atom);
    const XcbOwned<xcb_get_atom_name_reply_t> reply(xcb_get_atom_name_reply(connection_, cookie, nullptr));
    if (!reply) return {};
    std::string name(xcb_get_atom_name_name(reply.get()),
                     static_cast<std::size_t>(xcb_get_atom_name_name_length(reply.get())));
    atoms_.emplace(name, atom);
    return names_.emplace(atom, std::move(name)).first->second;
}

const xcb_query_extension_reply_t* XcbConnection::extension(xcb_extension_t& extension) const {
    const auto* data = xcb_get_extension_data(connection_, &extension);
    return data && data->present != 0 ? data : nullptr;
}

XcbOwned<xcb_generic_event_t> XcbConnection::pollEvent() const {
    return XcbOwned<xcb_generic_event_t>(xcb_poll_for_event(connection_));
}

void XcbConnection::flush() const {
    xcb_flush(connection_);
}

void XcbConnection::sync() const {
    const XcbOwned<xcb_get_input_focus_reply_t> reply(
        xcb_get_input_focus_reply(connection_, xcb_get_input_focus(connection_), nullptr));
}

}  // namespace plume
