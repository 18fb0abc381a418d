#include "ports/x11/keyboard/HardwareKeyboards.h"

#include <algorithm>
#include <string>

namespace plume {

namespace {

// A keyboard that another program has grabbed is attached to no master meanwhile.
bool isGrabbedByAnother(const InputDevice& device) {
    return device.type == XCB_INPUT_DEVICE_TYPE_FLOATING_SLAVE && device.keySource != 0;
}

Error nothingToGrab(const TapConnection& connection, const std::string& occupied) {
    const std::string& display = connection.connection().displayName();
    if (!occupied.empty()) {
        return Error{"The keyboard \"" + occupied + "\" of display \"" + display +
                     "\" is held by another program, perhaps another Plume or key tool: end that program."};
    }
    return Error{"The X server of display \"" + display +
                 R"(" has no keyboard but its own: "xinput list" has to show one below "Virtual core keyboard".)"};
}

}  // namespace

std::vector<InputDevice> HardwareKeyboards::list(const TapConnection& connection) {
    auto devices = inputDevices(connection.connection());
    std::erase_if(devices, [&](const InputDevice& device) {
        return device.type != XCB_INPUT_DEVICE_TYPE_SLAVE_KEYBOARD || device.isTestKeyboard() || !device.enabled ||
               device.attachment != connection.masterKeyboard();
    });
    return devices;
}

Result<void> HardwareKeyboards::check(const TapConnection& connection) {
    const auto devices = inputDevices(connection.connection());
    if (!list(connection).empty() || std::ranges::any_of(devices, isGrabbedByAnother)) return {};
    return nothingToGrab(connection, {});
}

Result<void> HardwareKeyboards::grab() {
    std::string occupied;
    for (const InputDevice& device : list(connection_)) {
        if (!grab(device.id)) occupied = device.name;
    }
    if (!grabbed_.empty()) return {};
    for (const InputDevice& device : inputDevices(connection_.connection())) {
        if (isGrabbedByAnother(device)) occupied = device.name;
    }
    return nothingToGrab(connection_, occupied);
}

void HardwareKeyboards::grabNew() {
    for (const InputDevice& device : list(connection_)) {
        if (std::ranges::find(grabbed_, device.id) == grabbed_.end()) grab(device.id);
    }
}

bool HardwareKeyboards::grab(std::uint16_t device) {
    auto* const connection = connection_.connection().get();
    constexpr std::uint32_t Events = XCB_INPUT_XI_EVENT_MASK_KEY_PRESS | XCB_INPUT_XI_EVENT_MASK_KEY_RELEASE;
    const auto cookie = xcb_input_xi_grab_device(
        connection, connection_.connection().root(), XCB_CURRENT_TIME, XCB_NONE, device, XCB_INPUT_GRAB_MODE_22_ASYNC,
        XCB_INPUT_GRAB_MODE_22_ASYNC, XCB_INPUT_GRAB_OWNER_NO_OWNER, 1, &Events);
    const XcbOwned<xcb_input_xi_grab_device_reply_t> reply(xcb_input_xi_grab_device_reply(connection, cookie, nullptr));
    if (!reply || reply->status != XCB_GRAB_STATUS_SUCCESS) return false;
    grabbed_.push_back(device);
    return true;
}

void HardwareKeyboards::ungrab() {
    for (const std::uint16_t device : grabbed_) {
        xcb_input_xi_ungrab_device(connection_.connection().get(), XCB_CURRENT_TIME, device);
    }
    grabbed_.clear();
}

void HardwareKeyboards::forget(std::uint16_t device) {
    std::erase(grabbed_, device);
}

KeycodeSet HardwareKeyboards::keysDown() const {
    KeycodeSet down;
    for (const std::uint16_t device : grabbed_) down |= keysDownOn(connection_.connection(), device);
    return down;
}

}  // namespace plume
