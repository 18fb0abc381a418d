#include "ports/x11/keyboard/XkbKeyboard.h"

#include <xkbcommon/xkbcommon-x11.h>

#include <algorithm>
#include <string_view>
#include <utility>

#include "ports/x11/keyboard/XcbXkb.h"

namespace plume {

namespace {

constexpr std::uint16_t WatchedMapParts = XCB_XKB_MAP_PART_KEY_TYPES | XCB_XKB_MAP_PART_KEY_SYMS |
                                          XCB_XKB_MAP_PART_MODIFIER_MAP | XCB_XKB_MAP_PART_KEY_ACTIONS |
                                          XCB_XKB_MAP_PART_VIRTUAL_MODS | XCB_XKB_MAP_PART_VIRTUAL_MOD_MAP;
constexpr std::uint16_t WatchedStateParts = XCB_XKB_STATE_PART_MODIFIER_LATCH | XCB_XKB_STATE_PART_MODIFIER_LOCK |
                                            XCB_XKB_STATE_PART_GROUP_STATE | XCB_XKB_STATE_PART_GROUP_LATCH |
                                            XCB_XKB_STATE_PART_GROUP_LOCK;
constexpr auto RulesProperty = "_XKB_RULES_NAMES";
// The server's event of a change that was announced is among the next few events, or does not come.
constexpr std::size_t MostExpected = 8;

// The piece with this number of a list, empty beyond its end.
std::string_view piece(std::string_view list, char separator, std::size_t number) {
    for (; number > 0; --number) {
        const auto end = list.find(separator);
        if (end == std::string_view::npos) return {};
        list.remove_prefix(end + 1);
    }
    return list.substr(0, list.find(separator));
}

bool happenedBefore(const xcb_generic_event_t& event, unsigned sequence) {
    return static_cast<std::int32_t>(event.full_sequence - sequence) < 0;
}

}  // namespace

Result<std::unique_ptr<XkbKeyboard>> XkbKeyboard::open(XcbConnection& connection) {
    std::unique_ptr<XkbKeyboard> keyboard(new XkbKeyboard(connection));
    if (keyboard->begin()) return keyboard;
    return Error{"The keyboard layout of the X display \"" + connection.displayName() +
                 "\" cannot be read: Plume needs an X server with the XKB extension."};
}

bool XkbKeyboard::begin() {
    constexpr auto Flags = XKB_X11_SETUP_XKB_EXTENSION_NO_FLAGS;
    if (xkb_x11_setup_xkb_extension(connection_.get(), XKB_X11_MIN_MAJOR_XKB_VERSION, XKB_X11_MIN_MINOR_XKB_VERSION,
                                    Flags, nullptr, nullptr, &firstEvent_, nullptr) == 0) {
        return false;
    }
    device_ = xkb_x11_get_core_keyboard_device_id(connection_.get());
    context_.reset(xkb_context_new(XKB_CONTEXT_NO_FLAGS));
    if (device_ < 0 || !context_) return false;
    selectEvents();
    keymap_ = keymapOf(device_);
    if (!keymap_) return false;
    readState();
    readLayoutName();
    return true;
}

void XkbKeyboard::selectEvents() const {
    constexpr std::uint16_t Events =
        XCB_XKB_EVENT_TYPE_NEW_KEYBOARD_NOTIFY | XCB_XKB_EVENT_TYPE_MAP_NOTIFY | XCB_XKB_EVENT_TYPE_STATE_NOTIFY;
    xcb_xkb_select_events_details_t details{};
    details.affectNewKeyboard =
        XCB_XKB_NKN_DETAIL_KEYCODES | XCB_XKB_NKN_DETAIL_GEOMETRY | XCB_XKB_NKN_DETAIL_DEVICE_ID;
    details.newKeyboardDetails = details.affectNewKeyboard;
    details.affectState = WatchedStateParts;
    details.stateDetails = WatchedStateParts;
    xcb_xkb_select_events_aux(connection_.get(), static_cast<std::uint16_t>(device_), Events, 0, 0, WatchedMapParts,
                              WatchedMapParts, &details);
}

KeycodeSet XkbKeyboard::foreignKeycodes(xkb_keymap* keymap) const {
    KeycodeSet foreign;
    for (unsigned i = 0; i < ownSymbols_.size(); ++i) {
        const xkb_keysym_t* symbols = nullptr;
        if (ownSymbols_[i] == XKB_KEY_NoSymbol) continue;
        const int count = xkb_keymap_key_get_syms_by_level(keymap, i, 0, 0, &symbols);
        foreign[i] = count == 1 && symbols[0] == ownSymbols_[i];
    }
    return foreign;
}

std::shared_ptr<const XkbKeymap> XkbKeyboard::keymapOf(std::int32_t device) const {
    XkbOwned<xkb_keymap> keymap(
        xkb_x11_keymap_new_from_device(context_.get(), connection_.get(), device, XKB_KEYMAP_COMPILE_NO_FLAGS));
    if (!keymap) return nullptr;
    const KeycodeSet foreign = foreignKeycodes(keymap.get());
    return std::make_shared<const XkbKeymap>(std::move(keymap), foreign);
}

void XkbKeyboard::readState() {
    const auto cookie = xcb_xkb_get_state(connection_.get(), static_cast<std::uint16_t>(device_));
    const XcbOwned<xcb_xkb_get_state_reply_t> state(xcb_xkb_get_state_reply(connection_.get(), cookie, nullptr));
    if (!state) return;
    group_ = state->group;
    locks_ = {state->latchedMods, state->lockedMods, state->latchedGroup, state->lockedGroup};
}

void XkbKeyboard::readLayoutName() {
    constexpr std::uint32_t Longest = 1024;  // in words
    const auto cookie = xcb_get_property(connection_.get(), 0, connection_.root(), connection_.atom(RulesProperty),
                                         XCB_ATOM_STRING, 0, Longest);
    const XcbOwned<xcb_get_property_reply_t> reply(xcb_get_property_reply(connection_.get(), cookie, nullptr));
    std::string_view names;
    if (reply) {
        names = {static_cast<const char*>(xcb_get_property_value(reply.get())),
                 static_cast<std::size_t>(xcb_get_property_value_length(reply.get()))};
    }
    constexpr std::size_t Layouts = 2;  // after the rules and the model
    layoutName_ = piece(piece(names, '\0', Layouts), ',', group_);
    const auto variant = piece(piece(names, '\0', Layouts + 1), ',', group_);
    if (!layoutName_.empty() && !variant.empty()) layoutName_ += '(' + std::string(variant) + ')';
    if (!layoutName_.empty()) return;
    const char* const name = xkb_keymap_layout_get_name(keymap_->get(), group_);
    layoutName_ = name ? name : "";
}

void XkbKeyboard::listenTo(X11Session& session) {
    rootEvents_ = session.listen(connection_.root(), XCB_EVENT_MASK_PROPERTY_CHANGE);
    for (const std::uint8_t type : {firstEvent_, std::uint8_t{XCB_PROPERTY_NOTIFY}}) {
        handlers_.push_back(session.addHandler(type, [this](const xcb_generic_event_t& event) { handleEvent(event); }));
    }
}

void XkbKeyboard::handleEvent(const xcb_generic_event_t& event) {
    const auto type = static_cast<std::uint8_t>(event.response_type & 0x7F);
    if (type == XCB_PROPERTY_NOTIFY) {
        const auto& property = reinterpret_cast<const xcb_property_notify_event_t&>(event);
        if (property.window != connection_.root() || property.atom != connection_.atom(RulesProperty)) return;
        const std::string before = std::exchange(layoutName_, {});
        readLayoutName();
        if (layoutName_ != before) changedEvent.raise(Change::Group);
        return;
    }
    // Which device it is about is in the same place in all of them.
    if (reinterpret_cast<const xcb_xkb_map_notify_event_t&>(event).deviceID != device_) return;
    switch (event.pad0) {  // which of the extension's events it is
        case XCB_XKB_STATE_NOTIFY:
            stateChanged(event);
            break;
        case XCB_XKB_MAP_NOTIFY: {
            const auto& change = reinterpret_cast<const xcb_xkb_map_notify_event_t&>(event);
            const bool own = isOwnChange(change.firstKeySym, change.nKeySyms);
            if (!own && !happenedBefore(event, lastRead_)) readAgain();
            break;
        }
        default:
            if (!happenedBefore(event, lastRead_)) readAgain();
    }
}

void XkbKeyboard::readAgain() {
    // One change is told several times; all that came before this reading is in it.
    lastRead_ = xcb_no_operation(connection_.get()).sequence;
    auto keymap = keymapOf(device_);
    if (!keymap || keymap->fingerprint() == keymap_->fingerprint()) return;
    keymap_ = std::move(keymap);
    readState();
    readLayoutName();
    changedEvent.raise(Change::Keymap);
}

void XkbKeyboard::stateChanged(const xcb_generic_event_t& event) {
    const auto& state = reinterpret_cast<const xcb_xkb_state_notify_event_t&>(event);
    const XkbLocks locks{state.latchedMods, state.lockedMods, state.latchedGroup, state.lockedGroup};
    const bool locked = locks != locks_;
    const bool switched = state.group != group_;
    locks_ = locks;
    group_ = state.group;
    if (switched) {
        readLayoutName();
        changedEvent.raise(Change::Group);
    }
    if (locked && state.keycode == 0) changedEvent.raise(Change::Locks);
}

void XkbKeyboard::willWrite(xcb_keycode_t first, std::span<const xkb_keysym_t> symbols) {
    for (std::size_t i = 0; i < symbols.size() && first + i < ownSymbols_.size(); ++i) {
        if (symbols[i] != XKB_KEY_NoSymbol) ownSymbols_[first + i] = symbols[i];
    }
    expected_.push_back({first, symbols.size()});
    if (expected_.size() > MostExpected) expected_.pop_front();
}

bool XkbKeyboard::isOwnChange(xcb_keycode_t first, std::uint8_t count) {
    const auto own = std::ranges::find_if(
        expected_, [&](const Written& written) { return written.first == first && written.count == count; });
    if (own == expected_.end()) return false;
    expected_.erase(expected_.begin(), own + 1);
    return true;
}

}  // namespace plume
