#include "content/ScannedText.h"

#include <algorithm>

#include "content/ClipboardReplacement.h"

namespace plume {

namespace {

// Counts what find-and-replace has added to the clipboard's text, which is counted already.
void takeGrowth(std::size_t before, std::size_t after, ExpansionContext& context) {
    if (after > before) context.takeUnits(after - before);
}

}  // namespace

// ---- PendingText ----

void PendingText::putBack(std::u16string_view text) {
    if (text.empty()) return;
    const std::size_t room = buffer_.empty() ? 0 : static_cast<std::size_t>(rest_.data() - buffer_.data());
    if (room < text.size()) {
        // As much room in front as there is text, so that the next growth is far away.
        std::vector<char16_t> grown(2 * (text.size() + rest_.size()));
        std::copy_backward(rest_.begin(), rest_.end(), grown.end());
        rest_ = {grown.data() + grown.size() - rest_.size(), rest_.size()};
        buffer_ = std::move(grown);
    }
    char16_t* const start = buffer_.data() + (buffer_.size() - rest_.size() - text.size());
    std::copy(text.begin(), text.end(), start);
    rest_ = {start, text.size() + rest_.size()};
}

// ---- PlainScannedText ----

PlainScannedText::PlainScannedText(std::u16string_view text) : pending_(text) {
    finished_.reserve(text.size());
}

void PlainScannedText::keep(std::size_t count) {
    finished_.append(pending_.rest().substr(0, count));
    pending_.take(count);
}

void PlainScannedText::write(const ClipboardValue& value, const SharedAttributes&) {
    if (value.text) finished_.append(*value.text);
}

void PlainScannedText::putBack(const Snippet& nested, const SharedAttributes&) {
    if (nested.richTextContent()) pending_.putBack(nested.richTextContent()->string());
}

ClipboardValue PlainScannedText::clipboardValue(const SnippetClipboardVariable& variable, ExpansionContext& context) {
    const std::optional<std::u16string>& text = context.clipboardText();
    if (!text || !context.takeUnits(text->size())) return {};
    std::u16string value = processClipboardVariable(variable, *text, context.environment(), context.patternTimeLeft());
    takeGrowth(text->size(), value.size(), context);
    return {std::move(value), std::nullopt};
}

// ---- RichScannedText ----

RichScannedText::RichScannedText(const AttributedString& text) : pending_(text.string()) {
    putBackRuns(text);
}

void RichScannedText::putBackRuns(const AttributedString& text) {
    pendingRuns_.insert(pendingRuns_.end(), text.runs().rbegin(), text.runs().rend());
}

std::size_t RichScannedText::takeFromRun(std::size_t count) {
    AttributedString::Run& run = pendingRuns_.back();
    const std::size_t taken = std::min(count, run.length);
    run.length -= taken;
    if (run.length == 0) pendingRuns_.pop_back();
    pending_.take(taken);
    return taken;
}

void RichScannedText::keep(std::size_t count) {
    while (count > 0) {
        const std::u16string_view text = pending_.rest().substr(0, std::min(count, pendingRuns_.back().length));
        finished_.append(text, pendingRuns_.back().attributes);
        count -= takeFromRun(count);
    }
}

void RichScannedText::drop(std::size_t count) {
    while (count > 0) count -= takeFromRun(count);
}

void RichScannedText::write(const ClipboardValue& value, const SharedAttributes& attributes) {
    if (value.richText) {
        finished_.append(*value.richText);
    } else if (value.text) {
        finished_.append(*value.text, attributes);
    }
}

void RichScannedText::putBack(const Snippet& nested, const SharedAttributes& attributes) {
    if (!nested.richTextContent() || nested.richTextContent()->isEmpty()) return;
    const AttributedString& content = *nested.richTextContent();
    pending_.putBack(content.string());
    if (nested.contentType() == ContentType::RichText) {
        putBackRuns(content);
    } else {
        pendingRuns_.push_back({content.length(), attributes});
    }
}

ClipboardValue RichScannedText::clipboardValue(const SnippetClipboardVariable& variable, ExpansionContext& context) {
    const std::optional<AttributedString>& richText = context.richClipboard();
    if (!richText) return PlainScannedText::clipboardValue(variable, context);
    if (!context.takeUnits(richText->length())) return {};
    AttributedString value =
        processClipboardVariable(variable, *richText, context.environment(), context.patternTimeLeft());
    takeGrowth(richText->length(), value.length(), context);
    return {std::nullopt, std::move(value)};
}

}  // namespace plume
