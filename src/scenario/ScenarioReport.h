// Reads, plays and compares a scenario file, for the command line.
#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace plume {

struct ScenarioReport {
    // The outcome as JSON, or for a file with cases an object that maps the name of each to its outcome. Cases with a
    // step that could not be taken are left out. Empty when nothing was played to its end.
    std::string output;
    // What is wrong with the file, or where it differs from what it expects; empty when all is well.
    std::string problems;
    int exitStatus = 0;  // 1: not what was expected; 2: something could not be played
};

// The file name is for messages. With `onlyCase` the cases of other names are not played.
ScenarioReport simulate(std::string_view text, const std::string& fileName,
                        const std::optional<std::string>& onlyCase = std::nullopt);

}  // namespace plume
