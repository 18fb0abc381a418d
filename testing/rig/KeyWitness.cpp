#include "testing/rig/KeyWitness.h"

#include <xcb/xinput.h>

#include "testing/rig/Deadline.h"
#include "testing/rig/XcbReply.h"

namespace plume::rig {

KeyWitness::KeyWitness(const std::string& display) : client_(display) {
    auto* const connection = client_.connection();
    const auto* const extension = xcb_get_extension_data(connection, &xcb_input_id);
    if (extension == nullptr || extension->present == 0) throw RigError("the X server has no input extension");
    extensionOpcode_ = extension->major_opcode;
    own(xcb_input_xi_query_version_reply(connection, xcb_input_xi_query_version(connection, 2, 2), nullptr));

    struct {
        xcb_input_event_mask_t header{XCB_INPUT_DEVICE_ALL_MASTER, 1};
        std::uint32_t events = XCB_INPUT_XI_EVENT_MASK_RAW_KEY_PRESS;
    } selection;
    xcb_input_xi_select_events(connection, client_.root(), 1, &selection.header);
    client_.focusedWindow();  // a round trip: the server has taken the selection
}

void KeyWitness::awaitPress(int keycode, Milliseconds bound) {
    const Deadline deadline(bound);
    while (!takePress(keycode)) {
        if (deadline.passed()) throw RigError("no program got key " + std::to_string(keycode) + " in time");
        deadline.waitReadable(xcb_get_file_descriptor(client_.connection()));
    }
}

bool KeyWitness::takePress(int keycode) {
    while (const auto event = own(xcb_poll_for_event(client_.connection()))) {
        if ((event->response_type & 0x7F) != XCB_GE_GENERIC) continue;
        const auto* const key = reinterpret_cast<const xcb_input_raw_key_press_event_t*>(event.get());
        if (key->extension == extensionOpcode_ && key->event_type == XCB_INPUT_RAW_KEY_PRESS &&
            key->detail == static_cast<std::uint32_t>(keycode)) {
            return true;
        }
    }
    return false;
}

}  // namespace plume::rig
