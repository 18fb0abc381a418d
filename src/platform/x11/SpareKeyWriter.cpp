#include "platform/x11/SpareKeyWriter.h"

#include <algorithm>
#include <cstdint>
#include <cstring>
#include <span>
#include <vector>

#include "platform/x11/XcbXkb.h"

namespace plume {

namespace {

constexpr auto NoteProperty = "_PLUME_SPARE_KEYS";  // key codes and symbols by turns

xkb_keysym_t symbolOf(char32_t character) {
    if (character == 0) return XKB_KEY_NoSymbol;
    const bool latin1 = (character >= 0x20 && character <= 0x7E) || (character >= 0xA0 && character <= 0xFF);
    return latin1 ? character : 0x01000000 + character;
}

// The first symbol of each of the key codes on one device, by key code from the first.
std::vector<xkb_keysym_t> firstSymbols(xcb_connection_t* connection, std::uint16_t device, xcb_keycode_t first,
                                       std::uint8_t count) {
    xcb_discard_reply(connection, xcb_xkb_use_extension(connection, 1, 0).sequence);
    const auto cookie = xcb_xkb_get_map(connection, device, 0, XCB_XKB_MAP_PART_KEY_SYMS, 0, 0, first, count, 0, 0, 0,
                                        0, 0, 0, 0, 0, 0, 0, 0);
    const XcbOwned<xcb_xkb_get_map_reply_t> reply(xcb_xkb_get_map_reply(connection, cookie, nullptr));
    if (!reply) return {};
    std::vector<xkb_keysym_t> symbols;
    const auto* next = static_cast<const std::uint8_t*>(xcb_xkb_get_map_map(reply.get()));
    const auto* const end = reinterpret_cast<const std::uint8_t*>(reply.get()) + 32 + std::size_t{reply->length} * 4;
    xcb_xkb_key_sym_map_t head;
    while (symbols.size() < reply->nKeySyms && static_cast<std::size_t>(end - next) >= sizeof head) {
        std::memcpy(&head, next, sizeof head);
        next += sizeof head;
        const std::size_t length = head.nSyms * sizeof(xkb_keysym_t);
        if (static_cast<std::size_t>(end - next) < length) break;
        xkb_keysym_t symbol = XKB_KEY_NoSymbol;
        if (length > 0) std::memcpy(&symbol, next, sizeof symbol);
        symbols.push_back(symbol);
        next += length;
    }
    return symbols;
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
    auto& loans = spares.loans();
    const auto isUsed = [since](const SpareKeycodes::Loan& loan) { return loan.lastUse >= since && loan.written; };
    const auto first = std::ranges::find_if(loans, isUsed);
    if (first == loans.end()) return;
    const auto last = std::ranges::find_if(loans.rbegin(), loans.rend(), isUsed);
    const auto count = static_cast<std::uint8_t>(last->keycode - first->keycode + 1);
    const auto symbols =
        firstSymbols(connection_.connection().get(), connection_.testKeyboard(), first->keycode, count);
    for (auto& loan : loans) {
        if (!isUsed(loan)) continue;
        const std::size_t index = loan.keycode - first->keycode;
        loan.written = index < symbols.size() && symbols[index] == symbolOf(loan.character);
    }
}

void SpareKeyWriter::write(SpareKeycodes& spares) {
    Symbols changed;
    for (const auto& loan : spares.loans()) {
        if (!loan.written) changed[loan.keycode] = symbolOf(loan.character);
    }
    if (changed.empty() || !change(changed, nullptr)) return;
    for (auto& loan : spares.loans()) loan.written = true;
    note(spares);
}

bool SpareKeyWriter::change(const Symbols& symbols, const Symbols* only) {
    if (symbols.empty()) return true;
    auto* const connection = connection_.connection().get();
    const xcb_keycode_t first = symbols.begin()->first;
    const auto count = static_cast<std::uint8_t>(symbols.rbegin()->first - first + 1);
    const XcbOwned<xcb_get_keyboard_mapping_reply_t> reply(
        xcb_get_keyboard_mapping_reply(connection, xcb_get_keyboard_mapping(connection, first, count), nullptr));
    if (!reply) return false;
    const std::size_t width = reply->keysyms_per_keycode;
    const std::span all(xcb_get_keyboard_mapping_keysyms(reply.get()), width * count);
    std::vector<xkb_keysym_t> written(count, XKB_KEY_NoSymbol);
    for (const auto& [keycode, symbol] : symbols) {
        const std::size_t index = keycode - first;
        const auto row = all.subspan(index * width, width);
        const auto isOther = [&, keycode = keycode](xcb_keysym_t there) {
            return there != XKB_KEY_NoSymbol && there != only->at(keycode);
        };
        if (only && std::ranges::any_of(row, isOther)) continue;
        std::ranges::fill(row, symbol);
        written[index] = symbol;
    }
    // The end of a leftover, which was taken for a part of the layout, is to be noticed as a change of it.
    if (!only) keyboard_.willWrite(first, written);
    xcb_change_keyboard_mapping(connection, count, first, reply->keysyms_per_keycode, all.data());
    return true;
}

void SpareKeyWriter::note(const SpareKeycodes& spares) const {
    std::vector<std::uint32_t> values;
    for (const auto& loan : spares.loans()) {
        if (loan.character == 0) continue;
        values.push_back(loan.keycode);
        values.push_back(symbolOf(loan.character));
    }
    auto& connection = connection_.connection();
    xcb_change_property(connection.get(), XCB_PROP_MODE_REPLACE, connection.root(), connection.atom(NoteProperty),
                        XCB_ATOM_CARDINAL, 32, static_cast<std::uint32_t>(values.size()), values.data());
}

}  // namespace plume
