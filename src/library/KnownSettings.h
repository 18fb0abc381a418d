// Every setting that Plume knows: its name, what its value has to be, and what holds until the user says otherwise.
//
// Pure; from any thread.
#pragma once

#include <filesystem>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "Foundation/Result.h"
#include "Foundation/archive/PropertyList.h"
#include "Foundation/json/JsonNode.h"

namespace plume {

struct KnownSetting {
    std::string_view name;
    // The value as it is stored. Throws JsonError, which names the place and what was expected there.
    PropertyList (*read)(const JsonNode& node);
    std::optional<PropertyList> registered = std::nullopt;
};

// In the order in which they are shown.
const std::vector<KnownSetting>& knownSettings();
// Null when Plume knows none of that name.
const KnownSetting* findKnownSetting(std::string_view name);
// What a person wrote, as the value of this setting: JSON where it is that and fits, else a text as it is. The error
// names the setting and what was expected.
Result<PropertyList> settingFromText(const KnownSetting& setting, const std::string& text);
// What registerDefaults() is given. Without a folder for backups, none is registered.
PropertyList::Dictionary registeredSettings(const std::filesystem::path& backupFolder = {});

}  // namespace plume
