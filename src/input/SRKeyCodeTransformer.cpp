#include "input/SRKeyCodeTransformer.h"

#include <algorithm>
#include <cstddef>
#include <iterator>
#include <utility>

#include "Foundation/Strings.h"
#include "input/KeyCodes.h"

namespace plume {

namespace {

struct SpecialKey {
    std::uint16_t keyCode;
    std::u16string_view name;
};

constexpr SpecialKey SpecialKeys[] = {
    {KeyCode::Delete, u"\u232B"},
    {KeyCode::ForwardDelete, u"\u2326"},
    {71, u"\u2327"},  // Clear
    {KeyCode::Left, u"\u2190"},
    {KeyCode::Right, u"\u2192"},
    {KeyCode::Up, u"\u2191"},
    {KeyCode::Down, u"\u2193"},
    {KeyCode::End, u"\u2198"},
    {KeyCode::Home, u"\u2196"},
    {KeyCode::Escape, u"\u238B"},
    {KeyCode::PageDown, u"\u21DF"},
    {KeyCode::PageUp, u"\u21DE"},
    {KeyCode::Return, u"\u21A9"},
    {KeyCode::KeypadEnter, u"\u2305"},
    {KeyCode::Tab, u"\u21E5"},
    {114, u"?"},  // Help
    {122, u"F1"},
    {120, u"F2"},
    {99, u"F3"},
    {118, u"F4"},
    {96, u"F5"},
    {97, u"F6"},
    {98, u"F7"},
    {100, u"F8"},
    {101, u"F9"},
    {109, u"F10"},
    {103, u"F11"},
    {111, u"F12"},
    {105, u"F13"},
    {107, u"F14"},
    {113, u"F15"},
    {106, u"F16"},
    {64, u"F17"},
    {79, u"F18"},
    {80, u"F19"},
};

constexpr std::uint16_t KeypadKeys[] = {65, 67, 69, 75, 78, 81, 82, 83, 84, 85, 86, 87, 88, 89, 91, 92};

constexpr std::uint16_t KeyCodeCount = 128;

}  // namespace

SRKeyCodeTransformer::SRKeyCodeTransformer(const InputSources& inputSources, KeyNameTexts texts)
    : inputSources_(inputSources), texts_(std::move(texts)) {
    regenerateStringToKeyCodeMapping();
}

std::optional<std::u16string> SRKeyCodeTransformer::transformedValue(std::int64_t keyCode) const {
    if (static_cast<std::int16_t>(keyCode) < 0) return std::nullopt;
    const auto code = static_cast<std::uint16_t>(keyCode);
    if (code == KeyCode::Space) return texts_.space;
    const auto* const special = std::find_if(std::begin(SpecialKeys), std::end(SpecialKeys),
                                             [&](const SpecialKey& key) { return key.keyCode == code; });
    if (special != std::end(SpecialKeys)) return std::u16string(special->name);

    const auto typed = inputSources_.translateKey(code, 0);
    if (!typed || typed->empty()) return std::nullopt;
    std::u16string name = uppercased(std::u16string_view(*typed).substr(0, 1));
    if (std::find(std::begin(KeypadKeys), std::end(KeypadKeys), code) == std::end(KeypadKeys)) return name;
    std::u16string keypadName = texts_.keypad;
    const std::size_t place = keypadName.find(u"%@");
    return place == std::u16string::npos ? keypadName : keypadName.replace(place, 2, name);
}

std::optional<std::uint16_t> SRKeyCodeTransformer::reverseTransformedValue(std::u16string_view name) const {
    const auto found = keyCodes_.find(name);
    return found == keyCodes_.end() ? std::nullopt : std::optional(found->second);
}

std::uint16_t SRKeyCodeTransformer::keyCodeForString(std::u16string_view name) const {
    return reverseTransformedValue(name).value_or(KeyCode::None);
}

void SRKeyCodeTransformer::regenerateStringToKeyCodeMapping() {
    keyCodes_.clear();
    for (std::uint16_t code = 0; code < KeyCodeCount; ++code) {
        auto name = transformedValue(code);
        if (name && !name->empty()) keyCodes_.insert_or_assign(std::move(*name), code);
    }
}

}  // namespace plume
