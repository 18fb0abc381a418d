#include "ports/x11/keyboard/X11SystemHotKeys.h"

#include <xkbcommon/xkbcommon-keysyms.h>

#include <algorithm>
#include <string>
#include <utility>

#include "ports/x11/keyboard/XcbXkb.h"

namespace plume {

namespace {

constexpr xcb_keysym_t LockSymbols[] = {XKB_KEY_Num_Lock, XKB_KEY_Scroll_Lock};
constexpr std::uint16_t MatteringModifiers =
    XCB_MOD_MASK_SHIFT | XCB_MOD_MASK_CONTROL | XCB_MOD_MASK_1 | XCB_MOD_MASK_4;

// Shift, Control, Option, Command by their bits.
constexpr std::uint16_t XModifiers[] = {XCB_MOD_MASK_SHIFT, XCB_MOD_MASK_CONTROL, XCB_MOD_MASK_1, XCB_MOD_MASK_4};

std::uint16_t xModifiersOf(KeyModifiers modifiers) {
    std::uint16_t mask = 0;
    for (std::size_t bit = 0; bit < std::size(XModifiers); ++bit) {
        if ((modifiers.bits() >> bit & 1) != 0) mask = static_cast<std::uint16_t>(mask | XModifiers[bit]);
    }
    return mask;
}

std::vector<xcb_keycode_t> keyCodesOf(xcb_connection_t* server, xcb_keysym_t wanted) {
    const auto* const setup = xcb_get_setup(server);
    const auto count = static_cast<std::uint8_t>(setup->max_keycode - setup->min_keycode + 1);
    const XcbOwned<xcb_get_keyboard_mapping_reply_t> reply(
        xcb_get_keyboard_mapping_reply(server, xcb_get_keyboard_mapping(server, setup->min_keycode, count), nullptr));
    std::vector<xcb_keycode_t> keyCodes;
    if (!reply) return keyCodes;
    const auto* const symbols = xcb_get_keyboard_mapping_keysyms(reply.get());
    for (int i = 0; i < count * reply->keysyms_per_keycode; ++i) {
        if (symbols[i] != wanted) continue;
        keyCodes.push_back(static_cast<xcb_keycode_t>(setup->min_keycode + i / reply->keysyms_per_keycode));
    }
    return keyCodes;
}

// The modifiers that this lock key sets: the server has no fixed ones.
std::uint16_t lockModifiers(xcb_connection_t* server, xcb_keysym_t lock) {
    const auto keyCodes = keyCodesOf(server, lock);
    const XcbOwned<xcb_get_modifier_mapping_reply_t> reply(
        xcb_get_modifier_mapping_reply(server, xcb_get_modifier_mapping(server), nullptr));
    if (!reply) return 0;
    unsigned modifiers = 0;
    const auto* const keys = xcb_get_modifier_mapping_keycodes(reply.get());
    for (int i = 0; i < 8 * reply->keycodes_per_modifier; ++i) {
        const bool isLock = keys[i] != 0 && std::find(keyCodes.begin(), keyCodes.end(), keys[i]) != keyCodes.end();
        if (isLock) modifiers |= 1U << (i / reply->keycodes_per_modifier);
    }
    return static_cast<std::uint16_t>(modifiers & ~unsigned{MatteringModifiers});
}

// Caps Lock, Num Lock and Scroll Lock are modifiers to a grab, but not to the user: every combination of them.
std::vector<std::uint16_t> lockVariants(xcb_connection_t* server) {
    unsigned locks = XCB_MOD_MASK_LOCK;
    for (const xcb_keysym_t symbol : LockSymbols) locks |= lockModifiers(server, symbol);
    std::vector<std::uint16_t> variants;
    for (unsigned variant = 0; variant <= locks; ++variant) {
        if ((variant & ~locks) == 0) variants.push_back(static_cast<std::uint16_t>(variant));
    }
    return variants;
}

}  // namespace

X11SystemHotKeys::X11SystemHotKeys(X11Session& session, XkbKeyboard& keyboard)
    : session_(session), keyboard_(keyboard), lockVariants_(lockVariants(session.get())) {
    pressHandler_ = session_.addHandler(XCB_KEY_PRESS, [this](const xcb_generic_event_t& event) {
        pressed(reinterpret_cast<const xcb_key_press_event_t&>(event));
    });
    releaseHandler_ = session_.addHandler(XCB_KEY_RELEASE, [this](const xcb_generic_event_t& event) {
        const auto& release = reinterpret_cast<const xcb_key_release_event_t&>(event);
        if (release.detail == heldKeyCode_) heldKeyCode_ = 0;
    });
    keyboardChanged_ = keyboard.changedEvent.addObserver(this, &X11SystemHotKeys::keyboardChanged);
    tellRepeatsApart();
}

X11SystemHotKeys::~X11SystemHotKeys() {
    for (const auto& hotKey : hotKeys_) ungrab(hotKey.second);
    session_.flush();
}

// Repeats of a held key come as presses alone then, without a release before each.
void X11SystemHotKeys::tellRepeatsApart() const {
    if (!session_.connection().extension(xcb_xkb_id)) return;
    xcb_connection_t* const server = session_.get();
    const XcbOwned<xcb_xkb_use_extension_reply_t> use(
        xcb_xkb_use_extension_reply(server, xcb_xkb_use_extension(server, 1, 0), nullptr));
    if (!use) return;
    constexpr std::uint32_t Detectable = XCB_XKB_PER_CLIENT_FLAG_DETECTABLE_AUTO_REPEAT;
    const auto cookie = xcb_xkb_per_client_flags(server, XCB_XKB_ID_USE_CORE_KBD, Detectable, Detectable, 0, 0, 0);
    const XcbOwned<xcb_xkb_per_client_flags_reply_t> flags(xcb_xkb_per_client_flags_reply(server, cookie, nullptr));
}

void X11SystemHotKeys::keyboardChanged(const XkbKeyboard::Change& change) {
    if (change != XkbKeyboard::Change::Keymap) return;
    for (const auto& [id, hotKey] : hotKeys_) ungrab(hotKey);
    lockVariants_ = lockVariants(session_.get());
    for (auto& [id, hotKey] : hotKeys_) {
        hotKey.keyCode = keyboard_.keymap()->keycodeOf(hotKey.key);
        if (hotKey.keyCode != 0) grab(hotKey);
    }
    session_.flush();
}

Result<void> X11SystemHotKeys::registerHotKey(Id id, KeyCode keyCode, KeyModifiers modifiers,
                                              std::function<void()> handler) {
    unregisterHotKey(id);
    const xcb_keycode_t xKeyCode = keyboard_.keymap()->keycodeOf(keyCode);
    if (xKeyCode == 0)
        return Error{"The keyboard has no key with code " + std::to_string(numberOf(keyCode)) + " for the hot key."};
    HotKey hotKey{keyCode, xKeyCode, xModifiersOf(modifiers), std::move(handler)};
    if (isRegistered(hotKey)) return Error{"Another hot key of Plume's has this combination already."};
    if (!grab(hotKey)) return Error{"Another program has this combination as its hot key already: choose another."};
    hotKeys_.emplace(id, std::move(hotKey));
    return {};
}

void X11SystemHotKeys::unregisterHotKey(Id id) {
    const auto found = hotKeys_.find(id);
    if (found == hotKeys_.end()) return;
    ungrab(found->second);
    session_.flush();
    hotKeys_.erase(found);
}

bool X11SystemHotKeys::isRegistered(const HotKey& hotKey) const {
    return std::any_of(hotKeys_.begin(), hotKeys_.end(), [&](const auto& other) {
        return other.second.keyCode == hotKey.keyCode && other.second.modifiers == hotKey.modifiers;
    });
}

bool X11SystemHotKeys::grab(const HotKey& hotKey) const {
    std::vector<xcb_void_cookie_t> cookies;
    for (const std::uint16_t locks : lockVariants_) {
        const auto mask = static_cast<std::uint16_t>(hotKey.modifiers | locks);
        cookies.push_back(xcb_grab_key_checked(session_.get(), 0, session_.connection().root(), mask, hotKey.keyCode,
                                               XCB_GRAB_MODE_ASYNC, XCB_GRAB_MODE_ASYNC));
    }
    bool succeeded = true;
    for (const auto cookie : cookies) {
        const XcbOwned<xcb_generic_error_t> error(xcb_request_check(session_.get(), cookie));
        succeeded = succeeded && !error;
    }
    if (!succeeded) ungrab(hotKey);
    session_.flush();
    return succeeded && !session_.connection().isBroken();
}

void X11SystemHotKeys::ungrab(const HotKey& hotKey) const {
    if (hotKey.keyCode == 0) return;  // which would be any key
    for (const std::uint16_t locks : lockVariants_) {
        const auto mask = static_cast<std::uint16_t>(hotKey.modifiers | locks);
        xcb_ungrab_key(session_.get(), hotKey.keyCode, session_.connection().root(), mask);
    }
}

void X11SystemHotKeys::pressed(const xcb_key_press_event_t& event) {
    if (std::exchange(heldKeyCode_, event.detail) == event.detail) return;
    const auto modifiers = static_cast<std::uint16_t>(event.state & MatteringModifiers);
    for (const auto& [id, hotKey] : hotKeys_) {
        if (hotKey.keyCode != event.detail || hotKey.modifiers != modifiers) continue;
        const auto handler = hotKey.handler;  // it may unregister itself
        handler();
        return;
    }
}

}  // namespace plume
