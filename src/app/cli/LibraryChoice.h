// Which library a command works with.
#pragma once

#include <filesystem>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "Foundation/Result.h"
#include "library/MemoryUserDefaults.h"
#include "library/SnippetGroup.h"

namespace plume {

struct ChosenLibrary {
    std::vector<std::shared_ptr<SnippetGroup>> groups;
    std::filesystem::path file;
    // Those that search goes by: the user's where the library is the user's, else what holds when nothing is set.
    std::shared_ptr<MemoryUserDefaults> settings;
};

// The named file, of any kind that can be imported; without one the user's own library, for reading. A library that is
// there and cannot be read is an error, never another library. The error names the file, and the place in it.
Result<ChosenLibrary> openLibrary(const std::optional<std::string>& named,
                                  const std::function<void(const std::string& sentence)>& report);

}  // namespace plume
