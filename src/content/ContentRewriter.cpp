#include "content/ContentRewriter.h"

#include <algorithm>
#include <variant>

namespace plume {

// ---- AttributedStringRewriter ----

void AttributedStringRewriter::copyTo(std::size_t position) {
    const std::u16string_view text = source_.string();
    const auto& runs = source_.runs();
    position = std::min(position, text.size());
    while (position_ < position) {
        const std::size_t piece = std::min(runLeft(), position - position_);
        result_.append(text.substr(position_, piece), runs[run_].attributes);
        skipTo(position_ + piece);
    }
}

void AttributedStringRewriter::skipTo(std::size_t position) {
    const std::size_t end = std::min(position, source_.length());
    while (position_ < end) {
        const std::size_t piece = std::min(runLeft(), end - position_);
        position_ += piece;
        offsetInRun_ += piece;
        if (runLeft() > 0) continue;
        ++run_;
        offsetInRun_ = 0;
    }
}

SharedAttributes AttributedStringRewriter::attributes() const {
    const auto& runs = source_.runs();
    if (runs.empty()) return nullptr;
    return runs[std::min(run_, runs.size() - 1)].attributes;
}

SharedAttributes AttributedStringRewriter::attributesBefore() const {
    const bool startsRun = offsetInRun_ == 0 && run_ > 0;
    return startsRun ? source_.runs()[run_ - 1].attributes : attributes();
}

AttributedString AttributedStringRewriter::finish() {
    copyTo(source_.length());
    return std::move(result_);
}

// ---- ContentRewriter ----

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
