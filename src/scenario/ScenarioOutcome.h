// What can be seen when a run is over, and how it differs from what the scenario expects.
#pragma once

#include <nlohmann/json.hpp>
#include <string>
#include <vector>

namespace plume {

class ScenarioRun;

struct ScenarioOutcome {
    // As documented for users: "text", "caret", …, "events".
    nlohmann::ordered_json outcome;
    // What Plume sent: "events", "backspaces", …
    nlohmann::ordered_json counts;
};

// Reads the clipboard, so it comes last.
ScenarioOutcome outcomeOf(ScenarioRun& run);

// Where the outcome is not what the scenario expects, one entry each: the place, and both sides.
std::vector<std::string> differences(const nlohmann::ordered_json& expect, const ScenarioOutcome& outcome);

}  // namespace plume
