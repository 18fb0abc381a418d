#include "ports/x11/keyboard/NeutralKeyboard.h"

#include "ports/x11/keyboard/XcbXkb.h"

namespace plume {

namespace {

// By convention; the server knows it only by number.
constexpr std::uint8_t NumLockModifier = XCB_MOD_MASK_2;

}  // namespace

NeutralKeyboard::NeutralKeyboard(TapConnection& connection, const XkbKeymap& keymap)
    : connection_(connection), keymap_(keymap) {
    releaseKeys();
    // Last: the release of a locking key may unlock.
    readState();
    if ((lockedModifiers_ | latchedModifiers_) != 0) lock(0, latchedModifiers_);
}

NeutralKeyboard::~NeutralKeyboard() {
    if (lockedModifiers_ != 0) lock(lockedModifiers_, 0);
    for (const xcb_keycode_t keycode : heldModifiers_) connection_.sendKey(keycode, true);
    connection_.keepMenusClosed();
}

void NeutralKeyboard::releaseKeys() {
    const KeycodeSet down = connection_.keysDown();
    if (down.none()) return;
    std::vector<xcb_keycode_t> keys;
    for (std::size_t i = 0; i < down.size(); ++i) {
        const auto keycode = static_cast<xcb_keycode_t>(i);
        if (!down[i]) continue;
        keys.push_back(keycode);
        if (keymap_.modifiersOf(keycode) != 0 && connection_.userKeys[i]) heldModifiers_.push_back(keycode);
    }
    connection_.keepMenusClosed();
    for (const xcb_keycode_t keycode : keys) connection_.sendKey(keycode, false);
}

void NeutralKeyboard::readState() {
    auto* const connection = connection_.connection().get();
    xcb_discard_reply(connection, xcb_xkb_use_extension(connection, 1, 0).sequence);
    const auto cookie = xcb_xkb_get_state(connection, XCB_XKB_ID_USE_CORE_KBD);
    const XcbOwned<xcb_xkb_get_state_reply_t> state(xcb_xkb_get_state_reply(connection, cookie, nullptr));
    if (!state) return;
    lockedModifiers_ = state->lockedMods & static_cast<std::uint8_t>(~NumLockModifier);
    latchedModifiers_ = state->latchedMods;
    group_ = state->group;
}

void NeutralKeyboard::lock(std::uint8_t modifiers, std::uint8_t spentLatches) {
    xcb_xkb_latch_lock_state(connection_.connection().get(), XCB_XKB_ID_USE_CORE_KBD, lockedModifiers_, modifiers, 0, 0,
                             spentLatches, 0, 0);
}

}  // namespace plume
