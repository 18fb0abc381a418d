// What the tests of the library's records share.
#pragma once

#include <chrono>
#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "Foundation/Date.h"
#include "Foundation/Strings.h"
#include "Foundation/text/AttributedString.h"
#include "Foundation/text/RTFD.h"
#include "library/Snippet.h"
#include "library/SnippetGroup.h"

namespace plume::test {

// A calendar that stands still until told otherwise.
class StoppedDate {
  public:
    Date now() const { return now_; }
    void pass(std::chrono::seconds time) { now_ += time; }

  private:
    Date now_{std::chrono::seconds(1'700'000'000)};
    ScopedDateSource source_{[this] { return now_; }};
};

inline SharedAttributes bold() {
    auto attributes = std::make_shared<TextAttributes>();
    attributes->font = FontAttribute{u"Helvetica", 12, true, false};
    return attributes;
}

// "plain bold" with its second word in bold.
inline AttributedString richText() {
    AttributedString text(u"plain ");
    text.append(u"bold", bold());
    return text;
}

inline std::shared_ptr<Snippet> snippet(std::u16string abbreviation, std::u16string content = u"content") {
    return std::make_shared<Snippet>(std::move(abbreviation), std::move(content));
}

// Everything in it differs from a new record.
inline std::shared_ptr<Snippet> fullSnippet() {
    auto full = std::make_shared<Snippet>(u"Sig", std::nullopt);
    full->setContentType(ContentType::RichText);
    full->setRichTextContent(richText());
    full->setCaseSensitivity(CaseSensitivity::IgnoreCaseAndAdapt);
    full->setLabel(u"Signature");
    full->setNote(u"a note");
    return full;
}

inline std::shared_ptr<SnippetGroup> fullGroup() {
    auto group = SnippetGroup::make();
    group->setName(u"Mail \u65E5\u672C");
    group->setAbbreviationPrefix(u";");
    group->setExpandAfter(ExpandAfter::Digits);
    group->setExpandAfterDelimiters(CharacterSet::withCharacters(u"-\r"));
    group->setExpandTrigger(ExpandTrigger::HotKey);
    group->setDelimiters(CharacterSet::withCharacters(u" \t\""));
    group->setCaseSensitivity(CaseSensitivity::IgnoreCase);
    group->setResetFormatting(true);
    group->setSuggestAbbreviations(false);
    group->setShowInMenuBar(false);
    group->availability() = {1, {{u"org.mail", u"b"}}, 2, std::vector<std::u16string>()};
    group->addItems({fullSnippet(), snippet(u"b", u"Best\n\u3010|\u3011 \U0001F600"), std::make_shared<Snippet>()});
    group->items()[1]->setContentType(ContentType::ShellScript);
    return group;
}

// ---- Records as text, to be compared ----

inline std::string shown(const std::optional<std::u16string>& text) {
    return text ? "'" + toUtf8(*text) + "' " : "nil ";
}

inline std::string shown(const std::optional<CharacterSet>& set) {
    return set ? shown(set->characters()) : "nil ";
}

inline std::string shown(const std::optional<std::vector<std::u16string>>& texts) {
    std::string all = texts ? "" : "nil";
    for (const auto& text : texts.value_or(std::vector<std::u16string>())) all += shown(text);
    return "[" + all + "] ";
}

template <typename Enumeration>
std::string code(Enumeration value) {
    return std::to_string(static_cast<std::int64_t>(value)) + " ";
}

// All that a duplicate shares with its original.
inline std::string fieldsOf(const Snippet& snippet) {
    const auto& content = snippet.richTextContent();
    return shown(snippet.abbreviation()) + shown(snippet.label()) + shown(snippet.note()) +
           code(snippet.contentType()) + code(snippet.caseSensitivity()) + std::to_string(snippet.abbreviationHash()) +
           (content ? rtfFromAttributedString(*content) : " nil");
}

inline std::string settingsOf(const SnippetGroup& group) {
    const PLFunctionAvailability& availability = group.availability();
    return code(group.expandAfter()) + shown(group.expandAfterDelimiters()) + code(group.expandTrigger()) +
           shown(group.delimiters()) + code(group.caseSensitivity()) + code(group.resetFormatting()) +
           code(group.showInMenuBar()) + code(group.suggestAbbreviations()) + code(availability.availability) +
           shown(availability.applications) + code(availability.inputMethodsOption) + shown(availability.inputMethods);
}

inline std::string fieldsOf(const SnippetGroup& group) {
    std::string fields = shown(group.name()) + shown(group.abbreviationPrefix()) + settingsOf(group);
    for (const auto& item : group.items()) fields += "\n" + fieldsOf(*item);
    return fields;
}

}  // namespace plume::test
