#include "engine/SuggestionFinder.h"

#include <algorithm>
#include <string>

#include "Foundation/CharacterSet.h"
#include "Foundation/Strings.h"

namespace plume {

namespace {

constexpr std::uint8_t AfterNoAlphanumeric = 1;
constexpr std::uint8_t AfterWhitespace = 2;
constexpr std::uint8_t AfterAnything = 4;
constexpr std::uint8_t AfterDigit = 8;
constexpr std::uint8_t AfterNothing = 16;
constexpr std::uint8_t EveryRule = 31;

// Most of the time goes into reading snippets that lie anywhere in memory: several are read at once.
constexpr std::size_t FetchedAhead = 12;

void fetchAhead(const Snippet& snippet) {
    constexpr std::size_t CacheLine = 64;
    constexpr std::size_t ReadLines = 3;  // of a snippet, for its abbreviation and whether it has a content
    const char* const start = reinterpret_cast<const char*>(&snippet);
    for (std::size_t line = 0; line < ReadLines; ++line) __builtin_prefetch(start + line * CacheLine);
}

}  // namespace

SuggestionFinder::SuggestionFinder(const AbbreviationIndex& index, const AbbreviationIndex::Groups& groups)
    : index_(index) {
    for (const auto& group : groups) {
        const AbbreviationIndex::IndexedGroup* indexed = index.indexedGroup(*group);
        if (!indexed) continue;
        if (indexed->order >= rules_.size()) rules_.resize(indexed->order + 1);
        rulesOfAll_ |= rules_[indexed->order] = ruleOf(*group);
    }
}

SuggestionFinder::Rules SuggestionFinder::ruleOf(const SnippetGroup& group) {
    switch (group.expandAfter()) {
        case ExpandAfter::Delimiter:
            return AfterNoAlphanumeric;
        case ExpandAfter::Whitespace:
            return AfterWhitespace;
        case ExpandAfter::Anything:
            return AfterAnything;
        case ExpandAfter::Digits:
            return AfterDigit;
    }
    return AfterNothing;
}

SuggestionFinder::Rules SuggestionFinder::rulesAdmitting(char16_t before) {
    Rules rules = AfterAnything;
    if (!CharacterSet::alphanumerics().contains(before)) rules |= AfterNoAlphanumeric;
    if (CharacterSet::whitespacesAndNewlines().contains(before)) rules |= AfterWhitespace;
    if (CharacterSet::decimalDigits().contains(before)) rules |= AfterDigit;
    return rules;
}

void SuggestionFinder::find(std::u16string_view letters, SuggestionList& suggestions) {
    letters_ = letters;
    for (std::size_t length = std::min(letters.size(), index_.longest()); length > 0; --length) lookForLast(length);

    std::sort(prefixed_.begin(), prefixed_.end(), [](const Found& a, const Found& b) {
        return a.place != b.place ? a.place < b.place : a.length > b.length;
    });
    for (const Found& found : prefixed_) {
        suggestions.append(*found.snippet, std::u16string(letters.substr(letters.size() - found.length)));
    }
    for (const Found& found : plain_) {
        suggestions.append(*found.snippet, (*found.snippet)->abbreviation()->substr(0, found.length));
    }
}

void SuggestionFinder::lookForLast(std::size_t length) {
    const std::size_t start = letters_.size() - length;
    admitting_ = start == 0 ? EveryRule : rulesAdmitting(letters_[start - 1]);
    if ((admitting_ & rulesOfAll_) == 0) return;
    typed_ = letters_.substr(start);
    candidates_.clear();
    index_.visitBeginnings(typed_, *this);
    // What is found for one length is equal but for its case: library order decides. It is also the order in which the
    // snippets are read fastest.
    std::sort(candidates_.begin(), candidates_.end(),
              [](const Candidate& a, const Candidate& b) { return a.place < b.place; });
    for (std::size_t i = 0; i < candidates_.size(); ++i) {
        if (i + FetchedAhead < candidates_.size()) fetchAhead(**candidates_[i + FetchedAhead].snippet);
        const Candidate& candidate = candidates_[i];
        if (!beginsWithTyped(candidate)) continue;
        const Found found{candidate.place, length, candidate.snippet};
        if (!candidate.group->prefix.empty()) {
            prefixed_.push_back(found);
        } else if (!isFoundForMore(found.place)) {
            plain_.push_back(found);
        }
    }
    if (plain_.size() > (ends_.empty() ? 0 : ends_.back())) ends_.push_back(plain_.size());
}

void SuggestionFinder::visit(const AbbreviationIndex::Candidate& candidate) {
    const AbbreviationIndex::IndexedGroup& group = *candidate.group;
    if (group.order >= rules_.size() || (rules_[group.order] & admitting_) == 0) return;
    candidates_.push_back({std::uint64_t{group.order} << 32 | candidate.rank, &group, candidate.snippet});
}

bool SuggestionFinder::beginsWithTyped(const Candidate& candidate) const {
    const std::u16string& prefix = candidate.group->prefix;
    if (typed_.size() < prefix.size()) return false;
    const Snippet& snippet = **candidate.snippet;
    const auto& abbreviation = snippet.abbreviation();
    const std::u16string_view rest = typed_.substr(prefix.size());
    if (!snippet.hasContent() || !abbreviation || abbreviation->empty() || abbreviation->size() < rest.size()) {
        return false;
    }
    const std::u16string_view beginning = std::u16string_view(*abbreviation).substr(0, rest.size());
    if (rest == beginning && typed_.starts_with(prefix)) return true;
    return snippet.caseSensitivity() != CaseSensitivity::CaseSensitive && equalsIgnoringCase(rest, beginning) &&
           equalsIgnoringCase(typed_.substr(0, prefix.size()), prefix);
}

// For a longer end of the letters: they are looked at first.
bool SuggestionFinder::isFoundForMore(std::uint64_t place) const {
    const auto isBefore = [](const Found& found, std::uint64_t wanted) { return found.place < wanted; };
    auto start = plain_.begin();
    for (const std::size_t endIndex : ends_) {
        const auto end = plain_.begin() + static_cast<std::ptrdiff_t>(endIndex);
        const auto found = std::lower_bound(start, end, place, isBefore);
        if (found != end && found->place == place) return true;
        start = end;
    }
    return false;
}

}  // namespace plume
