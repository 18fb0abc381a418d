#include "engine/SnippetMatcher.h"

#include <algorithm>
#include <cstddef>
#include <tuple>
#include <utility>
#include <vector>

#include "Foundation/Strings.h"
#include "engine/AbbreviationIndex.h"
#include "engine/SuggestionFinder.h"

namespace plume {

namespace {

using Candidate = AbbreviationIndex::Candidate;
using IndexedGroup = AbbreviationIndex::IndexedGroup;
using Trigger = AbbreviationIndex::Trigger;

constexpr char16_t ObjectReplacementCharacter = 0xfffc;

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

// A snippet tells one group of a new abbreviation; another that lists it has it filed under the former one.
bool isUpToDate(const Candidate& candidate) {
    const auto& abbreviation = (*candidate.snippet)->abbreviation();
    return abbreviation && candidate.group->prefix.size() + abbreviation->size() == candidate.length;
}

// The abbreviation with its prefix is really there, if perhaps in another case.
bool isTyped(const Candidate& candidate, std::u16string_view text) {
    const std::u16string& prefix = candidate.group->prefix;
    const std::u16string_view typed = text.substr(text.size() - candidate.length);
    return standsAt(typed, 0, prefix) &&
           equalsIgnoringCase(typed.substr(prefix.size()), *(*candidate.snippet)->abbreviation());
}

bool isTypedInItsCase(const Candidate& candidate, std::u16string_view text) {
    const Snippet& snippet = **candidate.snippet;
    if (snippet.caseSensitivity() != CaseSensitivity::CaseSensitive) return true;
    const std::u16string_view typed = text.substr(text.size() - candidate.length);
    return candidate.group->prefix.empty() ? typed == *snippet.abbreviation()
                                           : typed == snippet.abbreviationWithPrefix();
}

// What MatchDecision calls that which must stand before the abbreviation.
std::u16string_view nameOf(ExpandAfter rule) {
    switch (rule) {
        case ExpandAfter::Delimiter:
            return MatchDecision::AfterDelimiter;
        case ExpandAfter::Whitespace:
            return MatchDecision::AfterWhitespace;
        case ExpandAfter::Digits:
            return MatchDecision::AfterDigits;
        case ExpandAfter::Anything:
            break;
    }
    return {};
}

// One look through the library for one key: the rules, applied to the index's candidates.
class Search final : public AbbreviationIndex::Visitor {
  private:
    using Verdict = DecisionLog::Verdict;
    struct Found {
        Candidate candidate;
        std::u16string_view typed;

        std::tuple<std::size_t, std::ptrdiff_t, std::uint32_t> place() const {
            // The longer the typed text, the further to the left its prefix stands.
            const bool prefixed = !candidate.group->prefix.empty();
            return {candidate.group->order, prefixed ? -static_cast<std::ptrdiff_t>(typed.size()) : 0, candidate.rank};
        }
    };

  public:
    Search(const SnippetMatcher& matcher, char16_t trigger, const KeyDestination& destination,
           SnippetMatcher::Refusals& refusals)
        : matcher_(matcher), trigger_(trigger), destination_(destination), refusals_(refusals) {}

    void run(const AbbreviationIndex& index, Trigger way, std::u16string_view text) {
        way_ = way;
        text_ = text;
        index.visitCandidates(way, text, *this);
    }

    void visit(const Candidate& candidate) override {
        if (!isUpToDate(candidate) || !isTyped(candidate, text_)) return;
        std::optional<Verdict> against = verdictAgainst(candidate);
        if (!isTriggeredFor(*candidate.group->group)) {
            // Not two reasons, and none where the abbreviation is only the end of some word.
            if (against) return;
            against = Verdict{MatchDecision::Outcome::WrongTrigger};
        }
        if (!against) {
            found_.push_back({candidate, text_.substr(text_.size() - candidate.length)});
        } else if (refusals_.size() < DecisionLog::Capacity) {
            refusals_.push_back({*against, *candidate.snippet, candidate.group->group, candidate.length});
        }
    }

    // Where a match covers it, nobody wonders why another did not expand.
    void dropCoveredRefusals() {
        std::size_t longest = 0;
        for (const Found& found : found_) longest = std::max(longest, found.typed.size());
        std::erase_if(refusals_, [&](const auto& refusal) { return refusal.length <= longest; });
    }

    // Library order; within a group with a prefix, the occurrences of the prefix from left to right first.
    std::vector<SnippetMatcher::Match> matchesInOrder() {
        std::sort(found_.begin(), found_.end(), [](const Found& a, const Found& b) { return a.place() < b.place(); });
        std::vector<SnippetMatcher::Match> matches;
        matches.reserve(found_.size());
        for (const Found& found : found_) matches.push_back({*found.candidate.snippet, std::u16string(found.typed)});
        return matches;
    }

  private:
    bool isTriggeredFor(const SnippetGroup& group) const {
        return way_ != Trigger::Delimiter || matcher_.delimitersOf(group).contains(trigger_);
    }

    // What keeps a snippet from expanding whose abbreviation is there, besides the key behind it.
    std::optional<Verdict> verdictAgainst(const Candidate& candidate) const {
        using Outcome = MatchDecision::Outcome;
        const SnippetGroup& group = *candidate.group->group;
        const std::size_t start = text_.size() - candidate.length;
        if (!(*candidate.snippet)->hasContent()) return Verdict{Outcome::Failed};
        if (!destination_.isApplicationAdmittedBy(group.availability())) return Verdict{Outcome::WrongApplication};
        if (!destination_.isInputSourceAdmittedBy(group.availability())) return Verdict{Outcome::WrongInputSource};
        if (!matcher_.checkGroup(group, text_, start)) {
            return Verdict{Outcome::WrongTextBefore, nameOf(group.expandAfter())};
        }
        if (candidate.group->prefixOverlapsItself && !isFoundFromLeft(text_, start, candidate.group->prefix)) {
            return Verdict{Outcome::WrongTextBefore, MatchDecision::AfterPrefix};
        }
        if (!isTypedInItsCase(candidate, text_)) return Verdict{Outcome::WrongCase};
        return std::nullopt;
    }

    const SnippetMatcher& matcher_;
    char16_t trigger_;
    const KeyDestination& destination_;
    SnippetMatcher::Refusals& refusals_;
    Trigger way_ = Trigger::Immediately;
    std::u16string_view text_;
    std::vector<Found> found_;
};

}  // namespace

SnippetMatcher::SnippetMatcher(const CharacterSet& defaultDelimiters)
    : defaultDelimiters_(defaultDelimiters), index_(std::make_unique<AbbreviationIndex>(defaultDelimiters_)) {}

SnippetMatcher::~SnippetMatcher() = default;

void SnippetMatcher::setSnippetGroups(const Groups& groups) {
    index_->setGroups(groups);
}

std::vector<SnippetMatcher::Match> SnippetMatcher::findSnippetsInLetters(std::u16string_view letters, char16_t trigger,
                                                                         std::u16string_view lettersWithoutSeparator,
                                                                         const KeyDestination& destination,
                                                                         Refusals& refusals) const {
    Search search(*this, trigger, destination, refusals);
    if (trigger == 0) {
        search.run(*index_, Trigger::HotKey, lettersWithoutSeparator);
    } else {
        search.run(*index_, Trigger::Immediately, letters);
        if (index_->isDelimiter(trigger)) search.run(*index_, Trigger::Delimiter, lettersWithoutSeparator);
    }
    if (!refusals.empty()) search.dropCoveredRefusals();
    return search.matchesInOrder();
}

void SnippetMatcher::findSuggestions(std::u16string_view letters, const Groups& groups,
                                     SuggestionList& suggestions) const {
    SuggestionFinder(*index_, groups).find(letters, suggestions);
}

const CharacterSet& SnippetMatcher::delimitersOf(const SnippetGroup& group) const {
    return group.delimiters() ? *group.delimiters() : defaultDelimiters_;
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

}  // namespace plume
