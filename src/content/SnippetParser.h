// Turns a snippet's content into what is delivered: every placeholder replaced by its value, or cut out and recorded.
//
// The steps that follow the parsing have headers of their own: FieldMerging.h, NestedScripts.h, SnippetContentCase.h.
// Which placeholders there are is said in PlaceholderKinds.cpp.
//
// Owned by the engine for its whole life; used by one thread at a time. Expanding takes time linear in the content and
// is bounded (ExpansionContext.h): a content that grows without end (snippets that include each other) is refused and
// reported.
#pragma once

#include <memory>
#include <string_view>
#include <vector>

#include "Foundation/Date.h"
#include "Foundation/text/AttributedString.h"
#include "content/ContentEnvironment.h"
#include "content/SnippetExpandedContent.h"
#include "library/SnippetGroup.h"

namespace plume {

class SnippetParser {
  public:
    using Groups = std::vector<std::shared_ptr<SnippetGroup>>;
    using Expansion = std::shared_ptr<SnippetExpandedContent>;

    explicit SnippetParser(ContentEnvironment environment);

    // Null when the snippet cannot be expanded: it has no content, its type is unknown, or it never ends (the user is
    // told which one).
    Expansion parseSnippet(const std::shared_ptr<Snippet>& snippet, const Groups& groups);
    // The given text in place of the snippet's own, which must not be null. Null when the expansion never ends.
    Expansion parse(const std::shared_ptr<Snippet>& snippet, std::u16string_view plainTextContent,
                    const Groups& groups);
    Expansion parse(const std::shared_ptr<Snippet>& snippet, const AttributedString& richTextContent,
                    const Groups& groups);

    // The moment of the last parseSnippet.
    Date date() const { return date_; }

  private:
    ContentEnvironment environment_;
    Date date_{};
};

}  // namespace plume
