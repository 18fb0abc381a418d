#include "ports/x11/keyboard/InputDevices.h"

namespace plume {

namespace {

std::uint16_t keySourceOf(const xcb_input_xi_device_info_t* info) {
    for (auto each = xcb_input_xi_device_info_classes_iterator(info); each.rem > 0;
         xcb_input_device_class_next(&each)) {
        if (each.data->type == XCB_INPUT_DEVICE_CLASS_TYPE_KEY) return each.data->sourceid;
    }
    return 0;
}

}  // namespace

bool InputDevice::isTestKeyboard() const {
    return type == XCB_INPUT_DEVICE_TYPE_SLAVE_KEYBOARD && name.find("XTEST") != std::string::npos;
}

std::vector<InputDevice> inputDevices(const XcbConnection& connection) {
    std::vector<InputDevice> devices;
    const auto cookie = xcb_input_xi_query_device(connection.get(), XCB_INPUT_DEVICE_ALL);
    const XcbOwned<xcb_input_xi_query_device_reply_t> reply(
        xcb_input_xi_query_device_reply(connection.get(), cookie, nullptr));
    if (!reply) return devices;
    for (auto each = xcb_input_xi_query_device_infos_iterator(reply.get()); each.rem > 0;
         xcb_input_xi_device_info_next(&each)) {
        const auto* const info = each.data;
        devices.push_back({info->deviceid, info->type, info->attachment, keySourceOf(info), info->enabled != 0,
                           std::string(xcb_input_xi_device_info_name(info), info->name_len)});
    }
    return devices;
}

void selectDeviceEvents(const XcbConnection& connection, std::uint16_t device, std::uint32_t events) {
    struct {
        xcb_input_event_mask_t header;
        std::uint32_t events;
    } const mask{{device, 1}, events};
    xcb_input_xi_select_events(connection.get(), connection.root(), 1, &mask.header);
}

KeycodeSet keysDownOn(const XcbConnection& connection, std::uint16_t device) {
    KeycodeSet down;
    const auto cookie = xcb_input_query_device_state(connection.get(), static_cast<std::uint8_t>(device));
    const XcbOwned<xcb_input_query_device_state_reply_t> reply(
        xcb_input_query_device_state_reply(connection.get(), cookie, nullptr));
    if (!reply) return down;
    for (auto each = xcb_input_query_device_state_classes_iterator(reply.get()); each.rem > 0;
         xcb_input_input_state_next(&each)) {
        if (each.data->class_id != XCB_INPUT_INPUT_CLASS_KEY) continue;
        const auto& keys = reinterpret_cast<const xcb_input_key_state_t&>(*each.data).keys;
        for (unsigned key = 0; key < 8 * sizeof keys; ++key) down[key] = ((keys[key / 8] >> (key % 8)) & 1) != 0;
    }
    return down;
}

}  // namespace plume
