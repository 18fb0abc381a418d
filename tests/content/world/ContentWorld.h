// A small world for tests of the content language: a library, a clipboard and a clock that stand still, and short ways
// to write rich text and variables down. Texts are UTF-8 here, so that failures read well.
#pragma once

#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "content/ContentEnvironment.h"
#include "content/SnippetExpandedContent.h"
#include "content/SnippetParser.h"
#include "library/SnippetGroup.h"
#include "platform/Pasteboard.h"

namespace plume {

class FixedPasteboard final : public PasteboardReader {
  public:
    std::optional<std::string> plainText;
    std::optional<std::string> rtf;
    std::optional<std::string> rtfd;

    std::vector<std::string> types() const override;
    std::optional<std::u16string> string() const override;
    std::optional<std::string> data(std::string_view type) const override;

    mutable std::size_t readCount = 0;
};

class ContentWorld {
  public:
    // Monday 2026-03-09 at 14:05:06 UTC, en_US, an empty clipboard, no snippets.
    ContentWorld();

    // A snippet in the first group.
    std::shared_ptr<Snippet> add(std::string_view abbreviation, std::string_view content,
                                 ContentType type = ContentType::PlainText);
    std::shared_ptr<SnippetGroup> addGroup();
    // The snippet, listed nowhere. Contents of rich snippets are in the notation of `rich`.
    std::shared_ptr<Snippet> snippet(std::string_view content, ContentType type = ContentType::PlainText);
    SnippetParser::Expansion expand(std::string_view content, ContentType type = ContentType::PlainText);

    SnippetParser::Groups groups;
    FixedPasteboard pasteboard;
    std::vector<std::string> reports;
    ContentEnvironment environment;
};

// Rich text: what stands between stars is bold, between underlines italic.
AttributedString rich(std::string_view notation);
std::string notation(const AttributedString& text);
// The content of either form; plain text as it stands.
std::string notation(const SnippetExpandedContent& content);

// The variables in list order: "caret@3 key36@4 key36x2@4 field(Name=value)@0 field?(…) (optional) field?+(…) (ticked),
// field!(…) (read-only), script(abbreviation)@0+5".
std::string describe(const std::vector<std::shared_ptr<SnippetVariable>>& variables);

}  // namespace plume
