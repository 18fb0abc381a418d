#include "content/OldSyntax.h"

#include <array>
#include <string>
#include <string_view>
#include <utility>

#include "content/ContentRewriter.h"
#include "content/PlaceholderBody.h"
#include "content/SnippetKeyVariable.h"

namespace plume {

namespace {

using View = std::u16string_view;

constexpr char16_t Marker = u'%';
// In the order in which they are tried. Those that end in a colon take a parameter.
constexpr std::array<View, 12> Keywords = {u"date:", u"time:", u"clipboard", u"snippet:", u"field:", u"fill:",
                                           u"key:",  u"|",     u"<",         u"^",        u">",      u"v"};

struct OldPlaceholder {
    std::u16string body;     // in today's syntax
    std::size_t length = 0;  // in the old text, from the first marker on; 0: none
};

std::u16string keyBody(View label, KeyCode code) {
    return SnippetKeyVariable(std::u16string(label), code).toString();
}

// The keyword that the text starts with, or nothing.
View findKeyword(View text) {
    for (const View keyword : Keywords) {
        if (text.starts_with(keyword)) return keyword;
    }
    return {};
}

std::u16string bodyForSign(View keyword) {
    switch (keyword.front()) {
        case u'<':
            return keyBody(u"\u2190", KeyCode::Left);
        case u'^':
            return keyBody(u"\u2191", KeyCode::Up);
        case u'>':
            return keyBody(u"\u2192", KeyCode::Right);
        case u'v':
            return keyBody(u"\u2193", KeyCode::Down);
        default:  // the clipboard and the caret, written as before
            return std::u16string(keyword);
    }
}

std::u16string bodyForKey(View name) {
    if (name == u"enter") return keyBody(u"\u21A9", KeyCode::Return);
    if (name == u"tab") return keyBody(u"\u21E5", KeyCode::Tab);
    if (name == u"esc") return keyBody(u"\u238B", KeyCode::Escape);
    return u"key:(null) code:0";
}

std::u16string bodyForParameter(View keyword, View parameter) {
    if (keyword == u"key:") return bodyForKey(parameter);
    std::u16string body(keyword == u"fill:" ? View(u"field:") : keyword);
    return body + escapeParam(parameter);
}

// The placeholder that the text, which starts with the marker, starts with.
OldPlaceholder readPlaceholder(View text) {
    const View keyword = findKeyword(text.substr(1));
    if (keyword.empty()) return {};
    const std::size_t start = 1 + keyword.size();
    if (keyword.back() != u':') return {bodyForSign(keyword), start};
    const std::size_t end = text.find(Marker, start);
    if (end == View::npos) return {};
    return {bodyForParameter(keyword, text.substr(start, end - start)), end + 1};
}

}  // namespace

void convertOldSnippet(Snippet& snippet) {
    if (!snippet.hasContent()) return;
    const AttributedString source = *snippet.richTextContent();
    const View text = source.string();
    AttributedStringRewriter rewriter(source);
    for (std::size_t at = text.find(Marker); at != View::npos; at = text.find(Marker, at)) {
        const OldPlaceholder old = readPlaceholder(text.substr(at));
        if (old.length == 0) {
            ++at;
            continue;
        }
        rewriter.copyTo(at);
        rewriter.append(OpeningMarker + old.body + ClosingMarker, rewriter.attributes());
        at += old.length;
        rewriter.skipTo(at);
    }
    snippet.setRichTextContent(rewriter.finish());
}

}  // namespace plume
