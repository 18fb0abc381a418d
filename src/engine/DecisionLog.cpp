#include "engine/DecisionLog.h"

#include <algorithm>
#include <chrono>
#include <utility>

namespace plume {

namespace {

constexpr std::chrono::seconds RepeatedWithin{1};

std::u16string abbreviationOf(const Snippet& snippet, const SnippetGroup* group) {
    std::u16string prefix = group ? group->abbreviationPrefix().value_or(u"") : u"";
    return std::move(prefix) + snippet.abbreviation().value_or(u"");
}

}  // namespace

void DecisionLog::add(Verdict verdict, const std::shared_ptr<Snippet>& snippet,
                      const std::shared_ptr<SnippetGroup>& group, ProcessSerialNumber process) {
    Entry entry{currentDate(), verdict, snippet, group, process};
    if (!wasJustAdded(entry)) append(std::move(entry));
}

void DecisionLog::add(MatchDecision::Outcome outcome) {
    append({currentDate(), {outcome}, nullptr, {}, {}});
}

bool DecisionLog::wasJustAdded(const Entry& entry) const {
    return std::ranges::any_of(entries_, [&](const Entry& earlier) {
        // A clock that was put back must not make everything a repetition.
        return earlier.snippet == entry.snippet && earlier.verdict.outcome == entry.verdict.outcome &&
               earlier.process == entry.process && earlier.time <= entry.time &&
               entry.time - earlier.time < RepeatedWithin;
    });
}

void DecisionLog::append(Entry entry) {
    entries_[added_++ % Capacity] = std::move(entry);
}

std::vector<MatchDecision> DecisionLog::decisions(BundleIdentifierResolver& resolver) const {
    std::vector<MatchDecision> decisions;
    decisions.reserve(std::min(added_, Capacity));
    for (std::size_t i = added_ > Capacity ? added_ - Capacity : 0; i < added_; ++i) {
        decisions.push_back(decisionOf(entries_[i % Capacity], resolver));
    }
    return decisions;
}

MatchDecision DecisionLog::decisionOf(const Entry& entry, BundleIdentifierResolver& resolver) {
    MatchDecision decision{.time = entry.time, .outcome = entry.verdict.outcome};
    if (!entry.snippet) return decision;
    const std::shared_ptr<SnippetGroup> group = entry.group.lock();
    decision.abbreviation = abbreviationOf(*entry.snippet, group.get());
    if (group) decision.group = group->name().value_or(u"");
    decision.application = resolver.getBundleIdentifier(entry.process).value_or(u"");
    decision.detail = entry.verdict.detail;
    return decision;
}

void DecisionLog::clear() {
    entries_ = {};
    added_ = 0;
}

}  // namespace plume
