#include "ports/simulated/SimulatedTextField.h"

#include <unicode/ubrk.h>

#include <algorithm>
#include <memory>
#include <utility>

namespace plume {

namespace {

using Characters = std::unique_ptr<UBreakIterator, decltype(&ubrk_close)>;

Characters charactersOf(const std::u16string& text) {
    UErrorCode status = U_ZERO_ERROR;
    return {ubrk_open(UBRK_CHARACTER, "root", text.data(), static_cast<std::int32_t>(text.size()), &status),
            &ubrk_close};
}

}  // namespace

Range SimulatedTextField::selection() const {
    const std::size_t start = std::min(caret_, anchor_);
    return {start, std::max(caret_, anchor_) - start};
}

std::u16string SimulatedTextField::selectedText() const {
    return text_.substr(selection().location, selection().length);
}

void SimulatedTextField::setText(std::u16string text) {
    text_ = std::move(text);
    caret_ = anchor_ = text_.size();
}

void SimulatedTextField::select(Range range) {
    anchor_ = std::min(range.location, text_.size());
    caret_ = anchor_ + std::min(range.length, text_.size() - anchor_);
}

void SimulatedTextField::insert(std::u16string_view text) {
    const Range replaced = selection();
    text_.replace(replaced.location, replaced.length, text);
    caret_ = anchor_ = replaced.location + text.size();
}

void SimulatedTextField::deleteBackward() {
    if (caret_ == anchor_) anchor_ = previousCharacter(caret_);
    insert({});
}

void SimulatedTextField::deleteForward() {
    if (caret_ == anchor_) anchor_ = nextCharacter(caret_);
    insert({});
}

void SimulatedTextField::move(Movement movement, bool extending) {
    const Range selected = selection();
    const bool collapses = !extending && selected.length > 0;
    const bool backward = movement == Movement::Left || movement == Movement::Up || movement == Movement::LineStart;
    if (collapses) caret_ = backward ? selected.location : selected.end();
    const bool arrivesByCollapsing = collapses && (movement == Movement::Left || movement == Movement::Right);
    if (!arrivesByCollapsing) caret_ = target(movement, caret_);
    if (!extending) anchor_ = caret_;
}

std::size_t SimulatedTextField::target(Movement movement, std::size_t from) const {
    const std::size_t start = lineStart(from);
    const std::size_t end = lineEnd(from);
    switch (movement) {
        case Movement::Left:
            return previousCharacter(from);
        case Movement::Right:
            return nextCharacter(from);
        case Movement::LineStart:
            return start;
        case Movement::LineEnd:
            return end;
        case Movement::Up:
            return start == 0 ? 0 : std::min(lineStart(start - 1) + (from - start), start - 1);
        case Movement::Down:
            return end == text_.size() ? end : std::min(end + 1 + (from - start), lineEnd(end + 1));
    }
    return from;
}

std::size_t SimulatedTextField::previousCharacter(std::size_t from) const {
    const std::int32_t found = ubrk_preceding(charactersOf(text_).get(), static_cast<std::int32_t>(from));
    return found == UBRK_DONE ? 0 : static_cast<std::size_t>(found);
}

std::size_t SimulatedTextField::nextCharacter(std::size_t from) const {
    const std::int32_t found = ubrk_following(charactersOf(text_).get(), static_cast<std::int32_t>(from));
    return found == UBRK_DONE ? text_.size() : static_cast<std::size_t>(found);
}

std::size_t SimulatedTextField::lineStart(std::size_t from) const {
    if (from == 0) return 0;
    const std::size_t lineFeed = text_.rfind(u'\n', from - 1);
    return lineFeed == std::u16string::npos ? 0 : lineFeed + 1;
}

std::size_t SimulatedTextField::lineEnd(std::size_t from) const {
    return std::min(text_.find(u'\n', from), text_.size());
}

}  // namespace plume
