// Shows and changes the user's settings in the store.
#pragma once

#include <filesystem>
#include <iosfwd>
#include <optional>
#include <string>

namespace plume {

struct SettingsRequest {
    std::optional<std::string> key;    // without one, all settings are shown
    std::optional<std::string> value;  // JSON, or a text as it is
    bool toDefault = false;            // the user's own value goes
};

// Works with the store in this folder, which is made when it is not there; a Plume that runs notices what has changed.
// Writes what was asked for to `output`, what went wrong to `error`, and returns the exit status.
int runSettingsCommand(const SettingsRequest& request, const std::filesystem::path& folder, std::ostream& output,
                       std::ostream& error);

}  // namespace plume
