// A placeholder to fill in: a field of the form.
#pragma once

#include <cstdint>
#include <memory>
#include <optional>

#include "content/SnippetAbbreviationVariable.h"
#include "content/SnippetVariable.h"

namespace plume {

enum class FieldType : std::int32_t { Singleline = 0, Multiline = 1, PopupMenu = 2, Number = 3 };

class SnippetFieldVariable final : public SnippetVariable {
  public:
    SnippetFieldVariable() = default;
    explicit SnippetFieldVariable(const VariableParams& params);
    std::u16string toString() const override;

    bool isSingleline() const { return type == FieldType::Singleline; }
    bool isMultiline() const { return type == FieldType::Multiline; }
    bool isPopupMenu() const { return type == FieldType::PopupMenu; }
    bool isNumber() const { return type == FieldType::Number; }
    bool canSetWidth() const { return isSingleline() || isMultiline(); }
    bool canSetHeight() const { return isMultiline(); }
    bool canSetReadonly() const override { return isSingleline() || isMultiline(); }

    std::int64_t width() const { return width_; }
    std::int64_t height() const { return height_; }
    bool hasWidth() const { return hasWidth_; }
    bool hasHeight() const { return hasHeight_; }
    // A size of 0 or less stands for the default (30 and 5) and counts as not given.
    void setWidth(std::int64_t width);
    void setHeight(std::int64_t height);

    Text name;
    FieldType type = FieldType::Singleline;  // other stored numbers are kept and are none of the four kinds
    Text value;                              // the initial text; for a pop-up menu its items, one a line
    std::optional<AttributedString> richTextValue;
    std::int64_t defaultIndex = 0;
    // The field ticks this optional script: what it shows is never delivered. Else null.
    std::shared_ptr<SnippetAbbreviationVariable> script;

  private:
    std::int64_t width_ = 30;
    std::int64_t height_ = 5;
    bool hasWidth_ = false;
    bool hasHeight_ = false;
};

}  // namespace plume
