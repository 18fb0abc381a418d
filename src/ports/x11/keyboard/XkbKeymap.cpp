#include "ports/x11/keyboard/XkbKeymap.h"

#include <xkbcommon/xkbcommon-keysyms.h>

#include <algorithm>
#include <bit>
#include <utility>

#include "ports/x11/keyboard/X11KeyCodes.h"

namespace plume {

namespace {

constexpr unsigned FirstKeycode = 8;
constexpr unsigned LastKeycode = 255;

// Keys that are what their symbol says, wherever they are: remapping Caps Lock to Escape makes it an Escape key.
struct Function {
    xkb_keysym_t symbol;
    KeyCode virtualKey;
    bool alias = false;  // another key is the one to press for it
};

constexpr auto Functions = std::to_array<Function>({
    {XKB_KEY_Return, KeyCode::Return},
    {XKB_KEY_Tab, KeyCode::Tab},
    {XKB_KEY_ISO_Left_Tab, KeyCode::Tab, true},
    {XKB_KEY_BackSpace, KeyCode::Delete},
    {XKB_KEY_Escape, KeyCode::Escape},
    {XKB_KEY_KP_Enter, KeyCode::KeypadEnter},
    {XKB_KEY_Insert, KeyCode::Help},
    {XKB_KEY_Home, KeyCode::Home},
    {XKB_KEY_Prior, KeyCode::PageUp},
    {XKB_KEY_Delete, KeyCode::ForwardDelete},
    {XKB_KEY_End, KeyCode::End},
    {XKB_KEY_Next, KeyCode::PageDown},
    {XKB_KEY_Left, KeyCode::Left},
    {XKB_KEY_Right, KeyCode::Right},
    {XKB_KEY_Down, KeyCode::Down},
    {XKB_KEY_Up, KeyCode::Up},
    {XKB_KEY_KP_Insert, KeyCode::Help, true},
    {XKB_KEY_KP_Home, KeyCode::Home, true},
    {XKB_KEY_KP_Prior, KeyCode::PageUp, true},
    {XKB_KEY_KP_Delete, KeyCode::ForwardDelete, true},
    {XKB_KEY_KP_End, KeyCode::End, true},
    {XKB_KEY_KP_Next, KeyCode::PageDown, true},
    {XKB_KEY_KP_Left, KeyCode::Left, true},
    {XKB_KEY_KP_Right, KeyCode::Right, true},
    {XKB_KEY_KP_Down, KeyCode::Down, true},
    {XKB_KEY_KP_Up, KeyCode::Up, true},
    {XKB_KEY_Super_R, KeyCode::RightCommand},
    {XKB_KEY_Super_L, KeyCode::Command},
    {XKB_KEY_Hyper_R, KeyCode::RightCommand, true},
    {XKB_KEY_Hyper_L, KeyCode::Command, true},
    {XKB_KEY_Shift_L, KeyCode::Shift},
    {XKB_KEY_Shift_R, KeyCode::RightShift},
    {XKB_KEY_Caps_Lock, KeyCode::CapsLock},
    {XKB_KEY_Shift_Lock, KeyCode::CapsLock, true},
    {XKB_KEY_Alt_L, KeyCode::Option},
    {XKB_KEY_Alt_R, KeyCode::RightOption},
    {XKB_KEY_Meta_L, KeyCode::Option, true},
    {XKB_KEY_Meta_R, KeyCode::RightOption, true},
    {XKB_KEY_Control_L, KeyCode::Control},
    {XKB_KEY_Control_R, KeyCode::RightControl},
});

const Function* functionOf(xkb_keysym_t symbol) {
    const auto found = std::ranges::find(Functions, symbol, &Function::symbol);
    return found == Functions.end() ? nullptr : &*found;
}

bool hasFunction(KeyCode virtualKey) {
    return std::ranges::find(Functions, virtualKey, &Function::virtualKey) != Functions.end();
}

bool isKeypad(xkb_keysym_t symbol) {
    return symbol >= XKB_KEY_KP_Space && symbol <= XKB_KEY_KP_Equal;
}

bool startsComposing(xkb_keysym_t symbol) {
    return symbol == XKB_KEY_Multi_key || (symbol >= XKB_KEY_dead_grave && symbol <= XKB_KEY_dead_greek);
}

// What the symbol types, 0 when nothing that a text could hold.
char32_t characterOf(xkb_keysym_t symbol) {
    const char32_t character = xkb_keysym_to_utf32(symbol);
    const bool text = (character >= U' ' && character != 0x7F) || character == U'\t' || character == U'\r';
    return text && !isKeypad(symbol) ? character : 0;
}

// The real modifiers that choose this level, as few as possible and no lock; nothing when there are no such.
std::optional<std::uint8_t> modifiersOfLevel(xkb_keymap* keymap, xcb_keycode_t keycode, xkb_layout_index_t group,
                                             xkb_level_index_t level) {
    std::array<xkb_mod_mask_t, 32> masks{};
    const std::size_t count =
        xkb_keymap_key_get_mods_for_level(keymap, keycode, group, level, masks.data(), masks.size());
    std::optional<std::uint8_t> best;
    for (std::size_t i = 0; i < count; ++i) {
        if (masks[i] > 0xFF || (masks[i] & XCB_MOD_MASK_LOCK) != 0) continue;
        if (!best || std::popcount(masks[i]) < std::popcount(*best)) best = static_cast<std::uint8_t>(masks[i]);
    }
    return best;
}

class Fingerprint {
  public:
    void add(std::uint64_t value) { value_ = (value_ ^ value) * 0x100000001B3; }
    std::uint64_t value() const { return value_; }

  private:
    std::uint64_t value_ = 0xCBF29CE484222325;
};

template <typename Visitor>
void forEachSymbol(xkb_keymap* keymap, xcb_keycode_t keycode, Visitor visit) {
    const auto groups = xkb_keymap_num_layouts_for_key(keymap, keycode);
    for (xkb_layout_index_t group = 0; group < groups; ++group) {
        const auto levels = xkb_keymap_num_levels_for_key(keymap, keycode, group);
        for (xkb_level_index_t level = 0; level < levels; ++level) {
            const xkb_keysym_t* symbols = nullptr;
            const int count = xkb_keymap_key_get_syms_by_level(keymap, keycode, group, level, &symbols);
            for (int i = 0; i < count; ++i) visit(group, level, symbols[i]);
        }
    }
}

}  // namespace

XkbKeymap::XkbKeymap(XkbOwned<xkb_keymap> keymap, const KeycodeSet& foreign)
    : keymap_(std::move(keymap)), strokes_(xkb_keymap_num_layouts(keymap_.get())) {
    findModifierKeys();
    Fingerprint fingerprint;
    for (unsigned i = FirstKeycode; i <= LastKeycode; ++i) {
        const auto keycode = static_cast<xcb_keycode_t>(i);
        bool empty = true;
        if (!foreign[i]) {
            forEachSymbol(get(), keycode, [&](auto group, auto level, xkb_keysym_t symbol) {
                empty = empty && symbol == XKB_KEY_NoSymbol;
                composing_ = composing_ || startsComposing(symbol);
                fingerprint.add((std::uint64_t{i} << 48) | (std::uint64_t{group} << 40) | (std::uint64_t{level} << 32) |
                                symbol);
            });
        }
        if (empty) {
            spares_.push_back(keycode);
        } else {
            fingerprint.add(modifiersOf_[i]);
            addKey(keycode);
        }
    }
    fingerprint_ = fingerprint.value();
}

void XkbKeymap::addKey(xcb_keycode_t keycode) {
    for (xkb_layout_index_t group = 0; group < strokes_.size(); ++group) addStrokes(keycode, group);
    const xkb_keysym_t* symbols = nullptr;
    if (xkb_keymap_key_get_syms_by_level(get(), keycode, 0, 0, &symbols) != 1) return;
    const Function* const function = functionOf(symbols[0]);
    if (!function || function->alias) return;
    if (placeOfVirtualKey(function->virtualKey) == keycode) keyOfFunction_[function->virtualKey] = keycode;
    keyOfFunction_.emplace(function->virtualKey, keycode);
}

void XkbKeymap::addStrokes(xcb_keycode_t keycode, xkb_layout_index_t group) {
    const auto groups = xkb_keymap_num_layouts_for_key(get(), keycode);
    if (groups == 0) return;
    // A key with fewer groups goes round, which is what the server does unless told otherwise.
    const xkb_layout_index_t own = group % groups;
    auto& strokes = strokes_[group];
    const auto levels = xkb_keymap_num_levels_for_key(get(), keycode, own);
    for (xkb_level_index_t level = 0; level < levels; ++level) {
        const xkb_keysym_t* symbols = nullptr;
        if (xkb_keymap_key_get_syms_by_level(get(), keycode, own, level, &symbols) != 1) continue;
        const char32_t character = characterOf(symbols[0]);
        if (character == 0) continue;
        const auto modifiers = modifiersOfLevel(get(), keycode, own, level);
        if (!modifiers) continue;
        const auto [known, isNew] = strokes.try_emplace(character, XkbStroke{keycode, *modifiers});
        if (!isNew && std::popcount(*modifiers) < std::popcount(known->second.modifiers)) {
            known->second = XkbStroke{keycode, *modifiers};
        }
        if (character == U'\r') strokes.try_emplace(U'\n', known->second);
    }
}

void XkbKeymap::findModifierKeys() {
    XkbOwned<xkb_state> state(xkb_state_new(get()));
    for (unsigned i = FirstKeycode; i <= LastKeycode; ++i) {
        const auto changed = xkb_state_update_key(state.get(), i, XKB_KEY_DOWN);
        const auto held = static_cast<std::uint8_t>(xkb_state_serialize_mods(state.get(), XKB_STATE_MODS_DEPRESSED));
        xkb_state_update_key(state.get(), i, XKB_KEY_UP);
        const bool lasting = xkb_state_serialize_mods(state.get(), XKB_STATE_MODS_EFFECTIVE) != 0 ||
                             xkb_state_serialize_layout(state.get(), XKB_STATE_LAYOUT_EFFECTIVE) != 0;
        if (lasting) state.reset(xkb_state_new(get()));
        if (changed == 0) continue;
        modifiersOf_[i] = held;
        if (lasting || std::popcount(held) != 1) continue;
        auto& key = keyOfModifier_[static_cast<std::size_t>(std::countr_zero(held))];
        if (key == 0) key = static_cast<xcb_keycode_t>(i);
    }
}

std::optional<XkbStroke> XkbKeymap::strokeFor(char32_t character, xkb_layout_index_t group) const {
    if (strokes_.empty()) return std::nullopt;
    const auto& strokes = strokes_[group % strokes_.size()];
    const auto found = strokes.find(character);
    if (found == strokes.end()) return std::nullopt;
    return found->second;
}

xcb_keycode_t XkbKeymap::keyOfModifier(std::uint8_t modifier) const {
    return std::has_single_bit(modifier) ? keyOfModifier_[static_cast<std::size_t>(std::countr_zero(modifier))]
                                         : xcb_keycode_t{0};
}

xcb_keycode_t XkbKeymap::keycodeOf(KeyCode virtualKey) const {
    if (!hasFunction(virtualKey)) return placeOfVirtualKey(virtualKey);
    const auto found = keyOfFunction_.find(virtualKey);
    return found == keyOfFunction_.end() ? xcb_keycode_t{0} : found->second;
}

KeyCode XkbKeymap::virtualKeyOf(xcb_keycode_t keycode, xkb_keysym_t symbol) {
    if (const Function* const function = functionOf(symbol)) return function->virtualKey;
    const KeyCode atPlace = virtualKeyAt(keycode);
    if (!hasFunction(atPlace)) return atPlace;
    return foreignKeyCode(keycode);
}

}  // namespace plume
