#include "testing/rig/PrivateDirectory.h"

#include <sys/stat.h>

#include <cstdlib>
#include <string>
#include <system_error>

#include "testing/rig/RigError.h"

namespace plume::rig {

PrivateDirectory::PrivateDirectory() {
    std::string pattern = (std::filesystem::temp_directory_path() / "plume-desktop-XXXXXX").string();
    if (mkdtemp(pattern.data()) == nullptr) throw RigError("cannot make a temporary folder like " + pattern);
    path_ = pattern;
}

PrivateDirectory::~PrivateDirectory() {
    std::error_code ignored;
    std::filesystem::remove_all(path_, ignored);
}

std::filesystem::path PrivateDirectory::makeFolder(const std::filesystem::path& name) const {
    auto folder = path_ / name;
    std::filesystem::create_directories(folder);
    if (chmod(folder.c_str(), 0700) != 0) throw RigError("cannot make the folder " + folder.string() + " private");
    return folder;
}

}  // namespace plume::rig
