#include "content/ExpansionContext.h"

#include <algorithm>
#include <string_view>
#include <vector>

#include "Foundation/text/RTFD.h"
#include "content/SystemTimeZone.h"

namespace plume {

namespace {

// Equal keys exactly for placeholders that name a snippet in the same way.
std::u16string lookupKey(const SnippetAbbreviationVariable& variable) {
    constexpr char16_t Absent = u'-';
    constexpr char16_t Present = u'+';
    std::u16string key;
    for (const auto* part : {&variable.uuid, &variable.abbreviation}) {
        key.push_back(*part ? Present : Absent);
        if (*part) key.append(**part);
        key.push_back(u'\0');
    }
    return key;
}

// The richest form that the pasteboard offers and that can be read.
std::optional<AttributedString> readRichText(const PasteboardReader& pasteboard) {
    const std::vector<std::string> types = pasteboard.types();
    for (const std::string_view type : {PasteboardType::RTFD, PasteboardType::RTF}) {
        if (std::find(types.begin(), types.end(), type) == types.end()) continue;
        const std::optional<std::string> data = pasteboard.data(type);
        if (!data) continue;
        Result<AttributedString> text =
            type == PasteboardType::RTFD ? attributedStringFromRTFD(*data) : attributedStringFromRTF(*data);
        if (text) return std::move(text).value();
    }
    return std::nullopt;
}

}  // namespace

ExpansionContext::ExpansionContext(const ContentEnvironment& anEnvironment, const std::shared_ptr<Snippet>& aSnippet,
                                   const Groups& groups)
    : environment_(anEnvironment), snippet_(aSnippet), groups_(groups) {}

bool ExpansionContext::giveUp() {
    exhausted_ = true;
    return false;
}

bool ExpansionContext::takeReplacement() {
    if (exhausted_ || replacementsLeft_ == 0) return giveUp();
    --replacementsLeft_;
    return true;
}

bool ExpansionContext::takeUnits(std::size_t count) {
    if (exhausted_ || unitsLeft_ < count) return giveUp();
    unitsLeft_ -= count;
    return true;
}

bool ExpansionContext::enterScript() {
    if (exhausted_ || scriptDepth_ == MaximumScriptDepth) return giveUp();
    ++scriptDepth_;
    return true;
}

void ExpansionContext::settleTimeZone() {
    static SystemTimeZone system;
    if (!timeZoneSettled_ && environment_.timeZone.empty()) system.follow();
    timeZoneSettled_ = true;
}

std::shared_ptr<Snippet> ExpansionContext::nestedSnippet(const SnippetAbbreviationVariable& variable) {
    const auto [entry, isNew] = found_.try_emplace(lookupKey(variable));
    if (isNew) {
        entry->second = findSnippetBySnippetAbbreviationVariable(variable, *snippet_, groups_);
        if (entry->second == snippet_) entry->second = nullptr;
    }
    return entry->second;
}

const std::optional<std::u16string>& ExpansionContext::clipboardText() {
    if (!clipboardText_) {
        clipboardText_.emplace();
        if (environment_.pasteboard != nullptr) *clipboardText_ = environment_.pasteboard->string();
    }
    return *clipboardText_;
}

const std::optional<AttributedString>& ExpansionContext::richClipboard() {
    if (!richClipboard_) {
        richClipboard_.emplace();
        if (environment_.pasteboard != nullptr) *richClipboard_ = readRichText(*environment_.pasteboard);
    }
    return *richClipboard_;
}

}  // namespace plume
