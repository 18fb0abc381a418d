#include "input/delivery/OutputFragments.h"

#include <algorithm>
#include <memory>
#include <variant>

#include "Foundation/CharacterSet.h"
#include "input/delivery/StepCounts.h"

namespace plume {

namespace {

constexpr std::uint64_t DefaultBlockLength = 20;

bool isOwnChunk(char16_t unit) {
    return unit == u'\t' || CharacterSet::newlines().contains(unit);
}

void typeRichText(std::vector<PLOutput::Fragment>& fragments) {
    for (PLOutput::Fragment& fragment : fragments) {
        if (const auto* rich = std::get_if<AttributedString>(&fragment)) fragment = std::u16string(rich->string());
    }
}

std::uint64_t arrowsToCaret(const SnippetExpandedContent& content) {
    const std::int64_t behindCaret = content.caretDistanceFromEndingIgnoreKeys();
    // A caret located past the end asks for no arrows.
    if (behindCaret < 0) return 0;
    const std::u16string_view text = content.string();
    const auto length = static_cast<std::size_t>(behindCaret);
    const auto typedByKeys = static_cast<std::uint64_t>(content.caretDistanceFromEnding() - behindCaret);
    return leftArrowsFor(text.substr(text.size() - length)) + typedByKeys;
}

}  // namespace

std::vector<std::u16string> fragmentsForPlainText(std::u16string_view text, const ContextInputSetting& setting) {
    const std::size_t block = setting.blockLength == 0 ? DefaultBlockLength : setting.blockLength;
    std::vector<std::u16string> chunks;
    while (!text.empty()) {
        // Only the first unit of a chunk is looked at: a newline further on stays inside.
        const std::size_t length = isOwnChunk(text.front()) ? 1 : std::min(block, text.size());
        chunks.emplace_back(text.substr(0, length));
        text.remove_prefix(length);
    }
    return chunks;
}

std::vector<PLOutput::Fragment> fragmentsForOutputFragments(const std::vector<PLOutput::Fragment>& fragments,
                                                            const ContextInputSetting& setting) {
    std::vector<PLOutput::Fragment> result;
    for (const auto& fragment : fragments) {
        const auto* text = std::get_if<std::u16string>(&fragment);
        if (!text) {
            result.push_back(fragment);
            continue;
        }
        for (auto& chunk : fragmentsForPlainText(*text, setting)) result.emplace_back(std::move(chunk));
    }
    return result;
}

void refreshFragmentsForOuput(PLOutput& output, const ContextInputSetting& setting) {
    const auto& content = output.snippetExpandedContent;
    output.leftArrowCount = content ? arrowsToCaret(*content) : 0;
    output.refreshFragments();
    if (!setting.canPaste()) typeRichText(output.fragments);
    if (content && (!content->isRich() || !setting.canPaste()) && !setting.has(InputFlag::UseClipboard)) {
        output.fragments = fragmentsForOutputFragments(output.fragments, setting);
    }
}

std::uint64_t eventCountForOutput(const PLOutput& output) {
    std::uint64_t count = output.backspaceCount + output.leftArrowCount;
    for (const auto& fragment : output.fragments) {
        if (std::holds_alternative<std::u16string>(fragment)) ++count;
        if (const auto* key = std::get_if<std::shared_ptr<SnippetKeyVariable>>(&fragment)) count += (*key)->count;
    }
    return count;
}

}  // namespace plume
