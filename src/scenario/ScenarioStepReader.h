// The steps of a scenario file.
#pragma once

#include "Foundation/json/JsonNode.h"
#include "scenario/Scenario.h"

namespace plume {

// Hot keys are those of the settings. Throws JsonError for what is no step.
ScenarioStep readScenarioStep(const JsonNode& node, const UserDefaults& settings);

}  // namespace plume
