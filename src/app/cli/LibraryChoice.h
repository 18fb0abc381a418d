// Which library a command works with.
#pragma once

#include <filesystem>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "Foundation/Result.h"
#include "library/SnippetGroup.h"

namespace plume {

struct ChosenLibrary {
    std::vector<std::shared_ptr<SnippetGroup>> groups;
    std::filesystem::path file;

    std::size_t snippetCount() const;
};

// The named file, read by its ending; without one the user's own library, else the sample. A file that is
// there and cannot be read is an error, never another library. The error names the file, and the place in it.
Result<ChosenLibrary> openLibrary(const std::optional<std::string>& named);

}  // namespace plume
