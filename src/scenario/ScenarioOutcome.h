// What is to be seen on a stage when its scenario is over.
#pragma once

#include "scenario/ScenarioPlayer.h"

namespace plume {

class ScenarioStage;

// Reads the clipboard, so it comes last.
ScenarioOutcome outcomeOf(ScenarioStage& stage);

}  // namespace plume
