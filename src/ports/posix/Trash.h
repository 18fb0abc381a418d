// The trash of the desktop, by the specification of freedesktop.org.
#pragma once

#include <filesystem>

namespace plume {

// To the trash of the user's home, else to that of the file's own disk, else beside the file under another name. A
// folder goes with all that is in it. 0, or the system's number of the problem. Blocks; from any thread.
int moveToTrash(const std::filesystem::path& path);

}  // namespace plume
