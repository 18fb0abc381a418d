// Changed copies of a text, made in one walk from its start to its end: linear however many pieces change.
#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <utility>

#include "Foundation/text/AttributedString.h"
#include "content/SnippetExpandedContent.h"

namespace plume {

// Rich text. Positions are those of the source and only grow; the source must outlive the rewriter.
class AttributedStringRewriter {
  public:
    explicit AttributedStringRewriter(const AttributedString& source) : source_(source) {}

    // Takes over what stands between the present position and this one.
    void copyTo(std::size_t position);
    // Leaves it out.
    void skipTo(std::size_t position);
    void append(std::u16string_view text, SharedAttributes attributes) { result_.append(text, std::move(attributes)); }
    void append(const AttributedString& text) { result_.append(text); }

    // Those of the source's unit at the present position; at its end those of its last unit.
    SharedAttributes attributes() const;
    // Those of the unit before the present position; at its start those of its first unit.
    SharedAttributes attributesBefore() const;

    std::size_t resultLength() const { return result_.length(); }

    // The result, with the rest of the source taken over.
    AttributedString finish();

  private:
    std::size_t runLeft() const { return source_.runs()[run_].length - offsetInRun_; }

    const AttributedString& source_;
    AttributedString result_;
    std::size_t position_ = 0;
    std::size_t run_ = 0;
    std::size_t offsetInRun_ = 0;
};

// An expanded content, plain or rich. Positions as above.
class ContentRewriter {
  public:
    using Content = SnippetExpandedContent::Content;

    explicit ContentRewriter(const Content& source);

    bool isRich() const { return rich_.has_value(); }
    void copyTo(std::size_t position);
    void skipTo(std::size_t position);
    // Attributes count in rich content only.
    void append(std::u16string_view text, const SharedAttributes& attributes);
    void append(const AttributedString& text);

    std::size_t resultLength() const { return rich_ ? rich_->resultLength() : text_.size(); }
    Content finish();

  private:
    std::optional<AttributedStringRewriter> rich_;
    // For plain content.
    std::u16string_view rest_;
    std::size_t position_ = 0;
    std::u16string text_;
};

}  // namespace plume
