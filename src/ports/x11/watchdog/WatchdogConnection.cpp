#include "ports/x11/watchdog/WatchdogConnection.h"

#include <xcb/xinput.h>
#include <xcb/xtest.h>

#include <algorithm>
#include <utility>

namespace plume {

namespace {

constexpr std::uint32_t KeyEvents = XCB_INPUT_XI_EVENT_MASK_RAW_KEY_PRESS | XCB_INPUT_XI_EVENT_MASK_RAW_KEY_RELEASE;
// More is not typed before Plume is given up. A key that is older, in seconds, was not held by the tap.
constexpr std::size_t MostKeys = 512;
constexpr double LongestMemory = 4;

// A keyboard that people type on, whoever has it.
bool isHardware(const InputDevice& device) {
    const bool slave =
        device.type == XCB_INPUT_DEVICE_TYPE_SLAVE_KEYBOARD || device.type == XCB_INPUT_DEVICE_TYPE_FLOATING_SLAVE;
    return slave && device.keySource != 0 && !device.isTestKeyboard();
}

}  // namespace

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
    listening_ = on;
    keys_.clear();
    selectDeviceEvents(*connection_, XCB_INPUT_DEVICE_ALL, on ? std::uint32_t{XCB_INPUT_XI_EVENT_MASK_HIERARCHY} : 0U);
    selectKeys(on ? KeyEvents : 0U);
    connection_->sync();
}

// Each keyboard by itself: what the tap presses is not to be told.
void WatchdogConnection::selectKeys(std::uint32_t events) {
    for (const InputDevice& device : inputDevices(*connection_)) {
        if (isHardware(device)) selectDeviceEvents(*connection_, device.id, events);
    }
}

bool WatchdogConnection::takeKeys(const TapProgress& progress, double now) {
    bool wentDown = false;
    while (const auto event = connection_->pollEvent()) {
        const auto& raw = reinterpret_cast<const xcb_input_raw_key_press_event_t&>(*event);
        if ((raw.response_type & 0x7F) != XCB_GE_GENERIC || raw.extension != inputOpcode_ || !listening_) continue;
        if (raw.event_type == XCB_INPUT_HIERARCHY) {
            selectKeys(KeyEvents);
            connection_->flush();
            continue;
        }
        const bool down = raw.event_type == XCB_INPUT_RAW_KEY_PRESS;
        wentDown = wentDown || down;
        remember({moments_.next(raw.time), now, event->full_sequence, raw.deviceid,
                  static_cast<std::uint8_t>(raw.detail), down});
    }
    while (!keys_.empty() && progress.hasHandled(keys_.front().moment)) keys_.pop_front();
    return wentDown;
}

void WatchdogConnection::remember(const Key& key) {
    while (!keys_.empty() && (keys_.size() >= MostKeys || key.heardAt - keys_.front().heardAt > LongestMemory)) {
        keys_.pop_front();
    }
    keys_.push_back(key);
}

void WatchdogConnection::freeKeyboard(xcb_window_t window, TapProgress& progress, double now) {
    const std::vector<std::uint16_t> devices = heldKeyboards();
    progress.takeOver();
    const unsigned freed = xcb_kill_client(connection_->get(), window).sequence;
    connection_->sync();
    passOn(devices, freed, progress, now);
    for (const InputDevice& device : inputDevices(*connection_)) {
        if (device.isTestKeyboard()) releaseKeysOf(device.id);
    }
    connection_->sync();
}

// What came after the tap's connection was ended went to the programs by itself, and so did the keys of keyboards that
// the tap did not have, or still have another owner.
void WatchdogConnection::passOn(const std::vector<std::uint16_t>& devices, unsigned freed, const TapProgress& progress,
                                double now) {
    takeKeys(progress, now);
    const std::vector<std::uint16_t> stillHeld = heldKeyboards();
    for (const Key& key : keys_) {
        const bool wasHeld = std::ranges::find(devices, key.device) != devices.end() &&
                             std::ranges::find(stillHeld, key.device) == stillHeld.end();
        const bool before = static_cast<std::int32_t>(key.sequence - freed) < 0;
        if (!wasHeld || !before || now - key.heardAt > LongestMemory) continue;
        xcb_test_fake_input(connection_->get(), key.down ? XCB_KEY_PRESS : XCB_KEY_RELEASE, key.keycode,
                            XCB_CURRENT_TIME, connection_->root(), 0, 0, 0);
    }
    keys_.clear();
}

// A keyboard that somebody has taken hangs on no master.
std::vector<std::uint16_t> WatchdogConnection::heldKeyboards() const {
    std::vector<std::uint16_t> held;
    for (const InputDevice& device : inputDevices(*connection_)) {
        if (device.type == XCB_INPUT_DEVICE_TYPE_FLOATING_SLAVE) held.push_back(device.id);
    }
    return held;
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
