// A changed copy of an expanded content, plain or rich, made in one walk from its start to its end.
#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>

#include "content/AttributedStringRewriter.h"
#include "content/SnippetExpandedContent.h"

namespace plume {

// Positions are those of the source and only grow; the source must outlive the rewriter.
class ContentRewriter {
  public:
    using Content = SnippetExpandedContent::Content;

    explicit ContentRewriter(const Content& source);

    bool isRich() const { return rich_.has_value(); }
    // Takes over what stands between the present position and this one.
    void copyTo(std::size_t position);
    // Leaves it out.
    void skipTo(std::size_t position);
    // Attributes count in rich content only.
    void append(std::u16string_view text, const SharedAttributes& attributes);
    void append(const AttributedString& text);

    std::size_t resultLength() const { return rich_ ? rich_->resultLength() : text_.size(); }
    // The result, with the rest of the source taken over.
    Content finish();

  private:
    std::optional<AttributedStringRewriter> rich_;
    // For plain content.
    std::u16string_view rest_;
    std::size_t position_ = 0;
    std::u16string text_;
};

}  // namespace plume
