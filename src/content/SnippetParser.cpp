#include "content/SnippetParser.h"

#include <utility>

#include "content/ExpansionContext.h"
#include "content/PlaceholderScanner.h"

namespace plume {

namespace {

// How the user knows the snippet.
std::u16string nameOf(const Snippet& snippet) {
    if (snippet.label() && !snippet.label()->empty()) return *snippet.label();
    return snippet.abbreviation().value_or(u"");
}

void reportEndless(const Snippet& snippet, const ContentEnvironment& environment) {
    if (!environment.report) return;
    environment.report("The snippet \"" + toUtf8(nameOf(snippet)) +
                       "\" is not expanded, because its content never ends or is too long; check whether snippets "
                       "include each other.");
}

// Runs `expand` in a fresh context.
template <class Expand>
SnippetParser::Expansion expandWithin(const ContentEnvironment& environment, const std::shared_ptr<Snippet>& snippet,
                                      const SnippetParser::Groups& groups, std::size_t length, Expand expand) {
    ExpansionContext context(environment, snippet, groups);
    SnippetParser::Expansion content = context.takeUnits(length) ? expand(context) : nullptr;
    if (!content) reportEndless(*snippet, environment);
    return content;
}

}  // namespace

SnippetParser::SnippetParser(ContentEnvironment environment) : environment_(std::move(environment)) {}

SnippetParser::Expansion SnippetParser::parseSnippet(const std::shared_ptr<Snippet>& snippet, const Groups& groups) {
    date_ = environment_.now();
    if (!snippet || !snippet->hasContent()) return nullptr;
    const AttributedString content = *snippet->richTextContent();
    switch (snippet->contentType()) {
        case ContentType::RichText:
            return parse(snippet, content, groups);
        case ContentType::PlainText:
        case ContentType::AppleScript:
        case ContentType::ShellScript:
            return parse(snippet, content.string(), groups);
    }
    return nullptr;
}

SnippetParser::Expansion SnippetParser::parse(const std::shared_ptr<Snippet>& snippet,
                                              std::u16string_view plainTextContent, const Groups& groups) {
    return expandWithin(environment_, snippet, groups, plainTextContent.size(),
                        [&](ExpansionContext& context) { return expandPlainText(context, plainTextContent); });
}

SnippetParser::Expansion SnippetParser::parse(const std::shared_ptr<Snippet>& snippet,
                                              const AttributedString& richTextContent, const Groups& groups) {
    return expandWithin(environment_, snippet, groups, richTextContent.length(),
                        [&](ExpansionContext& context) { return expandRichText(context, richTextContent); });
}

}  // namespace plume
