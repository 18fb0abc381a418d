#include "ports/x11/keyboard/TapConnection.h"

#include <xcb/xinput.h>
#include <xcb/xtest.h>

#include <string_view>
#include <utility>

#include "ports/x11/keyboard/HardwareKeyboards.h"
#include "ports/x11/keyboard/InputDevices.h"

namespace plume {

namespace {

Error lacking(const XcbConnection& connection, const std::string& what) {
    return Error{"The X server of display \"" + connection.displayName() + "\" lacks " + what};
}

// 2.1 is the first version in which devices can be told apart and heard under other programs' grabs.
bool hasInputExtension(const XcbConnection& connection) {
    if (!connection.extension(xcb_input_id)) return false;
    const auto cookie = xcb_input_xi_query_version(connection.get(), 2, 2);
    const XcbOwned<xcb_input_xi_query_version_reply_t> reply(
        xcb_input_xi_query_version_reply(connection.get(), cookie, nullptr));
    return reply && (reply->major_version > 2 || (reply->major_version == 2 && reply->minor_version >= 1));
}

}  // namespace

Result<std::unique_ptr<TapConnection>> TapConnection::open(const std::string& display, const XkbKeyboard& keyboard) {
    auto connection = XcbConnection::open(display);
    if (!connection) return connection.error();
    std::unique_ptr<TapConnection> tap(new TapConnection(std::move(connection).value(), keyboard));
    if (const auto begun = tap->begin(); !begun) return begun.error();
    return tap;
}

Result<void> TapConnection::check(const std::string& display) {
    const auto connection = XcbConnection::open(display);
    if (!connection) return connection.error();
    const auto keyboard = XkbKeyboard::open(*connection.value());
    if (!keyboard) return keyboard.error();
    const auto tap = open(display, *keyboard.value());
    if (!tap) return tap.error();
    return HardwareKeyboards::check(*tap.value());
}

Result<void> TapConnection::begin() {
    if (!hasInputExtension(*connection_)) {
        return lacking(*connection_,
                       "XInput 2.1, by which Plume hears keys: use X.Org 1.11 or newer, with the XInputExtension on.");
    }
    if (!connection_->extension(xcb_test_id)) {
        return lacking(*connection_,
                       "the XTEST extension, by which Plume types: switch it on (\"xdpyinfo\" lists what is on).");
    }
    inputOpcode_ = connection_->extension(xcb_input_id)->major_opcode;
    window_ = xcb_generate_id(connection_->get());
    xcb_create_window(connection_->get(), 0, window_, connection_->root(), 0, 0, 1, 1, 0, XCB_WINDOW_CLASS_INPUT_ONLY,
                      XCB_COPY_FROM_PARENT, 0, nullptr);
    return findDevices();
}

Result<void> TapConnection::findDevices() {
    const auto pointerCookie = xcb_input_xi_get_client_pointer(connection_->get(), XCB_NONE);
    const XcbOwned<xcb_input_xi_get_client_pointer_reply_t> pointer(
        xcb_input_xi_get_client_pointer_reply(connection_->get(), pointerCookie, nullptr));
    const auto devices = inputDevices(*connection_);
    masterKeyboard_ = 0;
    testKeyboard_ = 0;
    for (const InputDevice& device : devices) {
        const bool paired = !pointer || pointer->set == 0 || device.attachment == pointer->deviceid;
        if (device.type == XCB_INPUT_DEVICE_TYPE_MASTER_KEYBOARD && paired) {
            masterKeyboard_ = device.id;
            break;
        }
    }
    for (const InputDevice& device : devices) {
        if (device.isTestKeyboard() && device.attachment == masterKeyboard_) testKeyboard_ = device.id;
    }
    if (testKeyboard_ != 0) return {};
    return lacking(*connection_, "an XTEST keyboard on the main keyboard: was it removed with xinput?");
}

Result<void> TapConnection::reopen() {
    auto connection = XcbConnection::open(connection_->displayName());
    if (!connection) return connection.error();
    connection_ = std::move(connection).value();
    keysDown_.reset();
    userKeys.reset();
    hearsPresses_ = false;
    ownPresses_.reset();
    progress_.begin();
    if (auto begun = begin(); !begun) return begun;
    keysDown_ = keysDownOn(*connection_, testKeyboard_);
    releaseAll();
    connection_->sync();
    if (reopened_) reopened_(window_);
    return {};
}

void TapConnection::sendKey(xcb_keycode_t keycode, bool down) {
    const auto cookie = xcb_test_fake_input(connection_->get(), down ? XCB_KEY_PRESS : XCB_KEY_RELEASE, keycode,
                                            XCB_CURRENT_TIME, XCB_NONE, 0, 0, 0);
    ownPresses_[cookie.sequence % ownPresses_.size()] = down && hearsPresses_;
    keysDown_[keycode] = down;
}

void TapConnection::setHearsPresses(bool hears) {
    hearsPresses_ = hears;
    selectDeviceEvents(*connection_, testKeyboard_, hears ? XCB_INPUT_XI_EVENT_MASK_RAW_KEY_PRESS : 0);
}

bool TapConnection::isOwnPress(unsigned sequence) {
    auto pressed = ownPresses_[sequence % ownPresses_.size()];
    const bool own = pressed;
    pressed = false;
    return own;
}

std::uint8_t TapConnection::modifiersDown() const {
    std::uint8_t modifiers = 0;
    for (std::size_t i = 0; i < keysDown_.size(); ++i) {
        if (!keysDown_[i]) continue;
        modifiers =
            static_cast<std::uint8_t>(modifiers | keyboard_.keymap()->modifiersOf(static_cast<xcb_keycode_t>(i)));
    }
    return modifiers;
}

void TapConnection::keepMenusClosed() {
    // By convention; the server knows these only by number.
    constexpr std::uint8_t Alt = XCB_MOD_MASK_1;
    constexpr std::uint8_t Super = XCB_MOD_MASK_4;
    const std::uint8_t down = modifiersDown();
    const xcb_keycode_t control = keyboard_.keymap()->keyOfModifier(XCB_MOD_MASK_CONTROL);
    if ((down & (Alt | Super)) == 0 || (down & XCB_MOD_MASK_CONTROL) != 0 || control == 0) return;
    sendKey(control, true);
    sendKey(control, false);
}

void TapConnection::releaseAll() {
    for (std::size_t i = 0; i < keysDown_.size(); ++i) {
        if (keysDown_[i]) sendKey(static_cast<xcb_keycode_t>(i), false);
    }
    flush();
}

}  // namespace plume
