#include "ports/x11/keyboard/SpareKeyWriter.h"

#include <algorithm>
#include <cstdint>
#include <cstring>
#include <utility>
#include <vector>

#include "ports/x11/keyboard/XcbXkb.h"

namespace plume {

namespace {

constexpr auto NoteProperty = "_PLUME_SPARE_KEYS";  // key codes and symbols by turns

xkb_keysym_t symbolOf(char32_t character) {
    if (character == 0) return XKB_KEY_NoSymbol;
    const bool latin1 = (character >= 0x20 && character <= 0x7E) || (character >= 0xA0 && character <= 0xFF);
    return latin1 ? character : 0x01000000 + character;
}

// The symbols of some key codes on one device: for each a head and as many symbols as it says, one after the other.
struct KeySymbols {
    struct Key {
        xcb_xkb_key_sym_map_t head{};
        std::vector<xkb_keysym_t> symbols;

        void set(xkb_keysym_t symbol);
    };

    xcb_keycode_t minimum = 0;
    xcb_keycode_t maximum = 0;
    xcb_keycode_t first = 0;
    std::vector<Key> keys;

    static KeySymbols read(xcb_connection_t* connection, std::uint16_t device, xcb_keycode_t first, std::uint8_t count);
    void write(xcb_connection_t* connection, std::uint16_t device) const;
};

// One group of one level, of the first type, which is that of keys without levels everywhere; or none.
void KeySymbols::Key::set(xkb_keysym_t symbol) {
    const bool any = symbol != XKB_KEY_NoSymbol;
    head = {};
    head.groupInfo = any ? 1 : 0;
    head.width = any ? 1 : 0;
    head.nSyms = any ? 1 : 0;
    symbols.assign(head.nSyms, symbol);
}

KeySymbols KeySymbols::read(xcb_connection_t* connection, std::uint16_t device, xcb_keycode_t first,
                            std::uint8_t count) {
    xcb_discard_reply(connection, xcb_xkb_use_extension(connection, 1, 0).sequence);
    const auto cookie = xcb_xkb_get_map(connection, device, 0, XCB_XKB_MAP_PART_KEY_SYMS, 0, 0, first, count, 0, 0, 0,
                                        0, 0, 0, 0, 0, 0, 0, 0);
    const XcbOwned<xcb_xkb_get_map_reply_t> reply(xcb_xkb_get_map_reply(connection, cookie, nullptr));
    KeySymbols map;
    if (!reply) return map;
    map.minimum = reply->minKeyCode;
    map.maximum = reply->maxKeyCode;
    map.first = reply->firstKeySym;
    const auto* next = static_cast<const std::uint8_t*>(xcb_xkb_get_map_map(reply.get()));
    const auto* const end = reinterpret_cast<const std::uint8_t*>(reply.get()) + 32 + std::size_t{reply->length} * 4;
    const auto left = [&] { return static_cast<std::size_t>(end - next); };
    while (map.keys.size() < reply->nKeySyms && left() >= sizeof(xcb_xkb_key_sym_map_t)) {
        Key key;
        std::memcpy(&key.head, next, sizeof key.head);
        next += sizeof key.head;
        if (left() < key.head.nSyms * sizeof(xkb_keysym_t)) break;
        key.symbols.resize(key.head.nSyms);
        std::copy_n(next, key.head.nSyms * sizeof(xkb_keysym_t), reinterpret_cast<std::uint8_t*>(key.symbols.data()));
        next += key.head.nSyms * sizeof(xkb_keysym_t);
        map.keys.push_back(std::move(key));
    }
    return map;
}

void KeySymbols::write(xcb_connection_t* connection, std::uint16_t device) const {
    std::vector<std::uint8_t> bytes;
    std::size_t total = 0;
    const auto append = [&bytes](const void* data, std::size_t size) {
        const auto* const start = static_cast<const std::uint8_t*>(data);
        bytes.insert(bytes.end(), start, start + size);
    };
    for (const Key& key : keys) {
        append(&key.head, sizeof key.head);
        append(key.symbols.data(), key.symbols.size() * sizeof(xkb_keysym_t));
        total += key.symbols.size();
    }
    xcb_xkb_set_map(connection, device, XCB_XKB_MAP_PART_KEY_SYMS, 0, minimum, maximum, 0, 0, first,
                    static_cast<std::uint8_t>(keys.size()), static_cast<std::uint16_t>(total), 0, 0, 0, 0, 0, 0, 0, 0,
                    0, 0, 0, 0, 0, 0, 0, 0, bytes.data());
}

}  // namespace

void SpareKeyWriter::clearLeftovers() {
    auto& connection = connection_.connection();
    constexpr std::uint32_t Longest = 512;
    const auto cookie = xcb_get_property(connection.get(), 1, connection.root(), connection.atom(NoteProperty),
                                         XCB_ATOM_CARDINAL, 0, Longest);
    const XcbOwned<xcb_get_property_reply_t> reply(xcb_get_property_reply(connection.get(), cookie, nullptr));
    if (!reply || reply->format != 32) return;
    const auto* const values = static_cast<const std::uint32_t*>(xcb_get_property_value(reply.get()));
    const auto* const setup = xcb_get_setup(connection.get());
    Symbols left;
    Symbols none;
    for (std::size_t i = 0; i + 1 < reply->value_len; i += 2) {
        if (values[i] < setup->min_keycode || values[i] > setup->max_keycode) continue;
        left[static_cast<xcb_keycode_t>(values[i])] = values[i + 1];
        none[static_cast<xcb_keycode_t>(values[i])] = XKB_KEY_NoSymbol;
    }
    change(none, &left);
    connection.sync();
}

void SpareKeyWriter::verify(SpareKeycodes& spares, double since) const {
    auto& assignments = spares.assignments();
    const auto isUsed = [since](const SpareKeycodes::Assignment& assignment) {
        return assignment.lastUse >= since && assignment.written;
    };
    const auto first = std::ranges::find_if(assignments, isUsed);
    if (first == assignments.end()) return;
    const auto last = std::ranges::find_if(assignments.rbegin(), assignments.rend(), isUsed);
    const auto count = static_cast<std::uint8_t>(last->keycode - first->keycode + 1);
    const auto map =
        KeySymbols::read(connection_.connection().get(), connection_.testKeyboard(), first->keycode, count);
    for (auto& assignment : assignments) {
        if (!isUsed(assignment)) continue;
        const std::size_t index = assignment.keycode - first->keycode;
        assignment.written =
            index < map.keys.size() && map.keys[index].symbols == std::vector{symbolOf(assignment.character)};
    }
}

void SpareKeyWriter::write(SpareKeycodes& spares) {
    Symbols changed;
    for (const auto& assignment : spares.assignments()) {
        if (!assignment.written) changed[assignment.keycode] = symbolOf(assignment.character);
    }
    if (changed.empty() || !change(changed, nullptr)) return;
    for (auto& assignment : spares.assignments()) assignment.written = true;
    note(spares);
}

bool SpareKeyWriter::change(const Symbols& symbols, const Symbols* only) {
    if (symbols.empty()) return true;
    auto* const connection = connection_.connection().get();
    const xcb_keycode_t first = symbols.begin()->first;
    const auto count = static_cast<std::uint8_t>(symbols.rbegin()->first - first + 1);
    auto map = KeySymbols::read(connection, XCB_XKB_ID_USE_CORE_KBD, first, count);
    if (map.keys.size() != count) return false;
    std::vector<xkb_keysym_t> written(count, XKB_KEY_NoSymbol);
    for (const auto& [keycode, symbol] : symbols) {
        const std::size_t index = keycode - first;
        if (only && map.keys[index].symbols != std::vector{only->at(keycode)}) continue;
        map.keys[index].set(symbol);
        written[index] = symbol;
    }
    // The end of a leftover, which was taken for a part of the layout, is to be noticed as a change of it.
    if (!only) keyboard_.willWrite(first, written);
    map.write(connection, XCB_XKB_ID_USE_CORE_KBD);
    return true;
}

void SpareKeyWriter::note(const SpareKeycodes& spares) const {
    std::vector<std::uint32_t> values;
    for (const auto& assignment : spares.assignments()) {
        if (assignment.character == 0) continue;
        values.push_back(assignment.keycode);
        values.push_back(symbolOf(assignment.character));
    }
    auto& connection = connection_.connection();
    xcb_change_property(connection.get(), XCB_PROP_MODE_REPLACE, connection.root(), connection.atom(NoteProperty),
                        XCB_ATOM_CARDINAL, 32, static_cast<std::uint32_t>(values.size()), values.data());
}

}  // namespace plume
