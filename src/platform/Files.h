// Files and folders, as far as the library, its backups and its synchronisation need them.
//
// Every error names the file and says what the system says. Paths are absolute. Calls block; not for the road of a
// keystroke. From any thread.
#pragma once

#include <cstddef>
#include <filesystem>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "Foundation/Date.h"
#include "Foundation/Result.h"

namespace plume {

class Files {
  public:
    using Path = std::filesystem::path;

    struct Entry {
        std::string name;
        bool isFolder = false;
        std::optional<Date> modified;  // nothing when the system does not tell
    };

    // No file that Plume reads is larger.
    static constexpr std::size_t LargestFile = std::size_t{256} * 1024 * 1024;

    virtual ~Files() = default;
    virtual bool exists(const Path& path) const = 0;
    virtual bool isFolder(const Path& path) const = 0;
    virtual Result<std::string> read(const Path& path) const = 0;
    // The file holds either what it held or all of these bytes, whatever happens meanwhile. A new one is the user's
    // alone (0600). Its folder has to be there.
    virtual Result<void> write(const Path& path, std::string_view bytes) = 0;
    // The same as long as the file holds what is expected (nothing: is not there), which is looked at in the last
    // moment. False, and nothing is written, when it does not.
    virtual Result<bool> replace(const Path& path, const std::optional<std::string>& expected,
                                 std::string_view bytes) = 0;
    // With the folders above it; one that is there is no error.
    virtual Result<void> createFolder(const Path& path) = 0;
    // In the order in which the system tells them.
    virtual Result<std::vector<Entry>> list(const Path& folder) const = 0;
    // A file, or an empty folder. What is not there is an error.
    virtual Result<void> remove(const Path& path) = 0;
    // Where there is no trash on the file's disk, beside the file under another name.
    virtual Result<void> moveToTrash(const Path& path) = 0;
};

}  // namespace plume
