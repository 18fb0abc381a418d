#include "testing/real/CopyWatch.h"

#include <xcb/xfixes.h>

#include "testing/rig/Deadline.h"
#include "testing/rig/XcbReply.h"

namespace plume::real {

CopyWatch::CopyWatch(const std::string& display) : client_(display) {
    auto* connection = client_.connection();
    const auto* extension = xcb_get_extension_data(connection, &xcb_xfixes_id);
    if (extension == nullptr || extension->present == 0) throw rig::RigError("the X server has no XFIXES");
    firstEvent_ = extension->first_event;
    rig::own(xcb_xfixes_query_version_reply(connection, xcb_xfixes_query_version(connection, 5, 0), nullptr));
    xcb_xfixes_select_selection_input(connection, client_.root(), client_.atom("CLIPBOARD"),
                                      XCB_XFIXES_SELECTION_EVENT_MASK_SET_SELECTION_OWNER);
    forget();
}

void CopyWatch::forget() {
    client_.focusedWindow();  // a round trip: all that has happened is here
    while (rig::own(xcb_poll_for_event(client_.connection()))) {
    }
}

bool CopyWatch::awaitOwner(rig::Milliseconds bound, const std::function<bool(xcb_window_t)>& isAccepted) {
    const rig::Deadline deadline(bound);
    while (!deadline.passed()) {
        const auto event = rig::own(xcb_poll_for_event(client_.connection()));
        if (!event) {
            deadline.waitReadable(xcb_get_file_descriptor(client_.connection()));
            continue;
        }
        if ((event->response_type & 0x7F) != firstEvent_ + XCB_XFIXES_SELECTION_NOTIFY) continue;
        if (isAccepted(reinterpret_cast<const xcb_xfixes_selection_notify_event_t&>(*event).owner)) return true;
    }
    return false;
}

}  // namespace plume::real
