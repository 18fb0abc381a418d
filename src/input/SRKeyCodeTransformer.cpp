#include "input/SRKeyCodeTransformer.h"

#include <algorithm>
#include <cstddef>
#include <iterator>
#include <utility>

#include "Foundation/KeyCode.h"
#include "Foundation/KeyModifiers.h"
#include "Foundation/Strings.h"

namespace plume {

namespace {

struct SpecialKey {
    KeyCode keyCode;
    std::u16string_view name;
};

constexpr SpecialKey SpecialKeys[] = {
    {KeyCode::Delete, u"\u232B"},
    {KeyCode::ForwardDelete, u"\u2326"},
    {KeyCode::KeypadClear, u"\u2327"},
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
    {KeyCode::Help, u"?"},
    {KeyCode::F1, u"F1"},
    {KeyCode::F2, u"F2"},
    {KeyCode::F3, u"F3"},
    {KeyCode::F4, u"F4"},
    {KeyCode::F5, u"F5"},
    {KeyCode::F6, u"F6"},
    {KeyCode::F7, u"F7"},
    {KeyCode::F8, u"F8"},
    {KeyCode::F9, u"F9"},
    {KeyCode::F10, u"F10"},
    {KeyCode::F11, u"F11"},
    {KeyCode::F12, u"F12"},
    {KeyCode::F13, u"F13"},
    {KeyCode::F14, u"F14"},
    {KeyCode::F15, u"F15"},
    {KeyCode::F16, u"F16"},
    {KeyCode::F17, u"F17"},
    {KeyCode::F18, u"F18"},
    {KeyCode::F19, u"F19"},
};

constexpr KeyCode KeypadKeys[] = {
    KeyCode::KeypadDecimal, KeyCode::KeypadMultiply, KeyCode::KeypadPlus, KeyCode::KeypadDivide,
    KeyCode::KeypadMinus,   KeyCode::KeypadEqual,    KeyCode::Keypad0,    KeyCode::Keypad1,
    KeyCode::Keypad2,       KeyCode::Keypad3,        KeyCode::Keypad4,    KeyCode::Keypad5,
    KeyCode::Keypad6,       KeyCode::Keypad7,        KeyCode::Keypad8,    KeyCode::Keypad9};

constexpr std::uint16_t KeyCodeCount = 128;

}  // namespace

SRKeyCodeTransformer::SRKeyCodeTransformer(const InputSources& inputSources, KeyNameTexts texts)
    : inputSources_(inputSources), texts_(std::move(texts)) {
    regenerateStringToKeyCodeMapping();
}

std::optional<std::u16string> SRKeyCodeTransformer::transformedValue(KeyCode keyCode) const {
    constexpr std::uint16_t Last = 0x7FFF;
    if (numberOf(keyCode) > Last) return std::nullopt;
    if (keyCode == KeyCode::Space) return texts_.space;
    const auto* const special = std::find_if(std::begin(SpecialKeys), std::end(SpecialKeys),
                                             [&](const SpecialKey& key) { return key.keyCode == keyCode; });
    if (special != std::end(SpecialKeys)) return std::u16string(special->name);

    const auto typed = inputSources_.translateKey(keyCode, {});
    if (!typed || typed->empty()) return std::nullopt;
    std::u16string name = uppercased(std::u16string_view(*typed).substr(0, 1));
    if (std::find(std::begin(KeypadKeys), std::end(KeypadKeys), keyCode) == std::end(KeypadKeys)) return name;
    std::u16string keypadName = texts_.keypad;
    const std::size_t place = keypadName.find(u"%@");
    return place == std::u16string::npos ? keypadName : keypadName.replace(place, 2, name);
}

std::optional<KeyCode> SRKeyCodeTransformer::reverseTransformedValue(std::u16string_view name) const {
    const auto found = keyCodes_.find(name);
    return found == keyCodes_.end() ? std::nullopt : std::optional(found->second);
}

KeyCode SRKeyCodeTransformer::keyCodeForString(std::u16string_view name) const {
    return reverseTransformedValue(name).value_or(KeyCode::None);
}

void SRKeyCodeTransformer::regenerateStringToKeyCodeMapping() {
    keyCodes_.clear();
    for (std::uint16_t code = 0; code < KeyCodeCount; ++code) {
        auto name = transformedValue(KeyCode{code});
        if (name && !name->empty()) keyCodes_.insert_or_assign(std::move(*name), KeyCode{code});
    }
}

}  // namespace plume
