#include "library/EditedLibrary.h"

#include <algorithm>
#include <map>
#include <utility>

#include "Foundation/text/RTFD.h"

namespace plume {

namespace {

using Known = std::map<Uuid, std::shared_ptr<Snippet>>;

// What a readable library shows of the content.
std::optional<AttributedString> shownContent(const Snippet& snippet) {
    const auto& content = snippet.richTextContent();
    if (!content || snippet.contentType() != ContentType::RichText) {
        return content ? std::optional(AttributedString(content->string())) : std::nullopt;
    }
    auto shown = attributedStringFromRTF(rtfFromAttributedString(*content));
    return shown ? std::move(shown).value() : *content;
}

void takeContent(Snippet& snippet, const Snippet& edited) {
    const bool sameType = snippet.contentType() == edited.contentType();
    const bool sameContent = sameType && shownContent(snippet) == edited.richTextContent();
    snippet.setContentType(edited.contentType());
    if (!sameContent) snippet.setRichTextContent(edited.richTextContent());
}

std::shared_ptr<Snippet> taken(const Known& known, const std::shared_ptr<Snippet>& edited) {
    const auto found = edited->uuid() ? known.find(*edited->uuid()) : known.end();
    if (found == known.end()) return edited;
    Snippet& snippet = *found->second;
    if (snippet.abbreviation() != edited->abbreviation()) snippet.setAbbreviation(edited->abbreviation());
    if (snippet.label() != edited->label()) snippet.setLabel(edited->label());
    if (snippet.note() != edited->note()) snippet.setNote(edited->note());
    if (snippet.caseSensitivity() != edited->caseSensitivity()) {
        snippet.setCaseSensitivity(edited->caseSensitivity());
    }
    takeContent(snippet, *edited);
    return found->second;
}

std::shared_ptr<SnippetGroup> takeGroup(SnippetGroups& left, const std::shared_ptr<SnippetGroup>& edited) {
    const auto found =
        std::find_if(left.begin(), left.end(), [&](const auto& group) { return group->name() == edited->name(); });
    if (found == left.end()) {
        auto fresh = SnippetGroup::make();
        fresh->setName(edited->name());
        return fresh;
    }
    auto group = *found;
    left.erase(found);
    return group;
}

}  // namespace

SnippetGroups takeEdits(const SnippetGroups& current, const SnippetGroups& edited) {
    Known known;
    for (const auto& group : current) {
        for (const auto& snippet : group->items()) {
            if (snippet->uuid()) known.emplace(*snippet->uuid(), snippet);
        }
    }
    SnippetGroups left = current;
    SnippetGroups result;
    for (const auto& each : edited) {
        auto group = takeGroup(left, each);
        std::vector<std::shared_ptr<Snippet>> items;
        for (const auto& snippet : each->items()) items.push_back(taken(known, snippet));
        group->setAbbreviationPrefix(each->abbreviationPrefix());
        group->copySettingsFromGroup(*each);
        if (group->items() != items) group->replaceItems(items);
        result.push_back(std::move(group));
    }
    return result;
}

}  // namespace plume
