#pragma once

#include <chrono>
#include <filesystem>
#include <stdexcept>
#include <string>

namespace plume::rig {

// What the desktop rig throws when it cannot be brought up or when a condition is not met in time. A missing part of
// the system names the package to install: a desktop test is never skipped because something is not there.
class RigError : public std::runtime_error {
  public:
    using std::runtime_error::runtime_error;
};

using Milliseconds = std::chrono::milliseconds;

// The full path of a program looked up along PATH; throws RigError naming `package` when it is not there.
std::filesystem::path requireProgram(const std::string& program, const std::string& package);

// The first of the given files that exists; throws RigError naming `package` when there is none.
std::filesystem::path requireFile(std::initializer_list<std::filesystem::path> candidates, const std::string& package);

}  // namespace plume::rig
