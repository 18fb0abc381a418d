// What the snippet editor shows: every placeholder as a chip, one attachment character whose cell shows the body.
#pragma once

#include <string_view>

#include "Foundation/text/AttributedString.h"

namespace plume {

// The chip of a placeholder's body. An attachment with a cell text is a chip; any other is an attached file.
AttributedString attributedStringFromVariable(std::u16string_view body);

// Every placeholder that starts with a keyword replaced by its chip, which takes the attributes of the opening marker.
AttributedString convertToSnippetEditContent(const AttributedString& content);

// Every chip replaced by the placeholder between its markers, with the attributes of the chip.
AttributedString convertFromSnippetEditContent(const AttributedString& content);

}  // namespace plume
