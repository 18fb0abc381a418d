// The scripts that snippets of other programs run within their text: each becomes a snippet of its own, which others
// include, in a group that never expands by itself.
#pragma once

#include <map>
#include <memory>
#include <string>

#include "library/SnippetGroup.h"

namespace plume {

class ScriptShelf {
  public:
    // The placeholder that includes what the shell script prints. Scripts with the same text are one snippet, under the
    // first name.
    std::u16string placeholderFor(const std::u16string& script, const std::u16string& name);

    // Null when there are no scripts.
    std::shared_ptr<SnippetGroup> group(const std::u16string& name) const;

  private:
    std::map<std::u16string, std::shared_ptr<Snippet>> snippets_;  // by their script
    std::vector<std::shared_ptr<Snippet>> inOrder_;
};

}  // namespace plume
