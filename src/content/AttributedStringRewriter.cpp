#include "content/AttributedStringRewriter.h"

#include <algorithm>

namespace plume {

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

}  // namespace plume
