// Plays scenario files one after the other.
#pragma once

#include <iosfwd>
#include <optional>
#include <string>
#include <vector>

namespace plume {

// Writes the outcome of each as JSON to `output`, and to `error` what is wrong with a file or differs from what it
// expects. With `onlyCase` the cases of other names are not played. Returns the gravest exit status of all.
int simulateFiles(const std::vector<std::string>& files, const std::optional<std::string>& onlyCase,
                  std::ostream& output, std::ostream& error);

}  // namespace plume
