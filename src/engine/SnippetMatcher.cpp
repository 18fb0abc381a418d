#include "engine/SnippetMatcher.h"

#include <algorithm>
#include <tuple>
#include <utility>

#include "Foundation/Strings.h"
#include "engine/AbbreviationIndex.h"

namespace plume {

namespace {

using Candidate = AbbreviationIndex::Candidate;
using IndexedGroup = AbbreviationIndex::IndexedGroup;
using Trigger = AbbreviationIndex::Trigger;

constexpr char16_t ObjectReplacementCharacter = 0xfffc;

// Where the key went, asked at most once for a key.
class Destination {
  public:
    explicit Destination(const MatchContext& context) : context_(context) {}

    bool isAdmittedBy(const PLFunctionAvailability& availability) {
        if (availability.availability != PLFunctionAvailability::Everywhere) {
            if (!application_) application_ = context_.bundleIdentifier();
            if (!availability.admitsApplication(*application_)) return false;
        }
        if (availability.inputMethodsOption != PLFunctionAvailability::Everywhere) {
            if (!inputSource_) inputSource_ = context_.inputSourceIdentifier();
            if (!availability.admitsInputSource(*inputSource_)) return false;
        }
        return true;
    }

  private:
    const MatchContext& context_;
    std::optional<std::optional<std::u16string>> application_;
    std::optional<std::optional<std::u16string>> inputSource_;
};

bool standsAt(std::u16string_view text, std::size_t position, std::u16string_view prefix) {
    return equalsIgnoringCase(text.substr(position, prefix.size()), prefix);
}

// The closest occurrence of the prefix that starts before `position` and reaches past it, or NotFound.
std::size_t overlappingOccurrenceBefore(std::u16string_view text, std::size_t position, std::u16string_view prefix) {
    const std::size_t first = position >= prefix.size() ? position - prefix.size() + 1 : 0;
    for (std::size_t start = position; start > first; --start) {
        if (standsAt(text, start - 1, prefix)) return start - 1;
    }
    return NotFound;
}

// Whether a search for the prefix from the left, in which occurrences do not overlap, comes upon the one at `position`.
// It is decided by the chain of occurrences that overlap each other on the way there: its first one is always found.
bool isFoundFromLeft(std::u16string_view text, std::size_t position, std::u16string_view prefix) {
    std::size_t found = position;
    for (std::size_t before; (before = overlappingOccurrenceBefore(text, found, prefix)) != NotFound;) found = before;
    while (found < position) {
        found += prefix.size();
        while (found < position && !standsAt(text, found, prefix)) ++found;
    }
    return found == position;
}

bool matchesPrefixed(const SnippetMatcher& matcher, const Candidate& candidate, std::u16string_view text) {
    const IndexedGroup& group = *candidate.group;
    const Snippet& snippet = **candidate.snippet;
    const std::size_t start = text.size() - candidate.length;
    const std::u16string_view typed = text.substr(start);
    if (!standsAt(text, start, group.prefix)) return false;
    if (!equalsIgnoringCase(typed.substr(group.prefix.size()), *snippet.abbreviation())) return false;
    if (!matcher.checkGroup(*group.group, text, start)) return false;
    if (group.prefixOverlapsItself && !isFoundFromLeft(text, start, group.prefix)) return false;
    return snippet.caseSensitivity() != CaseSensitivity::CaseSensitive || typed == snippet.abbreviationWithPrefix();
}

bool matchesPlain(const SnippetMatcher& matcher, const Candidate& candidate, std::u16string_view text) {
    const Snippet& snippet = **candidate.snippet;
    const bool caseSensitive = snippet.caseSensitivity() == CaseSensitivity::CaseSensitive;
    return matcher.checkAbbreviation(*snippet.abbreviation(), text, *candidate.group->group, caseSensitive).has_value();
}

// Library order; within a group with a prefix the occurrences of the prefix from left to right first.
auto orderOf(const Candidate& candidate, std::size_t textLength) {
    const std::size_t occurrence = candidate.group->prefix.empty() ? 0 : textLength - candidate.length;
    return std::tuple(candidate.group->order, occurrence, candidate.rank);
}

}  // namespace

SnippetMatcher::SnippetMatcher(CharacterSet defaultDelimiters)
    : defaultDelimiters_(std::move(defaultDelimiters)),
      index_(std::make_unique<AbbreviationIndex>(defaultDelimiters_)) {}

SnippetMatcher::~SnippetMatcher() = default;

void SnippetMatcher::setSnippetGroups(const Groups& groups) {
    index_->setGroups(groups);
}

std::vector<SnippetMatcher::Match> SnippetMatcher::findSnippetsInLetters(std::u16string_view letters, char16_t trigger,
                                                                         std::u16string_view lettersWithoutSeparator,
                                                                         const MatchContext& context) const {
    std::vector<std::pair<Candidate, std::u16string_view>> found;
    std::vector<Candidate> candidates;
    Destination destination(context);

    const auto collect = [&](Trigger way, std::u16string_view text) {
        candidates.clear();
        index_->collectCandidates(way, text, candidates);
        for (const Candidate& candidate : candidates) {
            const SnippetGroup& group = *candidate.group->group;
            if (way == Trigger::Delimiter && !group.delimiters().value_or(defaultDelimiters_).contains(trigger))
                continue;
            if (!(*candidate.snippet)->hasContent() || !destination.isAdmittedBy(group.availability())) continue;
            const bool matches = candidate.group->prefix.empty() ? matchesPlain(*this, candidate, text)
                                                                 : matchesPrefixed(*this, candidate, text);
            if (matches) found.emplace_back(candidate, text);
        }
    };
    if (trigger == 0) {
        collect(Trigger::HotKey, lettersWithoutSeparator);
    } else {
        collect(Trigger::Immediately, letters);
        if (index_->isDelimiter(trigger)) collect(Trigger::Delimiter, lettersWithoutSeparator);
    }

    std::sort(found.begin(), found.end(), [](const auto& a, const auto& b) {
        return orderOf(a.first, a.second.size()) < orderOf(b.first, b.second.size());
    });
    std::vector<Match> matches;
    matches.reserve(found.size());
    for (const auto& [candidate, text] : found) {
        matches.push_back({*candidate.snippet, std::u16string(text.substr(text.size() - candidate.length))});
    }
    return matches;
}

bool SnippetMatcher::checkGroup(const SnippetGroup& group, std::u16string_view text, std::size_t index) const {
    const ExpandAfter rule = group.expandAfter();
    if (rule == ExpandAfter::Anything) return true;
    if (index == 0) return rule != ExpandAfter::Digits;
    const char16_t before = text[index - 1];
    if (before == ObjectReplacementCharacter) return true;
    switch (rule) {
        case ExpandAfter::Delimiter: {
            const char16_t delimiter = before == u'\n' ? u'\r' : before;
            const auto& own = group.expandAfterDelimiters();
            return (own ? *own : defaultDelimiters_).contains(delimiter);
        }
        case ExpandAfter::Whitespace:
            return CharacterSet::whitespacesAndNewlines().contains(before);
        case ExpandAfter::Digits: {
            const CharacterSet& digits = CharacterSet::decimalDigits();
            std::size_t start = index;
            while (start > 0 && digits.contains(text[start - 1])) --start;
            if (start == 0) return true;
            if (start == index) return false;
            const char16_t edge = text[start - 1];
            return CharacterSet::whitespacesAndNewlines().contains(edge) || defaultDelimiters_.contains(edge);
        }
        case ExpandAfter::Anything:
            break;
    }
    return false;
}

std::optional<std::u16string_view> SnippetMatcher::checkAbbreviation(std::u16string_view abbreviation,
                                                                     std::u16string_view letters,
                                                                     const SnippetGroup& group,
                                                                     bool caseSensitive) const {
    const std::size_t start = letters.size() - abbreviation.size();
    if (!checkGroup(group, letters, start)) return std::nullopt;
    const std::u16string_view typed = letters.substr(start);
    const bool equal = caseSensitive ? typed == abbreviation : equalsIgnoringCase(typed, abbreviation);
    return equal ? std::optional(typed) : std::nullopt;
}

}  // namespace plume
