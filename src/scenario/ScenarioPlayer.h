// Plays a scenario.
#pragma once

#include "Foundation/Result.h"
#include "scenario/Scenario.h"
#include "scenario/ScenarioOutcome.h"

namespace plume {

// On a desktop of its own. The error names the scenario and the step that could not be taken.
Result<ScenarioOutcome> playScenario(const Scenario& scenario);

}  // namespace plume
