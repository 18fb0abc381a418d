#include "Foundation/text/MarkdownImport.h"

#include <md4c-html.h>

#include "Foundation/text/HTMLImport.h"

namespace plume {

namespace {

constexpr std::size_t LongestMarkdown = std::size_t{4} << 20;

void appendPiece(const MD_CHAR* text, MD_SIZE size, void* html) {
    static_cast<std::string*>(html)->append(text, size);
}

}  // namespace

std::string htmlFromMarkdown(std::string_view utf8) {
    utf8 = utf8.substr(0, LongestMarkdown);
    std::string html;
    md_html(utf8.data(), static_cast<MD_SIZE>(utf8.size()), appendPiece, &html, MD_DIALECT_GITHUB, 0);
    return html;
}

AttributedString attributedStringFromMarkdown(std::string_view utf8) {
    return attributedStringFromHTML(htmlFromMarkdown(utf8));
}

}  // namespace plume
