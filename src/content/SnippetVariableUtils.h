// Reading placeholder bodies, and turning placeholders into chips of the snippet editor and back.
#pragma once

#include <array>
#include <memory>
#include <string>
#include <string_view>

#include "Foundation/text/AttributedString.h"
#include "content/SnippetVariable.h"

namespace plume {

class SnippetVariableUtils {
  public:
    static constexpr char16_t OpeningMarker = u'\u3010';
    static constexpr char16_t ClosingMarker = u'\u3011';

    // What the body of a placeholder starts with.
    static constexpr std::array<std::u16string_view, 11> Keywords = {u"date:",  u"time:",  u"clipboard", u"snippet:",
                                                                     u"field",  u"key:",   u"|",         u"\u25C0",
                                                                     u"\u25B2", u"\u25B6", u"\u25BC"};

    // The placeholder that a body (the text between the markers) stands for; null for the caret, the arrows and
    // everything that is no placeholder. Never fails; takes time linear in the body.
    static std::shared_ptr<SnippetVariable> parseVariable(std::u16string_view body);
    // The parameters of a body by name, read as CSVParser reads rows of "Name" and "Value" with ":" between fields and
    // spaces between rows: a body that starts with a space has none, a stray double quote ends the reading, and of
    // parameters with the same name the last one counts.
    static VariableParams parseParams(std::u16string_view body);
    // A parameter's value as it must be written to be read back.
    static std::u16string escapeParam(std::u16string_view value);

    // One attachment character whose cell shows the body; an attachment with a cell text is a chip.
    static AttributedString attributedStringFromVariable(std::u16string_view body);
    // Every placeholder that starts with a keyword replaced by its chip, which takes the attributes of the opening
    // marker; and every chip by the placeholder between its markers, with the attributes of the chip.
    static AttributedString convertToSnippetEditContent(const AttributedString& content);
    static AttributedString convertFromSnippetEditContent(const AttributedString& content);
};

}  // namespace plume
