// A folder of a test's own, which goes with all that is in it.
#pragma once

#include <stdlib.h>  // NOLINT(modernize-deprecated-headers): mkdtemp() is the system's, not the language's

#include <filesystem>
#include <string>
#include <system_error>

namespace plume {

class TemporaryFolder {
  public:
    TemporaryFolder() {
        std::string name = (std::filesystem::temp_directory_path() / "plume-test-XXXXXX").string();
        if (mkdtemp(name.data())) path_ = name;
    }
    ~TemporaryFolder() {
        std::error_code ignored;
        if (!path_.empty()) std::filesystem::remove_all(path_, ignored);
    }
    TemporaryFolder(const TemporaryFolder&) = delete;
    TemporaryFolder& operator=(const TemporaryFolder&) = delete;

    const std::filesystem::path& path() const { return path_; }

  private:
    std::filesystem::path path_;
};

}  // namespace plume
