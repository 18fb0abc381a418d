#include "ports/x11/clipboard/X11PasteTarget.h"

#include <utility>

namespace plume {

namespace {

constexpr double PingDelay = 0.3;  // seconds from the keystroke
// The questions of one paste follow one another, and an answer to the ping may overtake them, within so many seconds.
constexpr double Grace = 0.3;
constexpr double LongestSettling = 0.3;

}  // namespace

X11PasteTarget::X11PasteTarget(X11Session& session)
    : session_(session), ping_(session, [this](bool isLatest) { noteAnswer(isLatest); }) {}

void X11PasteTarget::begin(const X11FrontWindows& front) {
    end();
    windows_ = front;
    asking_ = session_.runLoop().performAfterDelay(PingDelay, [this] { ask(); });
}

void X11PasteTarget::end() {
    windows_ = {};
    replaced_ = 0;
    answered_.reset();
    firstLate_.reset();
    asking_.cancel();
    ping_.end();
    tell_ = nullptr;
    settling_.cancel();
}

void X11PasteTarget::wasTaken(std::function<void()> tell) {
    if (replaced_ != 0 && !answered_) answered_ = session_.runLoop().now();
    if (!tell_) settling_ = session_.runLoop().performAfterDelay(LongestSettling, [this] { settle(); });
    tell_ = std::move(tell);
    readsOn_ = false;
    if (!ask()) settle();
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

bool X11PasteTarget::ask() {
    asking_.cancel();
    return ping_.send(windows_.active);
}

void X11PasteTarget::noteAnswer(bool isLatest) {
    if (!answered_) answered_ = session_.runLoop().now();
    if (isLatest && tell_ && !readsOn_) settle();
}

bool X11PasteTarget::hasAnswered() const {
    return answered_ && session_.runLoop().now() - *answered_ > Grace;
}

bool X11PasteTarget::isAwaited() const {
    return ping_.wasSent() && !hasAnswered() && isInFront(session_, windows_.active);
}

bool X11PasteTarget::isLate(xcb_window_t requestor, xcb_timestamp_t time) {
    if (replaced_ == 0 || !isOf(requestor)) return false;
    const double now = session_.runLoop().now();
    const bool goesOn = firstLate_ && now - *firstLate_ < Grace;
    const bool isOlder = time != XCB_CURRENT_TIME && static_cast<std::int32_t>(time - replaced_) < 0;
    const bool isForPaste = ping_.wasSent() || isOlder;
    if (!goesOn && (hasAnswered() || !isForPaste)) return false;
    if (!firstLate_) firstLate_ = now;
    return true;
}

}  // namespace plume
