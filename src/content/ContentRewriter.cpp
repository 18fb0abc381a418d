#include "content/ContentRewriter.h"

#include <algorithm>
#include <utility>
#include <variant>

namespace plume {

ContentRewriter::ContentRewriter(const Content& source) {
    if (const auto* richSource = std::get_if<AttributedString>(&source)) {
        rich_.emplace(*richSource);
    } else {
        rest_ = std::get<std::u16string>(source);
        text_.reserve(rest_.size());
    }
}

void ContentRewriter::copyTo(std::size_t position) {
    if (rich_) {
        rich_->copyTo(position);
    } else if (position > position_) {
        text_.append(rest_.substr(0, position - position_));
        skipTo(position);
    }
}

void ContentRewriter::skipTo(std::size_t position) {
    if (rich_) {
        rich_->skipTo(position);
    } else if (position > position_) {
        rest_.remove_prefix(std::min(position - position_, rest_.size()));
        position_ = position;
    }
}

void ContentRewriter::append(std::u16string_view text, const SharedAttributes& attributes) {
    if (rich_) {
        rich_->append(text, attributes);
    } else {
        text_.append(text);
    }
}

void ContentRewriter::append(const AttributedString& text) {
    if (rich_) {
        rich_->append(text);
    } else {
        text_.append(text.string());
    }
}

ContentRewriter::Content ContentRewriter::finish() {
    if (rich_) return rich_->finish();
    text_.append(rest_);
    return std::move(text_);
}

}  // namespace plume
