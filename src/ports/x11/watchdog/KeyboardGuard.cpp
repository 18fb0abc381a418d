#include "ports/x11/watchdog/KeyboardGuard.h"

#include <xcb/xinput.h>
#include <xcb/xtest.h>

#include <string_view>
#include <utility>

namespace plume {

Result<std::unique_ptr<KeyboardGuard>> KeyboardGuard::open(const std::string& display) {
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
    return std::unique_ptr<KeyboardGuard>(new KeyboardGuard(std::move(connection), input->major_opcode));
}

void KeyboardGuard::listen(bool on) {
    struct {
        xcb_input_event_mask_t header;
        std::uint32_t events;
    } const mask{{XCB_INPUT_DEVICE_ALL, 1}, on ? std::uint32_t{XCB_INPUT_XI_EVENT_MASK_RAW_KEY_PRESS} : 0U};
    xcb_input_xi_select_events(connection_->get(), connection_->root(), 1, &mask.header);
    connection_->sync();
}

bool KeyboardGuard::takeKey() {
    bool heard = false;
    while (const auto event = connection_->pollEvent()) {
        const auto& generic = reinterpret_cast<const xcb_ge_generic_event_t&>(*event);
        heard = heard || ((generic.response_type & 0x7F) == XCB_GE_GENERIC && generic.extension == inputOpcode_ &&
                          generic.event_type == XCB_INPUT_RAW_KEY_PRESS);
    }
    return heard;
}

void KeyboardGuard::freeKeyboard(xcb_window_t window) {
    auto* const connection = connection_->get();
    xcb_kill_client(connection, window);
    const XcbOwned<xcb_input_xi_query_device_reply_t> reply(xcb_input_xi_query_device_reply(
        connection, xcb_input_xi_query_device(connection, XCB_INPUT_DEVICE_ALL), nullptr));
    if (!reply) return;
    for (auto info = xcb_input_xi_query_device_infos_iterator(reply.get()); info.rem > 0;
         xcb_input_xi_device_info_next(&info)) {
        const std::string_view name(xcb_input_xi_device_info_name(info.data), info.data->name_len);
        if (info.data->type == XCB_INPUT_DEVICE_TYPE_SLAVE_KEYBOARD && name.find("XTEST") != std::string_view::npos) {
            releaseKeysOf(info.data->deviceid);
        }
    }
    connection_->sync();
}

void KeyboardGuard::releaseKeysOf(std::uint16_t device) {
    auto* const connection = connection_->get();
    const auto cookie = xcb_input_query_device_state(connection, static_cast<std::uint8_t>(device));
    const XcbOwned<xcb_input_query_device_state_reply_t> reply(
        xcb_input_query_device_state_reply(connection, cookie, nullptr));
    if (!reply) return;
    for (auto state = xcb_input_query_device_state_classes_iterator(reply.get()); state.rem > 0;
         xcb_input_input_state_next(&state)) {
        if (state.data->class_id != XCB_INPUT_INPUT_CLASS_KEY) continue;
        const auto& keys = reinterpret_cast<const xcb_input_key_state_t&>(*state.data).keys;
        for (unsigned key = 0; key < 8 * sizeof keys; ++key) {
            if (((keys[key / 8] >> (key % 8)) & 1) == 0) continue;
            xcb_test_fake_input(connection, XCB_KEY_RELEASE, static_cast<std::uint8_t>(key), XCB_CURRENT_TIME,
                                connection_->root(), 0, 0, 0);
        }
    }
}

}  // namespace plume
