// Plays a scenario, and says what came of it.
#pragma once

#include <nlohmann/json.hpp>
#include <string>
#include <vector>

#include "Foundation/Result.h"
#include "scenario/Scenario.h"

namespace plume {

struct ScenarioOutcome {
    // As documented for users: "text", "caret", …, "events".
    nlohmann::ordered_json outcome;
    // What Plume sent: "events", "backspaces", …
    nlohmann::ordered_json counts;
};

// The error names the step that could not be taken.
Result<ScenarioOutcome> playScenario(const Scenario& scenario);

// Where the outcome is not what the scenario expects, one entry each: the place, and both sides.
std::vector<std::string> differences(const nlohmann::ordered_json& expect, const ScenarioOutcome& outcome);

// Reads, plays and compares one scenario, for a command line.
struct ScenarioReport {
    std::string output;    // the outcome as JSON; empty when nothing was played
    std::string problems;  // what is wrong with the file, or the differences; empty when all is well
    int exitStatus = 0;    // 1: not what was expected; 2: nothing could be played
};
ScenarioReport simulate(std::string_view text, const std::string& fileName);

}  // namespace plume
