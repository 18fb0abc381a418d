#include "ports/x11/keyboard/X11MouseTap.h"

#include <xcb/xinput.h>

#include <utility>

#include "ports/x11/keyboard/InputDevices.h"

namespace plume {

namespace {

// Turning the wheel arrives as presses of these.
constexpr std::uint32_t FirstWheelButton = 4;
constexpr std::uint32_t LastWheelButton = 7;

}  // namespace

X11MouseTap::~X11MouseTap() {
    if (inputOpcode_ != 0) select(0);
}

Result<void> X11MouseTap::create(Listener listener) {
    if (auto heard = hear(); !heard) return heard;
    // Clicks of before may still be waiting to be handled.
    listeningSince_ = xcb_no_operation(session_.get()).sequence;
    session_.connection().sync();
    listener_ = std::move(listener);
    return {};
}

Result<void> X11MouseTap::setClicked(std::function<void()> clicked) {
    clicked_ = std::move(clicked);
    return hear();
}

Result<void> X11MouseTap::hear() {
    if (inputOpcode_ != 0) return {};
    const auto* const input = session_.connection().extension(xcb_input_id);
    if (!input) {
        return Error{"The X server of display \"" + session_.connection().displayName() +
                     "\" lacks the XInput extension, by which Plume hears clicks: switch it on."};
    }
    inputOpcode_ = input->major_opcode;
    // Raw events are told whoever has grabbed the pointer to clients that know version 2.1.
    const auto cookie = xcb_input_xi_query_version(session_.get(), 2, 2);
    const XcbOwned<xcb_input_xi_query_version_reply_t> version(
        xcb_input_xi_query_version_reply(session_.get(), cookie, nullptr));
    handler_ = session_.addHandler(XCB_GE_GENERIC, [this](const xcb_generic_event_t& event) { handleEvent(event); });
    select(XCB_INPUT_XI_EVENT_MASK_RAW_BUTTON_PRESS);
    // From the return of this on, every click is heard.
    session_.connection().sync();
    return {};
}

void X11MouseTap::remove() {
    listener_ = nullptr;
    if (clicked_ || inputOpcode_ == 0) return;
    select(0);
    handler_.end();
    inputOpcode_ = 0;
}

void X11MouseTap::select(std::uint32_t events) const {
    selectDeviceEvents(session_.connection(), XCB_INPUT_DEVICE_ALL_MASTER, events);
    session_.connection().flush();
}

void X11MouseTap::handleEvent(const xcb_generic_event_t& event) {
    const auto& press = reinterpret_cast<const xcb_input_raw_button_press_event_t&>(event);
    if (press.extension != inputOpcode_ || press.event_type != XCB_INPUT_RAW_BUTTON_PRESS) return;
    // The middle one pastes, those at the side turn pages.
    if (press.detail >= FirstWheelButton && press.detail <= LastWheelButton) return;
    if (clicked_) clicked_();
    if (!exists() || static_cast<std::int32_t>(event.full_sequence - listeningSince_) < 0) return;
    const auto cookie = xcb_query_pointer(session_.get(), session_.connection().root());
    const XcbOwned<xcb_query_pointer_reply_t> pointer(xcb_query_pointer_reply(session_.get(), cookie, nullptr));
    if (!pointer) return;
    // Called by a copy: the listener may remove the tap.
    const Listener listener = listener_;
    listener({static_cast<double>(pointer->root_x), static_cast<double>(pointer->root_y)});
}

}  // namespace plume
