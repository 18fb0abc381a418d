#include "input/delivery/ApplicationRow.h"

#include <algorithm>
#include <array>
#include <optional>
#include <string_view>

#include "Foundation/Strings.h"

namespace plume {

namespace {

constexpr double LongestDelay = 24 * 60 * 60;  // seconds
constexpr std::int64_t LongestText = 1'000'000'000;

template <typename Value>
struct Named {
    std::string_view name;
    Value value;
};

constexpr auto FlagNames = std::to_array<Named<InputFlag>>({
    {"disableCapitalization", InputFlag::DisableCapitalization},
    {"useClipboard", InputFlag::UseClipboard},
    {"useClipboardIfHasNewLine", InputFlag::UseClipboardIfHasNewLine},
    {"doNotRestoreClipboard", InputFlag::DoNotRestoreClipboard},
    {"alternativePasting", InputFlag::AlternativePasting},
    {"useVMHelper", InputFlag::UseVMHelper},
    {"clickAtVMHelper", InputFlag::ClickAtVMHelper},
    {"clickAtVM", InputFlag::ClickAtVM},
    {"deleteAfterActivateVM", InputFlag::DeleteAfterActivateVM},
    {"reactivate", InputFlag::Reactivate},
    {"doNotSetModifier", InputFlag::DoNotSetModifier},
    {"delayPasting", InputFlag::DelayPasting},
    {"postToSessionEventTap", InputFlag::PostToSessionEventTap},
    {"useControlKey", InputFlag::UseControlKey},
    {"includeHTMLData", InputFlag::IncludeHTMLData},
    {"excludeParagraphTag", InputFlag::ExcludeParagraphTag},
});

constexpr auto ModifierNames = std::to_array<Named<EventFlag>>({
    {"Control+", EventFlag::Control},
    {"Shift+", EventFlag::Shift},
    {"Alt+", EventFlag::Option},
    {"Super+", EventFlag::Command},
});

constexpr auto KeyNames = std::to_array<Named<KeyCode>>({
    {"Insert", KeyCode::Help},
    {"Delete", KeyCode::ForwardDelete},
    {"Escape", KeyCode::Escape},
    {"Return", KeyCode::Return},
    {"Tab", KeyCode::Tab},
});

constexpr auto ErasedNames = std::to_array<Named<ErasedAtOnce>>({
    {"character", ErasedAtOnce::Character},
    {"emojiPart", ErasedAtOnce::EmojiPart},
    {"emoji", ErasedAtOnce::Emoji},
    {"letter", ErasedAtOnce::Letter},
});

template <typename Names>
auto oneOf(const Names& names, const JsonNode& node) {
    const std::string name = toUtf8(node.string());
    std::string expected = "expected one of";
    for (const auto& named : names) {
        if (named.name == name) return named.value;
        expected += " " + std::string(named.name);
    }
    node.fail(expected);
}

InputFlags flags(const JsonNode& node) {
    InputFlags all;
    for (const JsonNode& element : node.elements()) all |= oneOf(FlagNames, element);
    return all;
}

EventFlags takeModifiers(std::string_view& name) {
    EventFlags modifiers;
    const auto isNext = [&](const Named<EventFlag>& modifier) { return name.starts_with(modifier.name); };
    for (;;) {
        const auto* const modifier = std::ranges::find_if(ModifierNames, isNext);
        if (modifier == ModifierNames.end()) return modifiers;
        modifiers |= modifier->value;
        name.remove_prefix(modifier->name.size());
    }
}

// "Control+Shift+V", "Shift+Insert", or a character to type.
Keystroke keystroke(const JsonNode& node) {
    const std::string text = toUtf8(node.string());
    std::string_view name = text;
    Keystroke stroke;
    stroke.flags = takeModifiers(name);
    for (const Named<KeyCode>& named : KeyNames) {
        if (named.name == name) stroke.keyCode = named.value;
    }
    if (stroke.keyCode != KeyCode::None) return stroke;
    if (name.size() != 1 || name.front() <= ' ' || name.front() > '~') {
        node.fail(
            "expected a key such as \"Control+V\": any of Control, Shift, Alt and Super, and one ASCII character or "
            "Insert, Delete, Escape, Return or Tab");
    }
    const bool isCapital = !stroke.flags.isEmpty() && name.front() >= 'A' && name.front() <= 'Z';
    stroke.letter = static_cast<char16_t>(isCapital ? name.front() - 'A' + 'a' : name.front());
    return stroke;
}

Keystrokes keystrokes(const JsonNode& node) {
    Keystrokes keys;
    if (node.isString()) {
        if (node.string() != u"none") node.fail("expected a list of keys, or \"none\"");
        return keys;
    }
    for (const JsonNode& element : node.elements()) keys.push_back(keystroke(element));
    if (keys.empty()) node.fail("expected at least one key, or \"none\" in place of the list");
    return keys;
}

const ContextInputSetting& family(const JsonNode& node, const ApplicationFamilies& families) {
    const auto found = families.find(toUtf8(node.string()));
    if (found != families.end()) return found->second;
    std::string expected = families.empty() ? "expected none: there are no families here" : "expected one of";
    for (const auto& [name, setting] : families) expected += " " + name;
    node.fail(expected);
}

std::uint64_t length(const JsonNode& node) {
    return static_cast<std::uint64_t>(node.integer(0, LongestText));
}

}  // namespace

ContextInputSetting readApplicationRow(const JsonNode& node, const ContextInputSetting& otherwise,
                                       const ApplicationFamilies& families) {
    const JsonObject row =
        node.object({"about", "family", "flags", "pasteKeys", "copyKeys", "pastesPrimary", "pastingDelay",
                     "afterPastingDelay", "afterErasingDelay", "overtypesCompletion", "losesRepeatedKeys",
                     "typesBeyondBmp", "erasesAtOnce", "longestTyped", "blockLength"});
    ContextInputSetting setting = otherwise;
    const auto set = [&](std::string_view key, auto& field, auto read) {
        row.whenSet(key, [&](const JsonNode& value) { field = read(value); });
    };
    const auto delay = [](const JsonNode& value) { return value.number(0, LongestDelay); };
    const auto isSo = [](const JsonNode& value) { return value.boolean(); };
    row.whenSet("about", [](const JsonNode& value) { value.string(); });
    set("family", setting, [&](const JsonNode& value) { return family(value, families); });
    set("flags", setting.flags, flags);
    set("pasteKeys", setting.pasteKeys, keystrokes);
    set("copyKeys", setting.copyKeys, keystrokes);
    set("pastesPrimary", setting.pastesPrimary, isSo);
    set("pastingDelay", setting.pastingDelay, delay);
    set("afterPastingDelay", setting.afterPastingDelay, delay);
    set("afterErasingDelay", setting.afterErasingDelay, delay);
    set("overtypesCompletion", setting.overtypesCompletion, isSo);
    set("losesRepeatedKeys", setting.losesRepeatedKeys, isSo);
    set("typesBeyondBmp", setting.typesBeyondBmp, isSo);
    set("erasesAtOnce", setting.erasesAtOnce, [](const JsonNode& value) { return oneOf(ErasedNames, value); });
    set("longestTyped", setting.longestTyped, length);
    set("blockLength", setting.blockLength, length);
    return setting;
}

}  // namespace plume
