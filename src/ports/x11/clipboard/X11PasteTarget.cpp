#include "ports/x11/clipboard/X11PasteTarget.h"

#include <algorithm>
#include <cstring>
#include <utility>
#include <vector>

namespace plume {

namespace {

constexpr double PingDelay = 0.3;  // seconds from the keystroke
// The questions of one paste follow one another, and an answer to the ping may overtake them, within so many seconds.
constexpr double Grace = 0.3;
constexpr double LongestSettling = 0.3;
constexpr std::uint32_t MostProtocols = 64;

}  // namespace

X11PasteTarget::X11PasteTarget(X11Session& session) : session_(session) {
    answerHandler_ =
        session_.addHandler(XCB_CLIENT_MESSAGE, [this](const xcb_generic_event_t& event) { noteAnswer(event); });
}

void X11PasteTarget::begin() {
    end();
    windows_ = windowsInFront(session_);
    ping_ = session_.runLoop().performAfterDelay(PingDelay, [this] { ping(); });
}

void X11PasteTarget::end() {
    windows_ = {};
    replaced_ = 0;
    asked_ = false;
    answered_.reset();
    firstLate_.reset();
    ping_.cancel();
    rootEvents_ = {};
    tell_ = nullptr;
    settling_.cancel();
}

void X11PasteTarget::wasTaken(std::function<void()> tell) {
    if (replaced_ != 0 && !answered_) answered_ = session_.runLoop().now();
    if (!tell_) settling_ = session_.runLoop().performAfterDelay(LongestSettling, [this] { settle(); });
    tell_ = std::move(tell);
    readsOn_ = false;
    if (!ping()) settle();
}

void X11PasteTarget::settle() {
    const auto tell = std::exchange(tell_, nullptr);
    settling_.cancel();
    if (replaced_ == 0) end();
    if (tell) tell();
}

bool X11PasteTarget::isOf(xcb_window_t requestor) const {
    const xcb_window_t client = clientOf(session_, requestor);
    return client == clientOf(session_, windows_.focus) || client == clientOf(session_, windows_.active);
}

bool X11PasteTarget::ping() {
    ping_.cancel();
    if (!understandsPing()) return false;
    XcbConnection& connection = session_.connection();
    rootEvents_ = session_.listen(connection.root(), XCB_EVENT_MASK_SUBSTRUCTURE_NOTIFY);
    xcb_client_message_event_t message{};
    message.response_type = XCB_CLIENT_MESSAGE;
    message.format = 32;
    message.window = windows_.active;
    message.type = connection.atom("WM_PROTOCOLS");
    message.data.data32[0] = connection.atom("_NET_WM_PING");
    message.data.data32[1] = pinged_ = session_.serverTime();
    message.data.data32[2] = windows_.active;
    xcb_send_event(session_.get(), 0, windows_.active, XCB_EVENT_MASK_NO_EVENT,
                   reinterpret_cast<const char*>(&message));
    session_.flush();
    asked_ = true;
    return true;
}

bool X11PasteTarget::understandsPing() const {
    XcbConnection& connection = session_.connection();
    if (windows_.active == XCB_WINDOW_NONE) return false;
    const XcbOwned<xcb_get_property_reply_t> reply(
        xcb_get_property_reply(session_.get(),
                               xcb_get_property(session_.get(), 0, windows_.active, connection.atom("WM_PROTOCOLS"),
                                                XCB_ATOM_ATOM, 0, MostProtocols),
                               nullptr));
    if (!reply || reply->format != 32) return false;
    std::vector<xcb_atom_t> protocols(static_cast<std::size_t>(xcb_get_property_value_length(reply.get())) / 4);
    if (protocols.empty()) return false;
    std::memcpy(protocols.data(), xcb_get_property_value(reply.get()), protocols.size() * 4);
    return std::ranges::find(protocols, connection.atom("_NET_WM_PING")) != protocols.end();
}

void X11PasteTarget::noteAnswer(const xcb_generic_event_t& event) {
    const auto& message = reinterpret_cast<const xcb_client_message_event_t&>(event);
    XcbConnection& connection = session_.connection();
    const bool isAnswer =
        asked_ && message.window == connection.root() && message.type == connection.atom("WM_PROTOCOLS") &&
        message.data.data32[0] == connection.atom("_NET_WM_PING") && message.data.data32[2] == windows_.active;
    if (!isAnswer) return;
    if (!answered_) answered_ = session_.runLoop().now();
    if (message.data.data32[1] != pinged_) return;
    rootEvents_ = {};
    if (tell_ && !readsOn_) settle();
}

bool X11PasteTarget::hasAnswered() const {
    return answered_ && session_.runLoop().now() - *answered_ > Grace;
}

bool X11PasteTarget::isAwaited() const {
    return asked_ && !hasAnswered() && isInFront(session_, windows_.active);
}

bool X11PasteTarget::isLate(xcb_window_t requestor, xcb_timestamp_t time) {
    if (replaced_ == 0 || !isOf(requestor)) return false;
    const double now = session_.runLoop().now();
    const bool goesOn = firstLate_ && now - *firstLate_ < Grace;
    const bool isOlder = time != XCB_CURRENT_TIME && static_cast<std::int32_t>(time - replaced_) < 0;
    const bool isForPaste = asked_ || isOlder;
    if (!goesOn && (hasAnswered() || !isForPaste)) return false;
    if (!firstLate_) firstLate_ = now;
    return true;
}

}  // namespace plume
