// One application's row in a table of applications, as people write it.
#pragma once

#include <map>
#include <string>

#include "Foundation/json/JsonNode.h"
#include "input/delivery/ContextInputSetting.h"

namespace plume {

// Settings that rows are made from, by name.
using ApplicationFamilies = std::map<std::string, ContextInputSetting, std::less<>>;

// What the row leaves out is as in the family that it names, or, without one, as in `otherwise`. Throws JsonError.
ContextInputSetting readApplicationRow(const JsonNode& node, const ContextInputSetting& otherwise,
                                       const ApplicationFamilies& families);

}  // namespace plume
