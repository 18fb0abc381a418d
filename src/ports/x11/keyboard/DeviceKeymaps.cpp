#include "ports/x11/keyboard/DeviceKeymaps.h"

#include <utility>
#include <vector>

#include "ports/x11/keyboard/InputDevices.h"
#include "ports/x11/keyboard/KeymapCopy.h"
#include "ports/x11/keyboard/XcbXkb.h"

namespace plume {

DeviceKeymaps::DeviceKeymaps(const TapConnection& connection, XkbKeyboard& keyboard)
    : connection_(connection), keyboard_(keyboard), current_(keyboard.keymap()), core_(current_->fingerprint()) {
    auto& server = connection_.connection();
    xcb_discard_reply(server.get(), xcb_xkb_use_extension(server.get(), 1, 0).sequence);
    if (const auto* const xkb = server.extension(xcb_xkb_id)) firstEvent_ = xkb->first_event;
}

void DeviceKeymaps::add(std::uint16_t device) {
    if (keymaps_.contains(device)) return;
    // First: what changes from now on is heard.
    listen(device);
    if (auto keymap = keyboard_.keymapOf(device)) keymaps_[device] = {std::move(keymap)};
}

void DeviceKeymaps::remove(std::uint16_t device) {
    keymaps_.erase(device);
}

void DeviceKeymaps::listen(std::uint16_t device) const {
    constexpr std::uint16_t Events = XCB_XKB_EVENT_TYPE_NEW_KEYBOARD_NOTIFY | XCB_XKB_EVENT_TYPE_MAP_NOTIFY;
    constexpr std::uint16_t Parts =
        XCB_XKB_MAP_PART_KEY_TYPES | XCB_XKB_MAP_PART_KEY_SYMS | XCB_XKB_MAP_PART_MODIFIER_MAP;
    xcb_xkb_select_events_details_t details{};
    details.affectNewKeyboard = XCB_XKB_NKN_DETAIL_KEYCODES;
    details.newKeyboardDetails = details.affectNewKeyboard;
    xcb_xkb_select_events_aux(connection_.connection().get(), device, Events, 0, 0, Parts, Parts, &details);
}

void DeviceKeymaps::hear(const xcb_generic_event_t& event) {
    if (firstEvent_ == 0 || (event.response_type & 0x7F) != firstEvent_) return;
    // Which device it is about is in the same place in all of them.
    const auto known = keymaps_.find(reinterpret_cast<const xcb_xkb_map_notify_event_t&>(event).deviceID);
    if (known == keymaps_.end()) return;
    known->second.changed = true;
    changed_ = true;
}

bool DeviceKeymaps::use(std::uint16_t device) {
    for (auto& [id, entry] : keymaps_) {
        if (!std::exchange(entry.changed, false)) continue;
        if (auto keymap = keyboard_.keymapOf(id)) entry.keymap = std::move(keymap);
    }
    changed_ = false;
    used_ = device;
    const auto known = keymaps_.find(device);
    const bool isGiven = known != keymaps_.end() && known->second.keymap->fingerprint() == current_->fingerprint();
    return isGiven || give(device);
}

bool DeviceKeymaps::give(std::uint16_t device) {
    std::vector<std::uint16_t> to{connection_.testKeyboard()};
    // The core keyboard takes over the layout of the XTEST keyboard by itself when another one was used before.
    for (const InputDevice& each : inputDevices(connection_.connection())) {
        if (each.id == connection_.masterKeyboard() && each.keySource == connection_.testKeyboard())
            to.push_back(each.id);
    }
    giving_ = true;
    const bool given = copyKeymap(connection_.connection().displayName(), device, to);
    keyboard_.readAgain();
    giving_ = false;
    core_ = keyboard_.keymap()->fingerprint();
    const auto known = keymaps_.find(device);
    current_ = known != keymaps_.end() ? known->second.keymap : keyboard_.keymapOf(device);
    if (!current_) current_ = keyboard_.keymap();
    return given;
}

void DeviceKeymaps::coreChanged() {
    const std::uint64_t before = std::exchange(core_, keyboard_.keymap()->fingerprint());
    // By give(), or by the server when a key of the XTEST keyboard was pressed after it.
    if (giving_ || core_ == before || core_ == current_->fingerprint()) return;
    current_ = keyboard_.keymap();
    std::vector<std::uint16_t> devices;
    for (auto& [device, entry] : keymaps_) {
        devices.push_back(device);
        entry.keymap = current_;
    }
    // The server gave it to every keyboard but those that are grabbed.
    copyKeymap(connection_.connection().displayName(), connection_.testKeyboard(), devices);
}

}  // namespace plume
