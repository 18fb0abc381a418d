#include "ports/x11/X11Session.h"

#include <poll.h>

#include <algorithm>
#include <cmath>
#include <utility>
#include <vector>

namespace plume {

namespace {

constexpr std::string_view TimeProperty = "PLUME_TIME";
constexpr double LongestBetweenHeartbeats = 0.1;  // seconds
constexpr double LongestWaitForTheServer = 1;
constexpr std::uint8_t SentFlag = 0x80;

}  // namespace

Result<std::unique_ptr<X11Session>> X11Session::open(const std::string& display, PollRunLoop& runLoop) {
    auto connection = XcbConnection::open(display);
    if (!connection) return connection.error();
    return std::unique_ptr<X11Session>(new X11Session(std::move(connection).value(), runLoop));
}

X11Session::X11Session(std::unique_ptr<XcbConnection> connection, PollRunLoop& runLoop)
    : connection_(std::move(connection)), runLoop_(runLoop), window_(xcb_generate_id(connection_->get())) {
    xcb_create_window(get(), 0, window_, connection_->root(), -1, -1, 1, 1, 0, XCB_WINDOW_CLASS_INPUT_ONLY,
                      XCB_COPY_FROM_PARENT, 0, nullptr);
    windowEvents_ = listen(window_, XCB_EVENT_MASK_PROPERTY_CHANGE);
    const xcb_atom_t time = connection_->atom(TimeProperty);
    timeObserver_ = addObserver(XCB_PROPERTY_NOTIFY, [this, time](const xcb_generic_event_t& event) {
        const auto& change = reinterpret_cast<const xcb_property_notify_event_t&>(event);
        if (change.window == window_ && change.atom == time) noticedTime_ = change.time;
    });
    source_ = runLoop_.addSource(connection_->descriptor(), [this] { drain(); });
}

X11Session::WindowEvents::~WindowEvents() {
    if (session_) session_->unlisten(window_, eventMask_);
}

X11Session::WindowEvents& X11Session::WindowEvents::operator=(WindowEvents&& other) noexcept {
    const WindowEvents before = std::move(*this);
    session_ = std::exchange(other.session_, nullptr);
    window_ = std::exchange(other.window_, XCB_WINDOW_NONE);
    eventMask_ = other.eventMask_;
    return *this;
}

Subscription X11Session::addHandler(std::uint8_t eventType, Handler handler) {
    return add({.eventType = eventType, .observes = false, .handler = std::move(handler)});
}

Subscription X11Session::addObserver(std::uint8_t eventType, Handler observer) {
    return add({.eventType = eventType, .observes = true, .handler = std::move(observer)});
}

Subscription X11Session::add(Listener listener) {
    const auto added = std::make_shared<Listener>(std::move(listener));
    listeners_.emplace(++lastListener_, added);
    return Subscription(std::shared_ptr<bool>(added, &added->ended));
}

X11Session::WindowEvents X11Session::listen(xcb_window_t window, std::uint32_t eventMask) {
    ++masks_[window][eventMask];
    setEventMask(window);
    return {*this, window, eventMask};
}

void X11Session::unlisten(xcb_window_t window, std::uint32_t eventMask) {
    auto& masks = masks_.at(window);
    if (--masks.at(eventMask) > 0) return;
    masks.erase(eventMask);
    setEventMask(window);
    if (masks.empty()) masks_.erase(window);
}

void X11Session::setEventMask(xcb_window_t window) const {
    std::uint32_t all = 0;
    for (const auto& [mask, count] : masks_.at(window)) all |= mask;
    // For a window that has gone the answer is an error event, which nobody needs to hear.
    xcb_change_window_attributes(get(), window, XCB_CW_EVENT_MASK, &all);
}

void X11Session::dispatch(const xcb_generic_event_t& event, bool toObservers) {
    const auto type = static_cast<std::uint8_t>(event.response_type & ~SentFlag);
    // By key, not by iterator: a handler may add others, and have more events dispatched.
    for (auto next = listeners_.begin(); next != listeners_.end();) {
        const auto key = next->first;
        if (next->second->ended) {
            listeners_.erase(next);
        } else if (next->second->eventType == type && next->second->observes == toObservers) {
            const auto listener = next->second;
            listener->handler(event);
        }
        next = listeners_.upper_bound(key);
    }
}

void X11Session::collect() {
    while (auto event = connection_->pollEvent()) {
        dispatch(*event, true);
        collected_.push_back(std::move(event));
    }
    // The loop cannot see by itself that there is something to do.
    if (collected_.empty() || drains_ || pendingDrain_) return;
    pendingDrain_ = runLoop_.performAfterDelay(0, [this] { drain(); });
}

void X11Session::flush() {
    connection_->flush();
    collect();
}

void X11Session::drain() {
    drains_ = true;
    flush();
    while (!collected_.empty()) {
        const auto event = std::move(collected_.front());
        collected_.pop_front();
        dispatch(*event, false);
        flush();
    }
    drains_ = false;
    pendingDrain_.cancel();
    if (!connection_->isBroken() || std::exchange(serverIsGone_, true)) return;
    source_.end();
    if (serverGone) serverGone();
}

bool X11Session::waitUntil(const std::function<bool()>& condition, double seconds) {
    const double end = runLoop_.now() + seconds;
    for (bool first = true;; first = false) {
        if (!first && heartbeat) heartbeat();
        flush();
        if (condition()) return true;
        const double left = end - runLoop_.now();
        if (left <= 0 || connection_->isBroken()) return false;
        pollfd entry{connection_->descriptor(), POLLIN, 0};
        // Rounded up: the last millisecond is not spent in a busy loop.
        poll(&entry, 1, static_cast<int>(std::ceil(std::min(left, LongestBetweenHeartbeats) * 1000)));
    }
}

xcb_timestamp_t X11Session::serverTime() {
    noticedTime_ = 0;
    xcb_change_property(get(), XCB_PROP_MODE_APPEND, window_, connection_->atom(TimeProperty), XCB_ATOM_STRING, 8, 0,
                        nullptr);
    waitUntil([this] { return noticedTime_ != 0; }, LongestWaitForTheServer);
    return noticedTime_;
}

}  // namespace plume
