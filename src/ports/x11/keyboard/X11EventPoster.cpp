#include "ports/x11/keyboard/X11EventPoster.h"

#include <poll.h>
#include <xcb/xtest.h>

#include <algorithm>
#include <cmath>
#include <set>
#include <utility>

#include "ports/x11/keyboard/NeutralKeyboard.h"
#include "ports/x11/keyboard/X11KeyCodes.h"

namespace plume {

namespace {

// A key code of the poster's own: the key that types this ASCII character without modifiers, a spare one if need be.
constexpr std::uint16_t LetterKeyCode = 0x4000;

// Seconds that one batch may wait for spare key codes, and between two heartbeats.
constexpr double LongestWait = 2;
constexpr double BeatPeriod = 0.05;

constexpr std::uint8_t LeftButton = 1;

std::uint8_t realModifiers(EventFlags flags) {
    unsigned modifiers = 0;
    if (flags.contains(EventFlag::Shift)) modifiers |= XCB_MOD_MASK_SHIFT;
    if (flags.contains(EventFlag::Control)) modifiers |= XCB_MOD_MASK_CONTROL;
    if (flags.contains(EventFlag::Option)) modifiers |= XCB_MOD_MASK_1;
    if (flags.contains(EventFlag::Command)) modifiers |= XCB_MOD_MASK_4;
    return static_cast<std::uint8_t>(modifiers);
}

bool isHighSurrogate(char16_t unit) {
    return unit >= 0xD800 && unit <= 0xDBFF;
}

// Half of a surrogate pair, a control character: nothing that a key could type.
bool isTypeable(char32_t character) {
    const bool control = character < 0x20 || (character >= 0x7F && character < 0xA0);
    const bool surrogate = character >= 0xD800 && character <= 0xDFFF;
    return !control && !surrogate;
}

// Calls with each character; the ends of lines and Tab as U'\n' and U'\t', everything else as it is.
template <typename Function>
void forEachCharacter(std::u16string_view text, Function&& function) {
    for (std::size_t i = 0; i < text.size(); ++i) {
        char32_t character = text[i];
        if (isHighSurrogate(text[i]) && i + 1 < text.size() && text[i + 1] >= 0xDC00 && text[i + 1] <= 0xDFFF) {
            character = 0x10000 + ((character - 0xD800) << 10) + (text[++i] - 0xDC00U);
        }
        if (character == U'\r') {
            if (i + 1 < text.size() && text[i + 1] == u'\n') ++i;
            character = U'\n';
        }
        function(character);
    }
}

bool isKeyOfItsOwn(char32_t character) {
    return character == U'\n' || character == U'\t';
}

}  // namespace

X11EventPoster::X11EventPoster(const RunLoop& loop, TapConnection& connection, XkbKeyboard& keyboard,
                               X11KeyboardTap& tap)
    : loop_(loop), connection_(connection), keyboard_(keyboard), tap_(tap), writer_(connection, keyboard) {
    writer_.clearLeftovers();
}

X11EventPoster::~X11EventPoster() {
    double lastUse = -SpareKeycodes::Never;
    for (SpareKeycodes::Assignment& assignment : spares_.assignments()) {
        if (assignment.character == 0) continue;
        lastUse = std::max(lastUse, assignment.lastUse);
        assignment.character = 0;
        assignment.written = false;
    }
    // What was typed last may not have been read yet.
    const double wait = lastUse + SpareKeycodes::Rest - loop_.now();
    if (wait > 0) poll(nullptr, 0, static_cast<int>(std::ceil(wait * 1000)));
    writer_.write(spares_);
    connection_.connection().sync();
}

// ---- Gathering ----

void X11EventPoster::post(const SynthesisedKey& key, bool) {
    begin();
    if (!key.text.empty()) {
        // A text is typed when its key goes down; its going up has nothing left to do.
        if (key.down) addText(key.text);
    } else {
        textEnd_ = 0;
        Item item{.modifiers = realModifiers(key.flags), .down = key.down, .isKey = true};
        const std::uint16_t number = numberOf(key.keyCode);
        if ((number & LetterKeyCode) != 0 && key.keyCode != KeyCode::None) {
            item.character = number & 0x7FU;
        } else {
            item.keycode = keyboard_.keymap()->keycodeOf(key.keyCode);
        }
        items_.push_back(item);
    }
    end();
}

// A long text comes in pieces of a fixed length, so a character or an end of line may have been cut in two.
void X11EventPoster::addText(std::u16string_view text) {
    const char16_t before = std::exchange(textEnd_, text.back());
    std::u16string whole;
    if (isHighSurrogate(before)) whole = before;
    if (before == u'\r' && text.front() == u'\n') text.remove_prefix(1);
    whole += text;
    forEachCharacter(whole, [this](char32_t character) {
        if (isTypeable(character) || isKeyOfItsOwn(character)) items_.push_back({.character = character});
    });
}

bool X11EventPoster::canType(std::u16string_view text) const {
    if (tap_.composesKeys()) return false;
    const XkbKeymap& keymap = *keyboard_.keymap();
    const std::size_t spares = keymap.spareKeycodes().size();
    std::set<char32_t> missing;
    bool typeable = true;
    forEachCharacter(text, [&](char32_t character) {
        if (isKeyOfItsOwn(character) || missing.size() > spares) return;
        typeable = typeable && isTypeable(character);
        if (!keymap.strokeFor(character, keyboard_.group())) missing.insert(character);
    });
    if (!typeable) return false;
    return keyboard_.keymap() == keymap_ ? spares_.canTake(missing, loop_.now()) : missing.size() <= spares;
}

// ---- Sending ----

void X11EventPoster::end() {
    if (--depth_ > 0 || items_.empty()) return;
    std::vector<Item> items = std::exchange(items_, {});
    if (!connection_.isBroken()) send(items);
    items.clear();
    items_.swap(items);  // keeps the memory
}

void X11EventPoster::send(std::span<Item> items) {
    if (keymap_ != keyboard_.keymap()) {
        keymap_ = keyboard_.keymap();
        spares_.reset(keymap_->spareKeycodes());
    }
    const double start = loop_.now();
    {
        const TapConnection::Unheard unheard(connection_);
        const NeutralKeyboard neutral(connection_, *keymap_);
        group_ = neutral.group();
        while (!items.empty()) {
            const std::size_t count = findKeys(items);
            writer_.verify(spares_, start);
            writer_.write(spares_);
            for (const Item& item : items.first(count)) sendItem(item);
            items = items.subspan(count);
            if (!items.empty() && !awaitSpare(start + LongestWait)) items = items.subspan(1);
        }
        setModifiers(0);
        // What was pressed and not released in the batch.
        connection_.releaseAll();
        explicitModifiers_ = 0;
    }
    connection_.flush();
    spares_.extend(start, loop_.now());
}

// How many of the items can be sent now, each with its key.
std::size_t X11EventPoster::findKeys(std::span<Item> items) {
    std::size_t count = 0;
    while (count < items.size() && findKey(items[count])) ++count;
    return count;
}

// False when a character has to wait for a spare key code.
bool X11EventPoster::findKey(Item& item) {
    if (item.character == 0) return true;
    if (isKeyOfItsOwn(item.character)) {
        item.keycode = keymap_->keycodeOf(item.character == U'\t' ? KeyCode::Tab : KeyCode::Return);
        return true;
    }
    const auto stroke = keymap_->strokeFor(item.character, group_);
    if (stroke && (!item.isKey || stroke->modifiers == 0)) {
        item.keycode = stroke->keycode;
        item.modifiers |= stroke->modifiers;
        return true;
    }
    item.keycode = spares_.take(item.character, loop_.now());
    return item.keycode != 0;
}

void X11EventPoster::sendItem(const Item& item) {
    if (item.keycode == 0) return;
    if (!item.isKey) {
        setModifiers(item.modifiers);
        connection_.sendKey(item.keycode, true);
        connection_.sendKey(item.keycode, false);
        return;
    }
    if (!item.down && !connection_.keysDown()[item.keycode]) return;
    const std::uint8_t own = keymap_->modifiersOf(item.keycode);
    if (item.down) setModifiers(item.modifiers & static_cast<std::uint8_t>(~own));
    connection_.sendKey(item.keycode, item.down);
    // A modifier that was pressed as a key stays until it is released as one.
    const unsigned now = item.down ? explicitModifiers_ | own : explicitModifiers_ & ~own;
    explicitModifiers_ = static_cast<std::uint8_t>(now);
}

void X11EventPoster::setModifiers(std::uint8_t wanted) {
    for (unsigned bit = 1; bit <= XCB_MOD_MASK_5; bit <<= 1) {
        const auto modifier = static_cast<std::uint8_t>(bit);
        if (((modifiers_ ^ wanted) & modifier) == 0 || (explicitModifiers_ & modifier) != 0) continue;
        const xcb_keycode_t keycode = keymap_->keyOfModifier(modifier);
        if (keycode != 0) connection_.sendKey(keycode, (wanted & modifier) != 0);
        modifiers_ ^= modifier;
    }
}

// False when none will be free before the deadline.
bool X11EventPoster::awaitSpare(double deadline) const {
    const double free = spares_.nextFree();
    if (free > deadline) return false;
    connection_.flush();
    while (loop_.now() < free) {
        poll(nullptr, 0, static_cast<int>(std::ceil(std::clamp(free - loop_.now(), 0.0, BeatPeriod) * 1000)));
        if (heartbeat) heartbeat();
    }
    return true;
}

// ---- The keyboard and the pointer ----

KeyCode X11EventPoster::keyCodeOfLetter(char16_t letter) const {
    const XkbKeymap& keymap = *keyboard_.keymap();
    const auto stroke = keymap.strokeFor(letter, keyboard_.group());
    if (stroke && stroke->modifiers == 0) {
        const KeyCode keyCode = virtualKeyAt(stroke->keycode);
        if (keymap.keycodeOf(keyCode) == stroke->keycode) return keyCode;
    }
    return KeyCode{static_cast<std::uint16_t>(LetterKeyCode | letter)};
}

bool X11EventPoster::isKeyDown(KeyCode keyCode) const {
    const xcb_keycode_t keycode = keyboard_.keymap()->keycodeOf(keyCode);
    return keycode != 0 && connection_.userKeys[keycode];
}

Point X11EventPoster::pointerLocation() const {
    auto& connection = connection_.connection();
    const XcbOwned<xcb_query_pointer_reply_t> reply(
        xcb_query_pointer_reply(connection.get(), xcb_query_pointer(connection.get(), connection.root()), nullptr));
    return reply ? Point{static_cast<double>(reply->root_x), static_cast<double>(reply->root_y)} : Point{};
}

void X11EventPoster::click(Point location) {
    auto& connection = connection_.connection();
    const auto x = static_cast<std::int16_t>(std::clamp(std::round(location.x), 0.0, 32767.0));
    const auto y = static_cast<std::int16_t>(std::clamp(std::round(location.y), 0.0, 32767.0));
    xcb_test_fake_input(connection.get(), XCB_MOTION_NOTIFY, 0, XCB_CURRENT_TIME, connection.root(), x, y, 0);
    xcb_test_fake_input(connection.get(), XCB_BUTTON_PRESS, LeftButton, XCB_CURRENT_TIME, connection.root(), 0, 0, 0);
    xcb_test_fake_input(connection.get(), XCB_BUTTON_RELEASE, LeftButton, XCB_CURRENT_TIME, connection.root(), 0, 0, 0);
    connection.flush();
}

}  // namespace plume
