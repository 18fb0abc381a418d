#include "testing/rig/TestKeyboard.h"

#include <poll.h>
#include <xkbcommon/xkbcommon.h>

#include <algorithm>
#include <memory>
#include <string>
#include <utility>

namespace plume::rig {

namespace {

// The server's queue of unprocessed input is bounded: it is emptied at least every so many keys.
constexpr std::size_t KeysBetweenSyncs = 50;

std::u32string decodeUtf8(std::string_view text) {
    std::u32string decoded;
    for (std::size_t i = 0; i < text.size();) {
        const auto lead = static_cast<unsigned char>(text[i]);
        const std::size_t length = lead < 0x80 ? 1 : lead < 0xE0 ? 2 : lead < 0xF0 ? 3 : 4;
        char32_t character = length == 1 ? lead : lead & (0x7FU >> length);
        for (std::size_t k = 1; k < length && i + k < text.size(); ++k) {
            character = (character << 6) | (static_cast<unsigned char>(text[i + k]) & 0x3FU);
        }
        decoded += character;
        i += length;
    }
    return decoded;
}

struct KeymapOwner {
    KeymapOwner(const std::string& layout, const std::string& variant)
        : context(xkb_context_new(XKB_CONTEXT_NO_FLAGS)) {
        const xkb_rule_names names{"evdev", "pc105", layout.c_str(), variant.c_str(), ""};
        keymap = xkb_keymap_new_from_names(context, &names, XKB_KEYMAP_COMPILE_NO_FLAGS);
        if (keymap == nullptr) throw RigError("there is no keyboard layout " + layout + " " + variant);
    }
    ~KeymapOwner() {
        xkb_keymap_unref(keymap);
        xkb_context_unref(context);
    }
    KeymapOwner(const KeymapOwner&) = delete;
    KeymapOwner& operator=(const KeymapOwner&) = delete;

    xkb_context* context;
    xkb_keymap* keymap = nullptr;
};

}  // namespace

TestKeyboard::TestKeyboard(const std::filesystem::path& socket, const XServer::Options& layout) : socket_(socket) {
    const KeymapOwner owner(layout.layout, layout.variant);
    auto* keymap = owner.keymap;
    // Only the keys of the typing area and its function keys: 9 to 94 on a PC keyboard, without the keypad.
    for (xkb_level_index_t level = 0; level < 4; ++level) {
        for (xkb_keycode_t key = 9; key <= 94; ++key) {
            const xkb_keysym_t* symbols = nullptr;
            const bool keypad = key >= 79 && key <= 91;
            if (keypad || xkb_keymap_key_get_syms_by_level(keymap, key, 0, level, &symbols) != 1) continue;
            const char32_t character = xkb_keysym_to_utf32(symbols[0]);
            if (character == 0) continue;
            strokes_.emplace(character, Stroke{static_cast<int>(key), (level & 1) != 0, (level & 2) != 0});
        }
    }
    strokes_[U'\n'] = Stroke{static_cast<int>(Key::Return), false, false};
}

void TestKeyboard::press(int keycode) {
    socket_.sendKey(keycode, true);
    down_.push_back(keycode);
}

void TestKeyboard::release(int keycode) {
    socket_.sendKey(keycode, false);
    std::erase(down_, keycode);
}

void TestKeyboard::tap(Key key) {
    press(key);
    release(key);
}

void TestKeyboard::chord(std::initializer_list<Key> modifiers, Key key) {
    for (const Key modifier : modifiers) press(modifier);
    tap(key);
    for (const Key modifier : modifiers) release(modifier);
    sync();
}

void TestKeyboard::chord(std::initializer_list<Key> modifiers, char32_t character) {
    chord(modifiers, static_cast<Key>(keycodeOf(character)));
}

void TestKeyboard::type(std::string_view text) {
    std::size_t unsynced = 0;
    for (const Stroke& stroke : strokesOf(text)) {
        holdModifiersOf(stroke);
        press(stroke.keycode);
        release(stroke.keycode);
        if (++unsynced % KeysBetweenSyncs == 0) sync();
    }
    holdModifiersOf({});
    sync();
}

void TestKeyboard::typeRollingOver(std::string_view text, Milliseconds gap) {
    std::size_t unsynced = 0;
    int previous = 0;
    for (const Stroke& stroke : strokesOf(text)) {
        if (previous == stroke.keycode) release(std::exchange(previous, 0));  // the same finger
        holdModifiersOf(stroke);
        press(stroke.keycode);
        if (previous != 0) release(previous);
        previous = stroke.keycode;
        if (gap.count() > 0) poll(nullptr, 0, static_cast<int>(gap.count()));
        if (++unsynced % KeysBetweenSyncs == 0) sync();
    }
    if (previous != 0) release(previous);
    holdModifiersOf({});
    sync();
}

void TestKeyboard::releaseAll() {
    while (!down_.empty()) release(int{down_.back()});
    sync();
}

void TestKeyboard::holdModifiersOf(const Stroke& stroke) {
    hold(Key::LeftShift, stroke.shift);
    hold(Key::AltGr, stroke.altGr);
}

void TestKeyboard::hold(Key key, bool down) {
    const bool isDown = std::ranges::find(down_, static_cast<int>(key)) != down_.end();
    if (down && !isDown) press(key);
    if (!down && isDown) release(key);
}

const TestKeyboard::Stroke& TestKeyboard::strokeOf(char32_t character) const {
    const auto found = strokes_.find(character);
    if (found == strokes_.end()) {
        throw RigError("no key prints U+" + std::to_string(static_cast<std::uint32_t>(character)) + " (decimal)");
    }
    return found->second;
}

std::vector<TestKeyboard::Stroke> TestKeyboard::strokesOf(std::string_view text) const {
    std::vector<Stroke> strokes;
    for (const char32_t character : decodeUtf8(text)) strokes.push_back(strokeOf(character));
    return strokes;
}

}  // namespace plume::rig
