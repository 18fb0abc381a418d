#pragma once

#include <filesystem>

#include "testing/rig/XClient.h"

namespace plume::rig {

// Writes what the whole screen shows as a PNG file; throws RigError.
void writeScreenshot(XClient& client, const std::filesystem::path& file);

}  // namespace plume::rig
