#include "testing/rig/FocusCounter.h"

#include <poll.h>

#include <xcb/xinput.h>

#include <utility>

#include "testing/rig/Deadline.h"
#include "testing/rig/XcbReply.h"

namespace plume::rig {

namespace {

void count(FocusCounter::Counts& counts, bool in, std::uint8_t mode) {
    ++(in ? counts.in : counts.out);
    if (mode != XCB_NOTIFY_MODE_NORMAL) ++counts.byGrab;
}

}  // namespace

FocusCounter::FocusCounter(const std::string& display, xcb_window_t window) : client_(display) {
    auto* connection = client_.connection();
    const auto* extension = xcb_get_extension_data(connection, &xcb_input_id);
    if (extension == nullptr || extension->present == 0) throw RigError("the X server has no input extension");
    extensionOpcode_ = extension->major_opcode;
    own(xcb_input_xi_query_version_reply(connection, xcb_input_xi_query_version(connection, 2, 2), nullptr));

    struct {
        xcb_input_event_mask_t header{XCB_INPUT_DEVICE_ALL_MASTER, 1};
        std::uint32_t events = XCB_INPUT_XI_EVENT_MASK_FOCUS_IN | XCB_INPUT_XI_EVENT_MASK_FOCUS_OUT;
    } selection;
    const std::uint32_t coreEvents = XCB_EVENT_MASK_FOCUS_CHANGE;
    for (const auto part : client_.treeOf(window)) {
        xcb_change_window_attributes(connection, part, XCB_CW_EVENT_MASK, &coreEvents);
        xcb_input_xi_select_events(connection, part, 1, &selection.header);
    }
    awaitQuiet();
}

// The window manager may still be busy with windows that came or went before, and move the focus for them.
void FocusCounter::awaitQuiet() {
    const Deadline deadline(Milliseconds(5'000));
    do {
        core_ = {};
        inputExtension_ = {};
        poll(nullptr, 0, 100);
        drain();
    } while ((core_ != Counts{} || inputExtension_ != Counts{}) && !deadline.passed());
}

FocusCounter::Counts FocusCounter::takeCore() {
    drain();
    return std::exchange(core_, {});
}

FocusCounter::Counts FocusCounter::takeInputExtension() {
    drain();
    return std::exchange(inputExtension_, {});
}

void FocusCounter::drain() {
    client_.focusedWindow();  // a round trip: everything sent before it has arrived
    while (const auto event = own(xcb_poll_for_event(client_.connection()))) {
        const std::uint8_t type = event->response_type & 0x7F;
        if (type == XCB_FOCUS_IN || type == XCB_FOCUS_OUT) {
            count(core_, type == XCB_FOCUS_IN, reinterpret_cast<const xcb_focus_in_event_t*>(event.get())->mode);
        } else if (type == XCB_GE_GENERIC) {
            const auto* focus = reinterpret_cast<const xcb_input_focus_in_event_t*>(event.get());
            const bool in = focus->event_type == XCB_INPUT_FOCUS_IN;
            if (focus->extension != extensionOpcode_ || (!in && focus->event_type != XCB_INPUT_FOCUS_OUT)) continue;
            count(inputExtension_, in, focus->mode);
        }
    }
}

}  // namespace plume::rig
