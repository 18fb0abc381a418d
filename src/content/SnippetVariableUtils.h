// Reading placeholder bodies, and turning placeholders into chips of the snippet editor and back.
#pragma once

#include <memory>
#include <string>
#include <string_view>

#include "Foundation/AttributedString.h"
#include "content/SnippetVariable.h"

namespace plume {

class SnippetVariableUtils {
  public:
    static constexpr char16_t OpeningMarker = u'\u3010';
    static constexpr char16_t ClosingMarker = u'\u3011';

    // The placeholder that a body (the text between the markers) stands for; null for the caret, the arrows and
    // everything that is no placeholder. Never fails; takes time linear in the body.
    static std::shared_ptr<SnippetVariable> parseVariable(std::u16string_view body);
    // The parameters of a body by name.
    static VariableParams parseParams(std::u16string_view body);
    // A parameter's value as it must be written to be read back.
    static std::u16string escapeParam(std::u16string_view value);

    // One attachment character whose cell shows the body.
    static AttributedString attributedStringFromVariable(std::u16string_view body);
    // Every known placeholder replaced by its chip, and back.
    static AttributedString convertToSnippetEditContent(const AttributedString& content);
    static AttributedString convertFromSnippetEditContent(const AttributedString& content);
};

}  // namespace plume
