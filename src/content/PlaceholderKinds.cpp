#include "content/PlaceholderKinds.h"

#include <algorithm>
#include <iterator>
#include <string>

#include "content/PlaceholderBody.h"
#include "content/SnippetAbbreviationVariable.h"
#include "content/SnippetClipboardVariable.h"
#include "content/SnippetDateTimeVariable.h"
#include "content/SnippetFieldVariable.h"
#include "content/SnippetKeyVariable.h"

namespace plume {
namespace {

using Variable = std::shared_ptr<SnippetVariable>;

template <class Kind>
Variable make(const VariableParams& params) {
    return std::make_shared<Kind>(params);
}

struct PlaceholderKind {
    std::u16string_view keyword;  // what the body starts with
    Variable (*make)(const VariableParams& params);
};

// A new kind of placeholder needs
//  - a class beside SnippetFieldVariable.h and the others, which reads its parameters and writes them back (toString);
//  - a row here, below those whose keyword it begins with; the editor's chips and the rest of the reading follow
//    from it;
//  - what it asks of the world (the clock, the clipboard) as a member of ContentEnvironment, so that tests can fix it;
//  - when text takes its place at once: a branch in PlaceholderScanner::replaceBy. Otherwise it is recorded with its
//    location, and whoever delivers the content (PLOutput.cpp), shows it in the form or asks after it
//    (SnippetExpandedContent.h) must know it;
//  - a section with examples in docs/content-language.md, which the tests run.
constexpr PlaceholderKind Kinds[] = {
    {u"date:", make<SnippetDateVariable>},          {u"time:", make<SnippetTimeVariable>},
    {u"clipboard", make<SnippetClipboardVariable>}, {u"snippet:", make<SnippetAbbreviationVariable>},
    {u"field", make<SnippetFieldVariable>},         {u"key:", make<SnippetKeyVariable>},
};

// The placeholders without parameters, whose sign is the whole body.
constexpr char16_t CaretSign = u'|';

struct Arrow {
    char16_t sign;
    KeyCode keyCode;
};
constexpr Arrow Arrows[] = {
    {u'\u25C0', KeyCode::Left}, {u'\u25B2', KeyCode::Up}, {u'\u25B6', KeyCode::Right}, {u'\u25BC', KeyCode::Down}};

const Arrow* arrowFor(char16_t sign) {
    const auto* const found =
        std::find_if(std::begin(Arrows), std::end(Arrows), [sign](const Arrow& arrow) { return arrow.sign == sign; });
    return found == std::end(Arrows) ? nullptr : found;
}

}  // namespace

Variable parseVariable(std::u16string_view body) {
    for (const PlaceholderKind& kind : Kinds) {
        if (body.starts_with(kind.keyword)) return kind.make(parseParams(body));
    }
    return nullptr;
}

Variable parseSign(std::u16string_view body, std::size_t location) {
    if (body.size() != 1) return nullptr;
    if (body.front() == CaretSign) {
        auto caret = std::make_shared<SnippetContentCaret>();
        caret->location = location;
        return caret;
    }
    const Arrow* const arrow = arrowFor(body.front());
    if (arrow == nullptr) return nullptr;
    auto key = std::make_shared<SnippetKeyVariable>(std::u16string(body), arrow->keyCode);
    // An arrow is located by its place in the table, at the very start of the content, wherever it was written.
    key->location = static_cast<std::size_t>(arrow - std::begin(Arrows));
    return key;
}

bool startsWithKeyword(std::u16string_view body) {
    if (body.empty()) return false;
    if (body.front() == CaretSign || arrowFor(body.front()) != nullptr) return true;
    return std::any_of(std::begin(Kinds), std::end(Kinds),
                       [body](const PlaceholderKind& kind) { return body.starts_with(kind.keyword); });
}

}  // namespace plume
