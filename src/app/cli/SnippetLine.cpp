#include "app/cli/SnippetLine.h"

#include <algorithm>

#include "Foundation/Strings.h"
#include "app/FirstLine.h"

namespace plume {

namespace {

std::string kindOf(const Snippet& snippet) {
    if (snippet.isScript()) return "  [script]";
    return snippet.contentType() == ContentType::RichText ? "  [rich text]" : "";
}

std::size_t codePoints(std::u16string_view text) {
    return static_cast<std::size_t>(
        std::count_if(text.begin(), text.end(), [](char16_t unit) { return (unit & 0xFC00) != 0xDC00; }));
}

}  // namespace

std::size_t typedWidth(const Snippet& snippet) {
    return codePoints(snippet.abbreviationWithPrefix().value_or(u""));
}

std::string snippetLine(const Snippet& snippet, std::size_t width) {
    const std::u16string abbreviation = snippet.abbreviationWithPrefix().value_or(u"");
    const std::u16string label = snippet.label().value_or(u"");
    std::string line = "  " + toUtf8(abbreviation) + std::string(width - codePoints(abbreviation) + 2, ' ');
    if (!label.empty()) line += toUtf8(label) + ": ";
    line += toUtf8(firstLine(snippet.plainTextContent().value_or(u""))) + kindOf(snippet);
    return line;
}

}  // namespace plume
