#include "content/PLOutput.h"

#include <utility>
#include <variant>

namespace plume {

namespace {

// `piece` makes the fragment of a range of the content.
template <class Piece>
std::vector<PLOutput::Fragment> cut(const SnippetExpandedContent& content, Piece piece) {
    std::vector<PLOutput::Fragment> fragments;
    std::vector<DeliveryStep> steps = content.deliverySteps();
    for (DeliveryStep& step : steps) {
        // A content without keys is one piece, even when it is empty.
        if (step.text.length > 0 || steps.size() == 1) fragments.push_back(piece(step.text));
        if (step.key) fragments.emplace_back(std::move(step.key));
    }
    return fragments;
}

}  // namespace

void PLOutput::refreshFragments() {
    fragments.clear();
    if (!snippetExpandedContent) return;
    fragments = snippetExpandedContent->isRich() ? fragmentsForRichTextSnippet(*snippetExpandedContent)
                                                 : fragmentsForPlainTextSnippet(*snippetExpandedContent);
}

std::vector<PLOutput::Fragment> PLOutput::fragmentsForPlainTextSnippet(const SnippetExpandedContent& content) {
    const std::u16string& text = content.string();
    return cut(content, [&](const Range& range) { return text.substr(range.location, range.length); });
}

std::vector<PLOutput::Fragment> PLOutput::fragmentsForRichTextSnippet(const SnippetExpandedContent& content) {
    const auto* rich = std::get_if<AttributedString>(&content.content);
    if (rich == nullptr) return fragmentsForPlainTextSnippet(content);
    return cut(content, [&](const Range& range) { return rich->substring(range); });
}

}  // namespace plume
