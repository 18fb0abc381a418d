// Rich text as HTML, for programs that paste it: the same text with bold, italic, underline, strikethrough, colours,
// fonts, links, alignment, lists and images.
//
// UTF-8. Styles are written inline, so that the pieces mean the same wherever they are pasted. Pure; from any thread.
#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "Foundation/text/AttributedString.h"

namespace plume {

// Text for an element or an attribute's value in double quotes. HTML takes a bare U+000D for a line feed, and cannot
// hold U+0000, which becomes U+FFFD.
std::string escapedForHtml(std::u16string_view text);

// The elements of a whole document, left out of what is pasted into one: "doctype", "html", "head", "body", "xml".
std::vector<std::string> defaultExcludedTags();

// The text as HTML without the start and end tags of the excluded elements (their content stays). Without "p",
// paragraphs are parted by line breaks.
std::string htmlFromAttributedString(const AttributedString& text, const std::vector<std::string>& excludedTags);

}  // namespace plume
