#include "ports/x11/watchdog/WatchdogConnection.h"

#include <xcb/xinput.h>
#include <xcb/xtest.h>

#include <utility>

#include "ports/x11/keyboard/InputDevices.h"

namespace plume {

Result<std::unique_ptr<WatchdogConnection>> WatchdogConnection::open(const std::string& display) {
    auto opened = XcbConnection::open(display);
    if (!opened) return opened.error();
    auto connection = std::move(opened).value();
    const auto* const input = connection->extension(xcb_input_id);
    if (!input || !connection->extension(xcb_test_id)) {
        return Error{"The X server of display \"" + connection->displayName() +
                     "\" lacks the XInput or XTEST extension."};
    }
    // Keys are told of while somebody holds the keyboard to clients that know version 2.1.
    const auto version = xcb_input_xi_query_version(connection->get(), 2, 2);
    const XcbOwned<xcb_input_xi_query_version_reply_t> reply(
        xcb_input_xi_query_version_reply(connection->get(), version, nullptr));
    if (!reply) return Error{"The X server of display \"" + connection->displayName() + "\" has no XInput 2.1."};
    return std::unique_ptr<WatchdogConnection>(new WatchdogConnection(std::move(connection), input->major_opcode));
}

void WatchdogConnection::listen(bool on) {
    struct {
        xcb_input_event_mask_t header;
        std::uint32_t events;
    } const mask{{XCB_INPUT_DEVICE_ALL, 1}, on ? std::uint32_t{XCB_INPUT_XI_EVENT_MASK_RAW_KEY_PRESS} : 0U};
    xcb_input_xi_select_events(connection_->get(), connection_->root(), 1, &mask.header);
    connection_->sync();
}

bool WatchdogConnection::takeKey() {
    bool heard = false;
    while (const auto event = connection_->pollEvent()) {
        const auto& generic = reinterpret_cast<const xcb_ge_generic_event_t&>(*event);
        heard = heard || ((generic.response_type & 0x7F) == XCB_GE_GENERIC && generic.extension == inputOpcode_ &&
                          generic.event_type == XCB_INPUT_RAW_KEY_PRESS);
    }
    return heard;
}

void WatchdogConnection::freeKeyboard(xcb_window_t window) {
    xcb_kill_client(connection_->get(), window);
    for (const InputDevice& device : inputDevices(*connection_)) {
        if (device.isTestKeyboard()) releaseKeysOf(device.id);
    }
    connection_->sync();
}

void WatchdogConnection::releaseKeysOf(std::uint16_t device) {
    const KeycodeSet down = keysDownOn(*connection_, device);
    for (unsigned key = 0; key < down.size(); ++key) {
        if (!down[key]) continue;
        xcb_test_fake_input(connection_->get(), XCB_KEY_RELEASE, static_cast<std::uint8_t>(key), XCB_CURRENT_TIME,
                            connection_->root(), 0, 0, 0);
    }
}

}  // namespace plume
