#include "ports/x11/keyboard/KeyDecoder.h"

#include <xkbcommon/xkbcommon-keysyms.h>

#include <algorithm>
#include <array>
#include <cstdlib>
#include <utility>

#include "ports/x11/keyboard/X11KeyCodes.h"

namespace plume {

namespace {

// Symbols of keys that change what other keys do.
bool isModifierSymbol(xkb_keysym_t symbol) {
    return (symbol >= XKB_KEY_Shift_L && symbol <= XKB_KEY_Hyper_R) ||
           (symbol >= XKB_KEY_ISO_Lock && symbol <= XKB_KEY_ISO_Level5_Lock) || symbol == XKB_KEY_Mode_switch;
}

bool isModifierKeyCode(KeyCode keyCode) {
    return keyCode >= KeyCode::RightCommand && keyCode <= KeyCode::RightControl;
}

// As the C library chooses the locale of a program's text.
const char* textLocale() {
    for (const char* variable : {"LC_ALL", "LC_CTYPE", "LANG"}) {
        const char* const value = std::getenv(variable);
        if (value && *value != '\0') return value;
    }
    return "C";
}

}  // namespace

KeyDecoder::KeyDecoder() : context_(xkb_context_new(XKB_CONTEXT_NO_FLAGS)) {}

void KeyDecoder::setKeymap(std::shared_ptr<const XkbKeymap> keymap, const KeycodeSet& held, const XkbLocks& locks) {
    state_.reset(xkb_state_new(keymap->get()));
    keymap_ = std::move(keymap);
    for (unsigned i = 0; i < held.size(); ++i) {
        if (!held[i]) continue;
        const xkb_keysym_t symbol = xkb_state_key_get_one_sym(state_.get(), i);
        keyCodes_[i] = XkbKeymap::virtualKeyOf(static_cast<xcb_keycode_t>(i), symbol);
        if (isModifierSymbol(symbol)) xkb_state_update_key(state_.get(), i, XKB_KEY_DOWN);
    }
    adopt(locks);
    if (keymap_->hasComposingKeys()) loadCompose();
}

void KeyDecoder::loadCompose() {
    if (composeState_ || !context_) return;
    constexpr auto Flags = XKB_COMPOSE_COMPILE_NO_FLAGS;
    composeTable_.reset(xkb_compose_table_new_from_locale(context_.get(), textLocale(), Flags));
    // Without a locale of its own a program composes nothing; everybody else composes much the same.
    if (!composeTable_) composeTable_.reset(xkb_compose_table_new_from_locale(context_.get(), "en_US.UTF-8", Flags));
    if (composeTable_) composeState_.reset(xkb_compose_state_new(composeTable_.get(), XKB_COMPOSE_STATE_NO_FLAGS));
}

void KeyDecoder::adopt(const XkbLocks& locks) {
    const auto mods = xkb_state_serialize_mods(state_.get(), XKB_STATE_MODS_DEPRESSED);
    const auto group = xkb_state_serialize_layout(state_.get(), XKB_STATE_LAYOUT_DEPRESSED);
    xkb_state_update_mask(state_.get(), mods, locks.latchedModifiers, locks.lockedModifiers, group,
                          static_cast<xkb_layout_index_t>(locks.latchedGroup), locks.lockedGroup);
}

XkbLocks KeyDecoder::locks() const {
    auto* const state = state_.get();
    return {static_cast<std::uint8_t>(xkb_state_serialize_mods(state, XKB_STATE_MODS_LATCHED)),
            static_cast<std::uint8_t>(xkb_state_serialize_mods(state, XKB_STATE_MODS_LOCKED)),
            static_cast<std::int16_t>(xkb_state_serialize_layout(state, XKB_STATE_LAYOUT_LATCHED)),
            static_cast<std::uint8_t>(xkb_state_serialize_layout(state, XKB_STATE_LAYOUT_LOCKED))};
}

void KeyDecoder::undoLocks() {
    if (locks() != locksBefore_) adopt(locksBefore_);
}

EventFlags KeyDecoder::flags() const {
    const auto mods = xkb_state_serialize_mods(state_.get(), XKB_STATE_MODS_EFFECTIVE);
    EventFlags flags;
    if ((mods & XCB_MOD_MASK_LOCK) != 0) flags |= EventFlag::CapsLock;
    if ((mods & XCB_MOD_MASK_SHIFT) != 0) flags |= EventFlag::Shift;
    if ((mods & XCB_MOD_MASK_CONTROL) != 0) flags |= EventFlag::Control;
    if ((mods & XCB_MOD_MASK_1) != 0) flags |= EventFlag::Option;
    if ((mods & XCB_MOD_MASK_4) != 0) flags |= EventFlag::Command;
    return flags;
}

KeyDecoder::Key KeyDecoder::press(xcb_keycode_t keycode) {
    text_.clear();
    const xkb_keysym_t symbol = xkb_state_key_get_one_sym(state_.get(), keycode);
    Key key;
    key.keyCode = XkbKeymap::virtualKeyOf(keycode, symbol);
    key.flags = flags();
    keyCodes_[keycode] = key.keyCode;
    key.modifier = isModifierSymbol(symbol);
    const bool composed = !key.modifier && isComposed(symbol);
    if (!key.modifier && !composed) text_.assignKey(*state_, keycode, key.flags.contains(EventFlag::Option));
    key.composing = composed && text_.view().empty();
    locksBefore_ = locks();
    xkb_state_update_key(state_.get(), keycode, XKB_KEY_DOWN);
    if (key.modifier) {
        const EventFlags now = flags();
        key.silent = now == key.flags && !isModifierKeyCode(key.keyCode);
        key.flags = now;
    }
    key.string = text_.view();
    return key;
}

bool KeyDecoder::isComposed(xkb_keysym_t symbol) {
    if (!composeState_ || xkb_compose_state_feed(composeState_.get(), symbol) != XKB_COMPOSE_FEED_ACCEPTED) {
        return false;
    }
    const auto status = xkb_compose_state_get_status(composeState_.get());
    if (status == XKB_COMPOSE_COMPOSED) {
        std::array<char, 64> utf8{};
        const int length = xkb_compose_state_get_utf8(composeState_.get(), utf8.data(), utf8.size());
        text_.assign({utf8.data(), static_cast<std::size_t>(std::clamp(length, 0, static_cast<int>(utf8.size()) - 1))});
    }
    return status != XKB_COMPOSE_NOTHING;
}

KeyDecoder::Key KeyDecoder::release(xcb_keycode_t keycode) {
    text_.clear();
    const xkb_keysym_t symbol = xkb_state_key_get_one_sym(state_.get(), keycode);
    Key key;
    key.keyCode = keyCodes_[keycode];
    key.flags = flags();
    key.modifier = isModifierSymbol(symbol);
    if (!key.modifier) text_.assignKey(*state_, keycode, key.flags.contains(EventFlag::Option));
    xkb_state_update_key(state_.get(), keycode, XKB_KEY_UP);
    if (key.modifier) {
        const EventFlags now = flags();
        key.silent = now == key.flags && !isModifierKeyCode(key.keyCode);
        key.flags = now;
    }
    key.string = text_.view();
    return key;
}

}  // namespace plume
