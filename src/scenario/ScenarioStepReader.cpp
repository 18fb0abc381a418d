#include "scenario/ScenarioStepReader.h"

#include <array>
#include <string_view>

#include "app/HotKeyDispatch.h"

namespace plume {

namespace {

constexpr std::int64_t LastKeyCode = 127;
constexpr double LongestWait = 24 * 60 * 60;  // seconds

struct NamedModifier {
    std::string_view name;
    KeyModifier modifier;
};

constexpr auto Modifiers = std::to_array<NamedModifier>({
    {"shift", KeyModifier::Shift},
    {"control", KeyModifier::Control},
    {"option", KeyModifier::Option},
    {"command", KeyModifier::Command},
});

KeyModifier modifier(const JsonNode& node) {
    const std::string name = toUtf8(node.string());
    for (const NamedModifier& named : Modifiers) {
        if (named.name == name) return named.modifier;
    }
    node.fail("expected one of shift control option command");
}

KeyCode keyCode(const JsonNode& node) {
    return KeyCode{static_cast<std::uint16_t>(node.integer(0, LastKeyCode))};
}

KeyStep readKeyStep(const JsonNode& node) {
    const JsonObject object = node.object({"key", "modifiers", "count"});
    KeyStep step;
    step.keyCode = keyCode(*object.find("key"));
    object.whenSet("modifiers", [&](const JsonNode& n) {
        for (const JsonNode& element : n.elements()) step.modifiers |= modifier(element);
    });
    object.whenSet("count", [&](const JsonNode& n) {
        constexpr std::int64_t Most = 100'000;
        step.count = n.integer(0, Most);
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

}  // namespace

ScenarioStep readScenarioStep(const JsonNode& node, const UserDefaults& settings) {
    const auto& value = node.value();
    if (value.contains("key")) return {readKeyStep(node), node.path()};
    if (value.contains("form") || value.contains("optional") || value.contains("accept")) {
        return {readFormStep(node), node.path()};
    }
    return {readSimpleAction(node, settings), node.path()};
}

}  // namespace plume
