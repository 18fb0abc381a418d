#include <unicode/ucal.h>

#include <array>
#include <cstdio>
#include <memory>

#include "Foundation/json/JsonNode.h"
#include "app/HotKeyDispatch.h"
#include "library/LibraryFile.h"
#include "library/SettingsFile.h"
#include "scenario/Scenario.h"

namespace plume {

namespace {

constexpr std::int64_t LastKeyCode = 127;
constexpr double LongestWait = 24 * 60 * 60;

// ---- Settings of applications ----

struct NamedFlag {
    std::string_view name;
    InputFlag flag;
};

constexpr auto Flags = std::to_array<NamedFlag>({
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

InputFlag flag(const JsonNode& node) {
    const std::string name = toUtf8(node.string());
    std::string expected = "expected one of";
    for (const NamedFlag& named : Flags) {
        if (named.name == name) return named.flag;
        expected += " " + std::string(named.name);
    }
    node.fail(expected);
}

std::shared_ptr<const ContextInputSetting> readApplicationSetting(const JsonNode& node) {
    const JsonObject object = node.object({"flags", "pastingDelay", "afterPastingDelay", "blockLength"});
    auto setting = std::make_shared<ContextInputSetting>();
    object.whenSet("flags", [&](const JsonNode& n) {
        for (const JsonNode& element : n.elements()) setting->flags.set(flag(element));
    });
    object.whenSet("pastingDelay", [&](const JsonNode& n) { setting->pastingDelay = n.number(0, LongestWait); });
    object.whenSet("afterPastingDelay",
                   [&](const JsonNode& n) { setting->afterPastingDelay = n.number(0, LongestWait); });
    object.whenSet("blockLength", [&](const JsonNode& n) {
        constexpr std::int64_t longest = 1'000'000;
        setting->blockLength = static_cast<std::uint64_t>(n.integer(0, longest));
    });
    return setting;
}

// ---- Time and place ----

void requireTimeZone(const JsonNode& node, const std::u16string& name) {
    std::array<UChar, 128> canonical{};
    UBool isSystemId = 0;
    UErrorCode status = U_ZERO_ERROR;
    ucal_getCanonicalTimeZoneID(name.data(), static_cast<std::int32_t>(name.size()), canonical.data(),
                                static_cast<std::int32_t>(canonical.size()), &isSystemId, &status);
    if (U_FAILURE(status) || !isSystemId) node.fail("expected the name of a time zone, such as Europe/Berlin");
}

struct LocalTime {
    int year = 0;
    int month = 0;
    int day = 0;
    int hour = 0;
    int minute = 0;
    int second = 0;
};

std::optional<LocalTime> localTimeIn(const std::string& text) {
    constexpr std::string_view pattern = "dddd-dd-ddTdd:dd:dd";
    if (text.size() != pattern.size()) return std::nullopt;
    for (std::size_t i = 0; i < text.size(); ++i) {
        const bool digit = text[i] >= '0' && text[i] <= '9';
        if (pattern[i] == 'd' ? !digit : text[i] != pattern[i]) return std::nullopt;
    }
    const auto number = [&](std::size_t at, std::size_t length) { return std::stoi(text.substr(at, length)); };
    return LocalTime{number(0, 4), number(5, 2), number(8, 2), number(11, 2), number(14, 2), number(17, 2)};
}

Date readNow(const JsonNode& node, const std::string& timeZone) {
    const std::optional<LocalTime> local = localTimeIn(toUtf8(node.string()));
    const std::u16string zone = fromUtf8(timeZone);
    UErrorCode status = U_ZERO_ERROR;
    const std::unique_ptr<UCalendar, decltype(&ucal_close)> calendar(
        ucal_open(zone.empty() ? nullptr : zone.data(), static_cast<std::int32_t>(zone.size()), "en_US", UCAL_GREGORIAN,
                  &status),
        &ucal_close);
    if (local && U_SUCCESS(status)) {
        ucal_setAttribute(calendar.get(), UCAL_LENIENT, 0);
        ucal_clear(calendar.get());
        ucal_setDateTime(calendar.get(), local->year, local->month - 1, local->day, local->hour, local->minute,
                         local->second, &status);
        const UDate milliseconds = ucal_getMillis(calendar.get(), &status);
        if (U_SUCCESS(status)) return Date(std::chrono::milliseconds(static_cast<std::int64_t>(milliseconds)));
    }
    node.fail("expected a moment that the time zone has, such as 2026-01-31T10:00:00");
}

// ---- Steps ----

struct NamedModifier {
    std::string_view name;
    std::int32_t modifier;
};

constexpr auto Modifiers = std::to_array<NamedModifier>({
    {"shift", KeyModifier::Shift},
    {"control", KeyModifier::Control},
    {"option", KeyModifier::Option},
    {"command", KeyModifier::Command},
});

std::int32_t modifier(const JsonNode& node) {
    const std::string name = toUtf8(node.string());
    for (const NamedModifier& named : Modifiers) {
        if (named.name == name) return named.modifier;
    }
    node.fail("expected one of shift control option command");
}

std::uint16_t keyCode(const JsonNode& node) {
    return static_cast<std::uint16_t>(node.integer(0, LastKeyCode));
}

KeyStep readKeyStep(const JsonNode& node) {
    const JsonObject object = node.object({"key", "modifiers", "count"});
    KeyStep step;
    step.keyCode = keyCode(*object.find("key"));
    object.whenSet("modifiers", [&](const JsonNode& n) {
        for (const JsonNode& element : n.elements()) step.modifiers |= modifier(element);
    });
    object.whenSet("count", [&](const JsonNode& n) {
        constexpr std::int64_t most = 100'000;
        step.count = n.integer(0, most);
    });
    return step;
}

HotKeyStep readHotKeyStep(const JsonNode& node, const UserDefaults& settings) {
    const std::string name = toUtf8(node.string());
    for (const std::string_view known : HotKeyDispatch::settingNames()) {
        if (known != name) continue;
        const auto hotKey = HotKeyDispatch::hotKeyIn(settings, name);
        if (!hotKey) node.fail("expected a hot key that the settings give a value");
        return {*hotKey};
    }
    node.fail("expected the name of a hot-key setting, such as UndoHotKey");
}

FormStep readFormStep(const JsonNode& node) {
    const JsonObject object = node.object({"form", "optional", "accept"});
    FormStep step;
    object.whenSet("form", [&](const JsonNode& n) {
        for (const auto& [name, value] : n.members()) step.values.emplace_back(fromUtf8(name), value.string());
    });
    object.whenSet("optional", [&](const JsonNode& n) {
        for (const auto& [name, value] : n.members()) step.ticks.emplace_back(fromUtf8(name), value.boolean());
    });
    object.whenSet("accept", [&](const JsonNode& n) { step.accept = n.boolean(); });
    return step;
}

SelectStep readSelectStep(const JsonNode& node) {
    const JsonObject object = node.object({"start", "length"});
    SelectStep step;
    object.whenSet("start", [&](const JsonNode& n) { step.range.location = static_cast<std::size_t>(n.integer(0)); });
    object.whenSet("length", [&](const JsonNode& n) { step.range.length = static_cast<std::size_t>(n.integer(0)); });
    return step;
}

// Steps of one key alone.
ScenarioStep::Action readSimpleAction(const JsonNode& node, const UserDefaults& settings) {
    const JsonObject object = node.object({"type", "key", "modifiers", "count", "press", "release", "hotKey", "wait",
                                           "click", "activate", "form", "optional", "accept", "select", "choose"});
    if (node.value().size() != 1) node.fail("expected an object that says one thing to do");
    if (const auto n = object.find("type")) return TypeStep{n->string()};
    if (const auto n = object.find("press")) return PressStep{keyCode(*n)};
    if (const auto n = object.find("release")) return ReleaseStep{keyCode(*n)};
    if (const auto n = object.find("hotKey")) return readHotKeyStep(*n, settings);
    if (const auto n = object.find("wait")) return WaitStep{n->number(0, LongestWait)};
    if (const auto n = object.find("activate")) return ActivateStep{n->string()};
    if (const auto n = object.find("select")) return readSelectStep(*n);
    if (const auto n = object.find("choose")) return ChooseStep{static_cast<std::size_t>(n->integer(0))};
    if (const auto n = object.find("click")) {
        if (!n->boolean()) n->fail("expected true");
        return ClickStep{};
    }
    node.fail("expected an object that says one thing to do");
}

ScenarioStep readStep(const JsonNode& node, std::size_t index, const UserDefaults& settings) {
    const std::string place = "$.steps[" + std::to_string(index) + "]";
    const auto& value = node.value();
    if (value.contains("key")) return {readKeyStep(node), place};
    if (value.contains("form") || value.contains("optional") || value.contains("accept")) {
        return {readFormStep(node), place};
    }
    return {readSimpleAction(node, settings), place};
}

// ---- The whole ----

void readExpectation(const JsonNode& node, Scenario& scenario) {
    const JsonObject object = node.object({"text", "caret", "clipboard", "letters", "application", "sounds",
                                           "suggestions", "form", "errors", "events", "counts"});
    for (const char* key : {"text", "letters", "application"}) {
        if (const auto n = object.find(key)) n->string();
    }
    for (const char* key : {"sounds", "errors"}) {
        if (const auto n = object.find(key)) n->strings();
    }
    if (const auto n = object.find("caret")) n->integer(0);
    if (const auto n = object.find("events")) n->elements();
    object.whenSet("clipboard", [](const JsonNode& n) { n.string(); });
    object.whenSet("suggestions", [](const JsonNode& n) { n.strings(); });
    object.whenSet("form", [](const JsonNode& n) { n.elements(); });
    if (const auto n = object.find("counts")) {
        n->object({"events", "backspaces", "pastes", "leftArrows", "chunks"});
        for (const auto& [name, count] : n->members()) count.integer(0);
    }
    scenario.expect = node.value();
}

void readSetting(const JsonObject& object, Scenario& scenario) {
    object.whenSet("application", [&](const JsonNode& n) { scenario.application = n.string(); });
    object.whenSet("inputSource", [&](const JsonNode& n) { scenario.inputSource = n.string(); });
    object.whenSet("applicationSettings", [&](const JsonNode& n) {
        for (const auto& [name, setting] : n.members()) {
            scenario.applicationSettings[fromUtf8(name)] = readApplicationSetting(setting);
        }
    });
    object.whenSet("timeZone", [&](const JsonNode& n) {
        requireTimeZone(n, n.string());
        scenario.timeZone = toUtf8(n.string());
    });
    object.whenSet("locale", [&](const JsonNode& n) { scenario.locale = toUtf8(n.string()); });
    object.whenSet("now", [&](const JsonNode& n) { scenario.now = readNow(n, scenario.timeZone); });
    object.whenSet("clipboard", [&](const JsonNode& n) { scenario.clipboard = n.string(); });
    object.whenSet("text", [&](const JsonNode& n) { scenario.text = n.string(); });
}

Scenario readFrom(const JsonNode& node, const std::string& fileName) {
    const JsonObject object =
        node.object({"about", "library", "settings", "application", "inputSource", "applicationSettings", "now",
                     "timeZone", "locale", "clipboard", "text", "steps", "expect"});
    Scenario scenario;
    scenario.fileName = fileName;
    scenario.settings = SettingsFile::registeredDefaults();
    object.whenSet("about", [&](const JsonNode& n) { scenario.about = toUtf8(n.string()); });
    object.whenSet("library", [&](const JsonNode& n) { scenario.library = LibraryFile::readFrom(n); });
    object.whenSet("settings", [&](const JsonNode& n) { scenario.settings = SettingsFile::readFrom(n); });
    readSetting(object, scenario);
    object.whenSet("steps", [&](const JsonNode& n) {
        for (const JsonNode& element : n.elements()) {
            scenario.steps.push_back(readStep(element, scenario.steps.size(), *scenario.settings));
        }
    });
    object.whenSet("expect", [&](const JsonNode& n) { readExpectation(n, scenario); });
    return scenario;
}

}  // namespace

Result<Scenario> readScenario(std::string_view text, const std::string& fileName) {
    return readingJson([&] { return readFrom(JsonNode::parse(text, fileName), fileName); });
}

}  // namespace plume
