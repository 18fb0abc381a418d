// What the engine remembers of what became of abbreviations.
#include "engine/AutoText.h"

namespace plume {

using Outcome = MatchDecision::Outcome;

std::vector<MatchDecision> AutoText::recentDecisions() const {
    return decisions_.decisions(dependencies_.bundleIdentifierResolver);
}

void AutoText::noteSecureInput(bool began) {
    decisions_.add(began ? Outcome::SecureInputBegan : Outcome::SecureInputEnded);
    // Nobody hears the keys that would pick from a list or close it.
    if (began && snippetSuggestionWindowVisible()) clear();
}

void AutoText::noteSwitch() {
    if (enabled_ == isKnownAsEnabled_) return;
    isKnownAsEnabled_ = enabled_;
    decisions_.add(enabled_ ? Outcome::SwitchedOn : Outcome::SwitchedOff);
}

void AutoText::noteRefusals() {
    const ProcessSerialNumber process = dependencies_.inputService.lastProcessReceivedKeyEvent();
    for (const SnippetMatcher::Refusal& refusal : refusals_) {
        decisions_.add(refusal.verdict, refusal.snippet, refusal.group, process);
    }
    refusals_.clear();
}

void AutoText::noteMatch(Outcome outcome, const std::shared_ptr<Snippet>& snippet) {
    decisions_.add({outcome}, snippet, snippet->parentGroup(),
                   dependencies_.inputService.lastProcessReceivedKeyEvent());
}

}  // namespace plume
