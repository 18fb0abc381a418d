#include "ports/x11/keyboard/X11SecureInput.h"

#include <utility>

#include "ports/x11/keyboard/KeyboardGrabCheck.h"

namespace plume {

namespace {
// A program that starts, or asks for a password after some work, takes its time.
constexpr std::chrono::seconds LongestToGrab{10};
}  // namespace

Result<std::unique_ptr<X11SecureInput>> X11SecureInput::open(const std::string& display,
                                                             std::function<bool()> focusIsPassword) {
    auto connection = XcbConnection::open(display);
    if (!connection) return connection.error();
    return std::unique_ptr<X11SecureInput>(
        new X11SecureInput(std::move(connection).value(), std::move(focusIsPassword)));
}

X11SecureInput::X11SecureInput(std::unique_ptr<XcbConnection> connection, std::function<bool()> focusIsPassword)
    : connection_(std::move(connection)),
      focusIsPassword_(std::move(focusIsPassword)),
      neverShown_(xcb_generate_id(connection_->get())) {
    xcb_create_window(connection_->get(), 0, neverShown_, connection_->root(), -1, -1, 1, 1, 0,
                      XCB_WINDOW_CLASS_INPUT_ONLY, XCB_COPY_FROM_PARENT, 0, nullptr);
}

bool X11SecureInput::isSecureEventInputEnabled() const {
    return (focusIsPassword_ && focusIsPassword_()) || isKeyboardHeld();
}

bool X11SecureInput::isKeyboardHeld() const {
    if (heldByUs_ && heldByUs_()) return false;
    if (!isHeld_ && Clock::now() - happenedAt_.load() > LongestToGrab) return false;
    xcb_connection_t* const server = connection_->get();
    const auto cookie =
        xcb_grab_keyboard(server, 0, neverShown_, XCB_CURRENT_TIME, XCB_GRAB_MODE_ASYNC, XCB_GRAB_MODE_ASYNC);
    const XcbOwned<xcb_grab_keyboard_reply_t> reply(xcb_grab_keyboard_reply(server, cookie, nullptr));
    isHeld_ = reply && tellsOfGrab(*reply);
    return isHeld_;
}

}  // namespace plume
