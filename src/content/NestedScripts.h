// Cutting nested script snippets out of a content, and putting their output in.
#pragma once

#include <memory>
#include <string_view>
#include <vector>

#include "content/PLScript.h"
#include "content/SnippetExpandedContent.h"

namespace plume {

// Cuts nested script snippets out of the content into its `scripts`; the locations of what stands behind one move with
// the text. The values of fields are to be merged before.
void processScripts(SnippetExpandedContent& content);

// Puts the results of the scripts that processScripts cut out into the content, with the attributes of their
// placeholders; what was written behind a script moves behind its result.
void mergeScriptResults(SnippetExpandedContent& content);

// Builds the script of `variable` from the text, removing it and what is nested in it from `variables`.
std::shared_ptr<PLScript> newScriptWithAbbreviationVariable(
    const std::shared_ptr<SnippetAbbreviationVariable>& variable, std::u16string_view snippetContent,
    std::vector<std::shared_ptr<SnippetAbbreviationVariable>>& variables);

}  // namespace plume
