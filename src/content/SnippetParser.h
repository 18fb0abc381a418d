// Turns a snippet's content into what is delivered: every placeholder replaced by its value, or cut out and recorded.
//
// Owned by the engine for its whole life; used by one thread at a time. Expanding takes time linear in the content and
// is bounded: a content that grows without end (snippets that include each other) is refused and reported.
#pragma once

#include <chrono>
#include <memory>
#include <string>
#include <vector>

#include "Foundation/Date.h"
#include "Foundation/text/AttributedString.h"
#include "content/ContentEnvironment.h"
#include "content/PLScript.h"
#include "content/SnippetExpandedContent.h"
#include "content/SnippetVariable.h"
#include "library/SnippetGroup.h"

namespace plume {

class SnippetParser {
  public:
    using Groups = std::vector<std::shared_ptr<SnippetGroup>>;
    using Expansion = std::shared_ptr<SnippetExpandedContent>;

    // One expansion gives up beyond these.
    static constexpr std::size_t MaximumReplacements = 100'000;
    static constexpr std::size_t MaximumLength = std::size_t{16} * 1024 * 1024;  // UTF-16 units
    // Find-and-replace with patterns may take this long in one expansion; what comes later leaves the clipboard's text
    // as it is. The keyboard waits meanwhile.
    static constexpr std::chrono::milliseconds MaximumPatternTime{200};

    explicit SnippetParser(ContentEnvironment environment);

    // Null when the snippet cannot be expanded: it has no content, its type is unknown, or it never ends (the user is
    // told which one).
    Expansion parseSnippet(const std::shared_ptr<Snippet>& snippet, const Groups& groups);
    // The given text in place of the snippet's own, which must not be null. Null when the expansion never ends.
    Expansion parse(const std::shared_ptr<Snippet>& snippet, std::u16string_view plainTextContent,
                    const Groups& groups);
    Expansion parse(const std::shared_ptr<Snippet>& snippet, const AttributedString& richTextContent,
                    const Groups& groups);

    // Puts the fill-in values into the content.
    static void mergeFields(SnippetExpandedContent& content);
    // Cuts nested script snippets out of the content into its `scripts`; the locations of what stands behind one move
    // with the text.
    static void processScripts(SnippetExpandedContent& content);
    // Puts the results of the scripts that processScripts cut out into the content, with the attributes of their
    // placeholders; what was written behind a script moves behind its result.
    static void mergeScriptResults(SnippetExpandedContent& content);
    // Builds the script of `variable` from the text, removing it and what is nested in it from `variables`.
    static std::shared_ptr<PLScript> newScriptWithAbbreviationVariable(
        const std::shared_ptr<SnippetAbbreviationVariable>& variable, std::u16string_view snippetContent,
        std::vector<std::shared_ptr<SnippetAbbreviationVariable>>& variables);

    // The snippet that a nested-snippet placeholder in `snippet` names, or null.
    static std::shared_ptr<Snippet> findSnippetBySnippetAbbreviationVariable(
        const SnippetAbbreviationVariable& variable, const Snippet& snippet, const Groups& groups);

    // Rewrites a snippet of the older "%" syntax in place.
    static void convertOldSnippet(Snippet& snippet);

    // The moment of the last parseSnippet.
    Date date() const { return date_; }

  private:
    ContentEnvironment environment_;
    Date date_{};
};

}  // namespace plume
