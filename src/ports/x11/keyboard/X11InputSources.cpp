#include "ports/x11/keyboard/X11InputSources.h"

#include "Foundation/Strings.h"
#include "ports/x11/keyboard/KeyText.h"
#include "ports/x11/keyboard/X11KeyCodes.h"

namespace plume {

X11InputSources::X11InputSources(XkbKeyboard& keyboard) : keyboard_(keyboard) {
    readIdentifier();
    keyboardChanged_ = keyboard.changedEvent.addObserver(this, &X11InputSources::changed);
}

void X11InputSources::changed(const XkbKeyboard::Change& change) {
    if (change == XkbKeyboard::Change::Locks) return;
    readIdentifier();
    tell();
}

void X11InputSources::setEngine(const std::string& identifier) {
    engine_ = identifier;
    readIdentifier();
    tell();
}

void X11InputSources::tell() const {
    // Called by a copy: it may set another.
    if (const auto listener = listener_) listener();
}

void X11InputSources::readIdentifier() {
    identifier_.reset();
    const std::string& name = engine_.empty() ? keyboard_.layoutName() : engine_;
    if (!name.empty()) identifier_ = fromUtf8(name);
}

std::optional<std::u16string> X11InputSources::translateKey(KeyCode keyCode, EventFlags flags) const {
    const xcb_keycode_t keycode = keyboard_.keymap()->keycodeOf(keyCode);
    const XkbOwned<xkb_state> state(xkb_state_new(keyboard_.keymap()->get()));
    if (keycode == 0 || !state) return std::nullopt;
    constexpr std::uint32_t NumLock = XCB_MOD_MASK_2;
    std::uint32_t held = 0;
    if (flags.contains(EventFlag::Shift)) held |= XCB_MOD_MASK_SHIFT;
    if (flags.contains(EventFlag::Control)) held |= XCB_MOD_MASK_CONTROL;
    xkb_state_update_mask(state.get(), held, 0, NumLock, 0, 0, keyboard_.group());
    KeyText text;
    text.assignKey(*state, keycode, flags.contains(EventFlag::Option));
    if (text.view().empty()) return std::nullopt;
    return std::u16string(text.view());
}

}  // namespace plume
