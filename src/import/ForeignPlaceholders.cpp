#include "import/ForeignPlaceholders.h"

#include <algorithm>
#include <array>
#include <utility>

#include "Foundation/KeyCode.h"
#include "Foundation/Strings.h"
#include "content/PlaceholderBody.h"

namespace plume {

namespace {

std::u16string withoutMarkers(std::u16string_view text) {
    std::u16string result(text);
    std::erase_if(result, [](char16_t unit) { return unit == OpeningMarker || unit == ClosingMarker; });
    return result;
}

std::u16string enclosed(BodyWriter& writer) {
    return OpeningMarker + withoutMarkers(writer.take()) + ClosingMarker;
}

struct NamedKey {
    std::string_view name;
    KeyCode code;
    std::u16string_view label;
};

constexpr std::array<NamedKey, 34> NamedKeys = {{
    {"enter", KeyCode::Return, u"\u21a9"},
    {"return", KeyCode::Return, u"\u21a9"},
    {"tab", KeyCode::Tab, u"\u21e5"},
    {"escape", KeyCode::Escape, u"\u238b"},
    {"esc", KeyCode::Escape, u"\u238b"},
    {"backspace", KeyCode::Delete, u"\u232b"},
    {"delete", KeyCode::ForwardDelete, u"\u2326"},
    {"insert", KeyCode::Help, u"Insert"},
    {"home", KeyCode::Home, u"\u2196"},
    {"end", KeyCode::End, u"\u2198"},
    {"page_up", KeyCode::PageUp, u"\u21de"},
    {"page_down", KeyCode::PageDown, u"\u21df"},
    {"pageup", KeyCode::PageUp, u"\u21de"},
    {"pagedown", KeyCode::PageDown, u"\u21df"},
    {"left", KeyCode::Left, u"\u25c0"},
    {"right", KeyCode::Right, u"\u25b6"},
    {"up", KeyCode::Up, u"\u25b2"},
    {"down", KeyCode::Down, u"\u25bc"},
    {"space", KeyCode::Space, u"Space"},
    {"f1", KeyCode::F1, u"F1"},
    {"f2", KeyCode::F2, u"F2"},
    {"f3", KeyCode::F3, u"F3"},
    {"f4", KeyCode::F4, u"F4"},
    {"f5", KeyCode::F5, u"F5"},
    {"f6", KeyCode::F6, u"F6"},
    {"f7", KeyCode::F7, u"F7"},
    {"f8", KeyCode::F8, u"F8"},
    {"f9", KeyCode::F9, u"F9"},
    {"f10", KeyCode::F10, u"F10"},
    {"f11", KeyCode::F11, u"F11"},
    {"f12", KeyCode::F12, u"F12"},
    {"np_enter", KeyCode::KeypadEnter, u"\u2324"},
    {"menu", KeyCode::Menu, u"Menu"},
    {"print_screen", KeyCode::F13, u"F13"},
}};

// The codes of "a" to "z" and of "0" to "9".
constexpr std::array<KeyCode, 26> Letters = {
    KeyCode::A, KeyCode::B, KeyCode::C, KeyCode::D, KeyCode::E, KeyCode::F, KeyCode::G, KeyCode::H, KeyCode::I,
    KeyCode::J, KeyCode::K, KeyCode::L, KeyCode::M, KeyCode::N, KeyCode::O, KeyCode::P, KeyCode::Q, KeyCode::R,
    KeyCode::S, KeyCode::T, KeyCode::U, KeyCode::V, KeyCode::W, KeyCode::X, KeyCode::Y, KeyCode::Z};
constexpr std::array<KeyCode, 10> Digits = {KeyCode::Digit0, KeyCode::Digit1, KeyCode::Digit2, KeyCode::Digit3,
                                            KeyCode::Digit4, KeyCode::Digit5, KeyCode::Digit6, KeyCode::Digit7,
                                            KeyCode::Digit8, KeyCode::Digit9};

std::optional<std::pair<KeyCode, std::u16string>> keyNamed(const std::string& name) {
    const auto found =
        std::find_if(NamedKeys.begin(), NamedKeys.end(), [&](const NamedKey& k) { return k.name == name; });
    if (found != NamedKeys.end()) return std::pair(found->code, std::u16string(found->label));
    if (name.size() != 1) return std::nullopt;
    const char c = name.front();
    if (c >= 'a' && c <= 'z') return std::pair(Letters.at(static_cast<std::size_t>(c - 'a')), fromUtf8(name));
    if (c >= '0' && c <= '9') return std::pair(Digits.at(static_cast<std::size_t>(c - '0')), fromUtf8(name));
    return std::nullopt;
}

}  // namespace

std::u16string fieldPlaceholder(const ForeignField& field) {
    BodyWriter body;
    body.param(u"field", field.name);
    std::u16string value = field.initial;
    std::int64_t first = 0;
    if (!field.choices.empty()) {
        body.part(u"type:2");
        value.clear();
        for (std::u16string choice : field.choices) {
            if (choice == field.initial) first = std::count(value.begin(), value.end(), u'\n');
            std::replace(choice.begin(), choice.end(), u'\n', u' ');
            value += choice + u'\n';
        }
        value.pop_back();
    } else if (field.isMultiline) {
        body.part(u"type:1");
    }
    if (!value.empty()) body.param(u"value", value);
    body.paramUnlessZero(u"defaultIndex", first);
    return enclosed(body);
}

std::u16string snippetPlaceholder(std::u16string_view abbreviation, std::u16string_view uuid) {
    BodyWriter body;
    body.param(u"snippet", abbreviation);
    if (!uuid.empty()) body.param(u"uuid", uuid);
    return enclosed(body);
}

std::optional<std::u16string> keyPlaceholder(std::string_view name, std::uint64_t modifiers, std::int64_t count) {
    const auto key = keyNamed(toUtf8(lowercased(fromUtf8(name))));
    if (!key) return std::nullopt;
    BodyWriter body;
    body.param(u"key", key->second);
    body.param(u"code", numberOf(key->first));
    if (modifiers != 0) body.unsignedParam(u"modifiers", modifiers);
    if (count > 1) body.param(u"count", count);
    return enclosed(body);
}

bool holdsMarker(std::u16string_view text) {
    return text.find(OpeningMarker) != std::u16string_view::npos;
}

}  // namespace plume
