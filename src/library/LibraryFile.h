// The readable form of a library: a JSON list of groups, each with its settings and its items.
//
// What a file leaves out is as in a new record; what is as in a new record is left out when written. Dates and
// attachments of rich text are not kept.
#pragma once

#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "Foundation/Result.h"
#include "Foundation/json/JsonNode.h"
#include "library/SnippetGroup.h"

namespace plume {

class LibraryFile {
  public:
    using Groups = std::vector<std::shared_ptr<SnippetGroup>>;

    // The error names the file, the place in it and what was expected.
    static Result<Groups> read(std::string_view text, const std::string& fileName);
    // Throws JsonError.
    static Groups readFrom(const JsonNode& node);
    static std::string write(const Groups& groups);
};

}  // namespace plume
