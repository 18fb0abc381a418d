// HTML as rich text: the reverse of HTMLExport, for what people write by hand, programs copy and libraries hold.
//
// Paragraphs, line breaks, bold, italic, underline, strikethrough, raised and lowered text, fonts, colours, links,
// alignment, lists, preformatted text, and images that the page itself holds ("data:"). Other images become their
// alternative text; scripts, style sheets and what a page hides are left out. Nothing is fetched. Pure; from any
// thread.
#pragma once

#include <string_view>

#include "Foundation/text/AttributedString.h"

namespace plume {

// UTF-8, whatever the page says of itself; malformed sequences become U+FFFD. Never fails: mistakes are read as
// browsers read them. What comes behind 64 MiB, 200,000 elements or an element within 1,000 others is left out. A line
// break within a list's item is U+2028, all others are line feeds; the items begin with their marker between two tabs.
AttributedString attributedStringFromHTML(std::string_view utf8);

}  // namespace plume
