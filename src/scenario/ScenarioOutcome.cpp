#include "scenario/ScenarioOutcome.h"

#include <cmath>

#include "Foundation/KeyCode.h"
#include "Foundation/KeyModifiers.h"
#include "Foundation/Strings.h"
#include "ports/simulated/SimulatedModifiers.h"
#include "scenario/ScenarioRun.h"

namespace plume {

namespace {

using Json = nlohmann::ordered_json;

// Times are written and compared to the microsecond: sums of delays are not exact beyond it.
constexpr double Microseconds = 1e6;

Json textOrNull(const std::optional<std::u16string>& text) {
    return text ? Json(toUtf8(*text)) : Json();
}

Json modifierNames(EventFlags flags) {
    Json names = Json::array();
    if (flags.contains(EventFlag::Shift)) names.push_back("shift");
    if (flags.contains(EventFlag::Control)) names.push_back("control");
    if (flags.contains(EventFlag::Option)) names.push_back("option");
    if (flags.contains(EventFlag::Command)) names.push_back("command");
    return names;
}

Json written(const SimulatedKeyEvent& event) {
    Json json;
    json["time"] = std::round(event.time * Microseconds) / Microseconds;
    json["origin"] = event.origin == SimulatedKeyEvent::Origin::User ? "user" : "plume";
    if (event.keyCode) {
        json["key"] = numberOf(*event.keyCode);
        json["down"] = event.down;
        json["modifiers"] = modifierNames(event.flags);
    } else {
        json["string"] = toUtf8(event.string);
        json["down"] = event.down;
    }
    return json;
}

Json written(const FormModel& form) {
    Json fields = Json::array();
    for (const FormModel::Field& field : form.fields()) {
        fields.push_back({{"name", textOrNull(field.variable->name)},
                          {"type", static_cast<std::int64_t>(field.variable->type)},
                          {"value", toUtf8(field.value)},
                          {"optional", field.variable->isOptional},
                          {"selected", field.selected},
                          {"readonly", field.isReadonly()}});
    }
    return fields;
}

Json suggestions(const ScenarioList& list) {
    if (!list.visible) return {};
    Json entries = Json::array();
    for (const std::u16string& entry : list.entries) entries.push_back(toUtf8(entry));
    return entries;
}

struct Counts {
    std::int64_t events = 0;
    std::int64_t backspaces = 0;
    std::int64_t pastes = 0;
    std::int64_t leftArrows = 0;
    std::int64_t chunks = 0;

    void add(const std::vector<SimulatedKeyEvent>& received) {
        EventFlags held;  // modifiers that Plume pressed as keys
        for (const SimulatedKeyEvent& event : received) {
            if (event.origin != SimulatedKeyEvent::Origin::Plume) continue;
            const EventFlags modifier = event.keyCode ? modifierFlagOf(*event.keyCode) : EventFlags();
            held = event.down ? held | modifier : held - modifier;
            if (event.down) add(event, event.flags | held);
        }
    }
    void add(const SimulatedKeyEvent& press, EventFlags flags) {
        ++events;
        if (!press.keyCode) ++chunks;
        if (press.keyCode == KeyCode::Delete) ++backspaces;
        if (press.keyCode == KeyCode::Left) ++leftArrows;
        if (press.keyCode == KeyCode::V && flags.containsAny(EventFlag::Control | EventFlag::Command)) ++pastes;
    }
};

// Of objects only the keys that are expected count, everything else is compared as a whole.
void compare(const Json& expected, const Json& actual, const std::string& place, std::vector<std::string>& found) {
    if (expected.is_object() && actual.is_object()) {
        for (const auto& [key, value] : expected.items()) {
            std::string member = place;
            member.append(".").append(key);
            compare(value, actual.contains(key) ? actual.at(key) : Json(), member, found);
        }
        return;
    }
    if (expected.is_array() && actual.is_array() && expected.size() == actual.size()) {
        for (std::size_t i = 0; i < expected.size(); ++i) {
            std::string element = place;
            element.append("[").append(std::to_string(i)).append("]");
            compare(expected[i], actual[i], element, found);
        }
        return;
    }
    if (expected.is_number() && actual.is_number()) {
        if (std::abs(expected.get<double>() - actual.get<double>()) * Microseconds < 1) return;
    } else if (expected == actual) {
        return;
    }
    found.push_back(place + ": expected " + expected.dump() + ", got " + actual.dump());
}

}  // namespace

ScenarioOutcome outcomeOf(ScenarioRun& run) {
    SimulatedDesktop& desktop = run.desktop();
    const SimulatedApplication* front = desktop.front();
    Json json;
    json["text"] = front ? toUtf8(front->field().text()) : "";
    json["caret"] = front ? front->field().caret() : 0;
    json["clipboard"] = textOrNull(desktop.pasteboard().string());
    json["letters"] = toUtf8(run.program().engine().letters());
    json["application"] = front ? toUtf8(front->bundleIdentifier()) : "";
    json["sounds"] = desktop.sounds().played();
    json["suggestions"] = suggestions(run.list());
    const auto& forms = run.forms().open;
    json["form"] = forms.empty() ? Json() : written(*forms.back().model);
    json["errors"] = run.errors();
    json["events"] = Json::array();
    if (front) {
        for (const SimulatedKeyEvent& event : front->events()) json["events"].push_back(written(event));
    }

    Counts counts;
    for (const SimulatedApplication* application : run.applications()) counts.add(application->events());
    return {std::move(json), Json{{"events", counts.events},
                                  {"backspaces", counts.backspaces},
                                  {"pastes", counts.pastes},
                                  {"leftArrows", counts.leftArrows},
                                  {"chunks", counts.chunks}}};
}

std::vector<std::string> differences(const Json& expect, const ScenarioOutcome& outcome) {
    std::vector<std::string> found;
    for (const auto& [key, value] : expect.items()) {
        compare(value, key == "counts" ? outcome.counts : outcome.outcome.at(key), key, found);
    }
    return found;
}

}  // namespace plume
