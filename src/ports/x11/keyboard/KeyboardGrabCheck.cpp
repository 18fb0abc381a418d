#include "ports/x11/keyboard/KeyboardGrabCheck.h"

#include <xcb/xcbext.h>

#include <memory>
#include <utility>

namespace plume {

namespace {

// Seconds of a pause in which another program may have grabbed the keyboard. Asking takes about 15 microseconds.
constexpr double LongestAge = 0.3;

}  // namespace

bool tellsOfGrab(const xcb_grab_keyboard_reply_t& refusal) {
    return refusal.status == XCB_GRAB_STATUS_ALREADY_GRABBED || refusal.status == XCB_GRAB_STATUS_FROZEN;
}

KeyboardGrabCheck::~KeyboardGrabCheck() {
    if (asked_) xcb_discard_reply(connection_.connection().get(), asked_->sequence);
}

void KeyboardGrabCheck::ask(double now) {
    if (asked_) return;
    asked_ = xcb_grab_keyboard(connection_.connection().get(), 0, connection_.window(), XCB_CURRENT_TIME,
                               XCB_GRAB_MODE_ASYNC, XCB_GRAB_MODE_ASYNC);
    askedAt_ = now;
}

bool KeyboardGrabCheck::isGrabbed(double now) {
    auto* const connection = connection_.connection().get();
    if (asked_) {
        void* answer = nullptr;
        xcb_generic_error_t* error = nullptr;
        if (xcb_poll_for_reply(connection, asked_->sequence, &answer, &error) != 0) {
            const XcbOwned<xcb_grab_keyboard_reply_t> reply(static_cast<xcb_grab_keyboard_reply_t*>(answer));
            const XcbOwned<xcb_generic_error_t> ignored(error);
            asked_.reset();
            if (reply) grabbed_ = tellsOfGrab(*reply);
        }
    }
    if (now - askedAt_ <= LongestAge) return grabbed_;
    if (asked_) xcb_discard_reply(connection, std::exchange(asked_, {})->sequence);
    ask(now);
    const XcbOwned<xcb_grab_keyboard_reply_t> reply(
        xcb_grab_keyboard_reply(connection, *std::exchange(asked_, {}), nullptr));
    if (reply) grabbed_ = tellsOfGrab(*reply);
    return grabbed_;
}

}  // namespace plume
