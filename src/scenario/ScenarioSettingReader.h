// The parts of a scenario file that say what is there before the first step.
#pragma once

#include <memory>
#include <string>

#include "Foundation/Date.h"
#include "Foundation/json/JsonNode.h"
#include "input/delivery/ContextInputSetting.h"

namespace plume {

// Each throws JsonError for a value that is none.
std::shared_ptr<const ContextInputSetting> readApplicationSetting(const JsonNode& node);
std::string readTimeZone(const JsonNode& node);
// An empty time zone is the system's.
Date readNow(const JsonNode& node, const std::string& timeZone);

}  // namespace plume
