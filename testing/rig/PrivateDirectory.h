#pragma once

#include <filesystem>

namespace plume::rig {

// A folder of its own under the system's temporary folder, mode 0700, removed with everything in it by the destructor.
// Its path is short enough for the sockets that are made in it.
class PrivateDirectory {
  public:
    PrivateDirectory();  // throws RigError
    ~PrivateDirectory();
    PrivateDirectory(const PrivateDirectory&) = delete;
    PrivateDirectory& operator=(const PrivateDirectory&) = delete;

    const std::filesystem::path& path() const { return path_; }

    // A folder inside it, mode 0700.
    std::filesystem::path makeFolder(const std::filesystem::path& name) const;

  private:
    std::filesystem::path path_;
};

}  // namespace plume::rig
