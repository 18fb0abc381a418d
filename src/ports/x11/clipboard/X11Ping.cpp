#include "ports/x11/clipboard/X11Ping.h"

#include <algorithm>
#include <cstring>
#include <utility>
#include <vector>

namespace plume {

namespace {
constexpr std::uint32_t MostProtocols = 64;
}

X11Ping::X11Ping(X11Session& session, std::function<void(bool isLatest)> answered)
    : session_(session), answered_(std::move(answered)) {
    answerHandler_ =
        session_.addHandler(XCB_CLIENT_MESSAGE, [this](const xcb_generic_event_t& event) { noteAnswer(event); });
}

bool X11Ping::send(xcb_window_t window) {
    if (!isUnderstoodBy(window)) return false;
    XcbConnection& connection = session_.connection();
    rootEvents_ = session_.listen(connection.root(), XCB_EVENT_MASK_SUBSTRUCTURE_NOTIFY);
    latest_ = session_.serverTime();
    if (window_ != window) first_ = latest_;
    window_ = window;
    xcb_client_message_event_t message{};
    message.response_type = XCB_CLIENT_MESSAGE;
    message.format = 32;
    message.window = window;
    message.type = connection.atom("WM_PROTOCOLS");
    message.data.data32[0] = connection.atom("_NET_WM_PING");
    message.data.data32[1] = latest_;
    message.data.data32[2] = window;
    xcb_send_event(session_.get(), 0, window, XCB_EVENT_MASK_NO_EVENT, reinterpret_cast<const char*>(&message));
    session_.flush();
    return true;
}

void X11Ping::end() {
    window_ = XCB_WINDOW_NONE;
    rootEvents_ = {};
}

bool X11Ping::isUnderstoodBy(xcb_window_t window) const {
    if (window == XCB_WINDOW_NONE) return false;
    XcbConnection& connection = session_.connection();
    const XcbOwned<xcb_get_property_reply_t> reply(xcb_get_property_reply(
        session_.get(),
        xcb_get_property(session_.get(), 0, window, connection.atom("WM_PROTOCOLS"), XCB_ATOM_ATOM, 0, MostProtocols),
        nullptr));
    if (!reply || reply->format != 32) return false;
    std::vector<xcb_atom_t> protocols(static_cast<std::size_t>(xcb_get_property_value_length(reply.get())) / 4);
    if (protocols.empty()) return false;
    std::memcpy(protocols.data(), xcb_get_property_value(reply.get()), protocols.size() * 4);
    return std::ranges::find(protocols, connection.atom("_NET_WM_PING")) != protocols.end();
}

void X11Ping::noteAnswer(const xcb_generic_event_t& event) {
    const auto& message = reinterpret_cast<const xcb_client_message_event_t&>(event);
    XcbConnection& connection = session_.connection();
    const bool isAnswer =
        wasSent() && message.window == connection.root() && message.type == connection.atom("WM_PROTOCOLS") &&
        message.data.data32[0] == connection.atom("_NET_WM_PING") && message.data.data32[2] == window_;
    // Others ping, too, and earlier questions may be answered late.
    const xcb_timestamp_t time = message.data.data32[1];
    if (!isAnswer || static_cast<std::int32_t>(time - first_) < 0) return;
    const bool isLatest = time == latest_;
    if (isLatest) rootEvents_ = {};
    answered_(isLatest);
}

}  // namespace plume
