// Values of settings as JSON, for people and their files.
//
// Pure; from any thread.
#pragma once

#include <optional>
#include <string>
#include <string_view>

#include "Foundation/Date.h"
#include "Foundation/archive/PropertyList.h"
#include "Foundation/json/JsonNode.h"

namespace plume {

// Booleans, numbers, strings, lists and objects of them. Throws JsonError for what a setting cannot hold.
PropertyList settingFromJson(const JsonNode& node);
// A date is a string like "2026-01-31T18:30:00Z"; of raw bytes only the number is told.
nlohmann::ordered_json settingAsJson(const PropertyList& value);

// Nothing for a text that is no such date.
std::optional<Date> dateFromText(std::string_view text);

}  // namespace plume
