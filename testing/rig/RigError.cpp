#include "testing/rig/RigError.h"

#include <unistd.h>

#include <cstdlib>
#include <sstream>

namespace plume::rig {

namespace {

[[noreturn]] void reportMissing(const std::string& part, const std::string& package) {
    throw RigError(part + " is missing: install the package " + package);
}

}  // namespace

std::filesystem::path requireProgram(const std::string& program, const std::string& package) {
    const char* path = std::getenv("PATH");
    std::istringstream folders(path != nullptr ? path : "/usr/local/bin:/usr/bin:/bin");
    for (std::string folder; std::getline(folders, folder, ':');) {
        const auto candidate = std::filesystem::path(folder) / program;
        if (access(candidate.c_str(), X_OK) == 0) return candidate;
    }
    reportMissing(program, package);
}

std::filesystem::path requireFile(std::initializer_list<std::filesystem::path> candidates, const std::string& package) {
    for (const auto& candidate : candidates) {
        if (access(candidate.c_str(), R_OK) == 0) return candidate;
    }
    reportMissing(candidates.begin()->string(), package);
}

}  // namespace plume::rig
