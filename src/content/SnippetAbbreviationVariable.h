// Another snippet, named by its abbreviation or its UUID.
#pragma once

#include <cstddef>
#include <memory>
#include <vector>

#include "content/SnippetVariable.h"

namespace plume {

class Snippet;
class SnippetGroup;

class SnippetAbbreviationVariable final : public SnippetVariable {
  public:
    SnippetAbbreviationVariable() = default;
    explicit SnippetAbbreviationVariable(const VariableParams& params);
    std::u16string toString() const override;

    Text abbreviation;
    Text uuid;
    // Set by the parser when the included snippet is a script.
    std::shared_ptr<Snippet> snippet;
    std::size_t scriptLength = 0;    // of its expanded text in the content
    std::size_t innerVariables = 0;  // so many of the variables listed behind it stand in that text
    bool isAppleScript = false;
};

// The snippet that a nested-snippet placeholder in `snippet` names, or null.
std::shared_ptr<Snippet> findSnippetBySnippetAbbreviationVariable(
    const SnippetAbbreviationVariable& variable, const Snippet& snippet,
    const std::vector<std::shared_ptr<SnippetGroup>>& groups);

}  // namespace plume
