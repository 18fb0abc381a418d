#pragma once

#include <filesystem>

#include "testing/rig/XClient.h"

namespace plume::rig {

// Writes what the whole screen shows as a PNG file; throws RigError.
void writeScreenshot(XClient& client, const std::filesystem::path& file);
// The same for a part of it, which must lie on the screen.
void writeScreenshot(XClient& client, const std::filesystem::path& file, const XClient::Place& part);

}  // namespace plume::rig
