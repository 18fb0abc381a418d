// A placeholder of the content language, at a place in the expanded content.
//
// One base and one class per kind. Made from a placeholder's parameters (initWithParams) and written back by toString,
// both without the brackets around the body. Shared by std::shared_ptr between the content and the form. Belongs to the
// thread that sends.
#pragma once

#include <cstdint>
#include <functional>
#include <map>
#include <memory>
#include <optional>
#include <string>

#include "Foundation/KeyCode.h"
#include "Foundation/KeyModifiers.h"
#include "Foundation/text/AttributedString.h"

namespace plume {

class Snippet;

// The parameters of a placeholder's body by name; a parameter without a value maps to the empty string.
using VariableParams = std::map<std::u16string, std::u16string, std::less<>>;

class SnippetVariable {
  public:
    using Text = std::optional<std::u16string>;

    SnippetVariable() = default;
    explicit SnippetVariable(const VariableParams& params);
    virtual ~SnippetVariable() = default;

    // The body that makes this placeholder again, as far as the kind allows it.
    virtual std::u16string toString() const;
    virtual bool canSetReadonly() const { return true; }

    std::size_t location = 0;  // index into the expanded content
    bool isOptional = false;
    bool isSelected = false;
    bool isReadonly = false;
    SharedAttributes attributes;  // in rich text: those of the opening marker
};

// The place where the text cursor is to stand after delivery.
class SnippetContentCaret final : public SnippetVariable {
  public:
    std::u16string toString() const override;
};

enum class FieldType : std::int32_t { Singleline = 0, Multiline = 1, PopupMenu = 2, Number = 3 };

// A fill-in field.
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

  private:
    std::int64_t width_ = 30;
    std::int64_t height_ = 5;
    bool hasWidth_ = false;
    bool hasHeight_ = false;
};

// A key pressed in the middle of the text.
class SnippetKeyVariable final : public SnippetVariable {
  public:
    // What a body may ask for at most; more is brought down to it when it is read.
    static constexpr std::uint64_t MaximumCount = 10'000;
    static constexpr double MaximumDelay = 24 * 60 * 60;

    SnippetKeyVariable() = default;
    // A code outside 16 bits is no key; a count below 1 or unreadable is 1; a negative or unreadable delay is 0.
    explicit SnippetKeyVariable(const VariableParams& params);
    SnippetKeyVariable(std::u16string label, KeyCode code);
    std::u16string toString() const override;

    bool shift() const;
    bool control() const;
    bool option() const;
    bool command() const;

    Text key;  // the label shown to the user
    KeyCode keyCode = KeyCode::None;
    std::uint64_t count = 1;
    double delay = 0;  // seconds
    EventFlags modifiers;
};

// The clipboard's content, after find-and-replace.
class SnippetClipboardVariable final : public SnippetVariable {
  public:
    enum class MatchingOption : std::int32_t { Anywhere = 0, WordStart = 1, WholeWord = 2, WordEnd = 3 };

    SnippetClipboardVariable() = default;
    explicit SnippetClipboardVariable(const VariableParams& params);
    std::u16string toString() const override;

    Text find;
    Text replacement;
    bool regularExpressions = false;
    MatchingOption matchingOption = MatchingOption::Anywhere;
    bool matchCase = false;
};

// Another snippet, named by its abbreviation or its UUID.
class SnippetAbbreviationVariable final : public SnippetVariable {
  public:
    SnippetAbbreviationVariable() = default;
    explicit SnippetAbbreviationVariable(const VariableParams& params);
    std::u16string toString() const override;

    Text abbreviation;
    Text uuid;
    // Set by the parser when the included snippet is a script.
    std::shared_ptr<Snippet> snippet;
    std::size_t scriptLength = 0;  // of its expanded text in the content
    bool isAppleScript = false;
};

}  // namespace plume
