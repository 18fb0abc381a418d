// Plays scenario files one after the other.
#pragma once

#include <iosfwd>
#include <string>
#include <vector>

namespace plume {

// Writes the outcome of each as JSON to `output`, and to `error` what is wrong with a file or differs from what it
// expects. Returns the gravest exit status of all.
int simulateFiles(const std::vector<std::string>& files, std::ostream& output, std::ostream& error);

}  // namespace plume
