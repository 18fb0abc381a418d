// What an importer made of a foreign file.
#pragma once

#include <memory>
#include <string>
#include <vector>

#include "library/SnippetGroup.h"

namespace plume {

struct ImportedLibrary {
    std::vector<std::shared_ptr<SnippetGroup>> groups;
    // One line for each thing that could not be carried over whole: which snippet or place, and why.
    std::vector<std::string> remarks;
};

}  // namespace plume
