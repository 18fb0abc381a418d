// The engine's two lists: suggestions at the caret, and quick search.
#include <utility>

#include "engine/AutoText.h"

namespace plume {

namespace {
constexpr std::size_t UsualSuggestions = 100;
// One letter begins too much.
constexpr std::size_t EnoughLetters = 2;
constexpr double Pause = 0.4;  // seconds
}  // namespace

bool AutoText::snippetSuggestionWindowVisible() const {
    return snippetSuggestionController_ && snippetSuggestionController_->windowVisible();
}

void AutoText::suggestAbbreviations() {
    refreshSuggestions();
    showSnippetSuggestion();
}

void AutoText::refreshSuggestions() {
    suggestions_.clear();
    suggestions_.reserve(UsualSuggestions);
    if (!letters().empty()) matcher_.findSuggestions(letters(), suggestingGroups(), suggestions_);
}

AutoText::Groups AutoText::suggestingGroups() const {
    Groups groups = filteredGroupsByApplication();
    std::erase_if(groups, [](const auto& group) { return !group->suggestAbbreviations(); });
    return groups;
}

void AutoText::showSnippetSuggestion() {
    if (suggestions_.isEmpty() || !dependencies_.makeSuggestionController) return;
    if (snippetSuggestionController_) {
        snippetSuggestionController_->reloadData();
    } else {
        snippetSuggestionController_ = dependencies_.makeSuggestionController();
        snippetSuggestionController_->setSnippets(suggestions_);
        snippetSuggestionController_->setSuggestionSelectedAction([this] { snippetSuggestionSuggestionSelected(); });
        snippetSuggestionController_->setSnippetSelectorKeyModifier(snippetSelectorKeyModifier_);
    }
    snippetSuggestionController_->showWindowAtCaret();
}

void AutoText::setSuggestsByItself(bool suggests) {
    suggestsByItself_ = suggests;
    if (!suggests) pauseWatch_.cancel();
}

// One watch serves many keys: what a key costs is a look at the clock.
void AutoText::waitToSuggest() {
    if (!suggestsByItself_) return;
    RunLoop& loop = dependencies_.inputService.runLoop();
    lastChange_ = loop.now();
    if (!pauseWatch_) pauseWatch_ = loop.performAfterDelay(Pause, [this] { suggestAfterPause(); });
}

void AutoText::suggestAfterPause() {
    RunLoop& loop = dependencies_.inputService.runLoop();
    pauseWatch_.cancel();
    const double due = lastChange_ + Pause;
    if (const double now = loop.now(); now < due) {
        pauseWatch_ = loop.performAfterDelay(due - now, [this] { suggestAfterPause(); });
        return;
    }
    if (selectingSnippet_ || snippetSuggestionWindowVisible() || snippetQuickSearchWindowVisible()) return;
    refreshSuggestions();
    if (isEnoughToSuggestFor()) {
        showSnippetSuggestion();
    } else {
        suggestions_.clear();
    }
}

bool AutoText::isEnoughToSuggestFor() const {
    for (std::size_t i = 0; i < suggestions_.size(); ++i) {
        const std::shared_ptr<SnippetGroup> group = suggestions_.suggestions[i]->parentGroup();
        const std::size_t prefix = group ? group->abbreviationPrefix().value_or(u"").size() : 0;
        if (suggestions_.suggestionFilters[i].size() >= prefix + EnoughLetters) return true;
    }
    return false;
}

void AutoText::hideSnippetSuggestion() {
    pauseWatch_.cancel();
    selectingSnippet_ = false;
    if (snippetSuggestionController_) snippetSuggestionController_->close();
    suggestions_.clear();
}

void AutoText::refreshSnippetSuggestionController() {
    if (!snippetSuggestionWindowVisible()) return;
    refreshSuggestions();
    if (suggestions_.isEmpty()) {
        snippetSuggestionController_->close();
    } else {
        snippetSuggestionController_->reloadData();
        snippetSuggestionController_->refreshHeight();
    }
}

void AutoText::acceptSuggestion() {
    sendSuggestionAtIndex(snippetSuggestionController_->selectedSuggestionIndex(), SnippetTrigger::Suggestion);
}

void AutoText::snippetSuggestionSuggestionSelected() {
    sendSuggestionAtIndex(snippetSuggestionController_->selectedSuggestionIndex(), SnippetTrigger::Digit);
}

void AutoText::sendSuggestionAtIndex(std::size_t index, SnippetTriggers snippetTrigger) {
    if (selectingSnippet_) snippetTrigger |= SnippetTrigger::FromSeveralMatches;
    if (index >= suggestions_.size()) {
        hideSnippetSuggestion();
        return;
    }
    const Match chosen{std::move(suggestions_.suggestions[index]), std::move(suggestions_.suggestionFilters[index])};
    hideSnippetSuggestion();
    sender_.performOnceKeysAreTaken([this, chosen, snippetTrigger] {
        if (snippetTrigger.contains(SnippetTrigger::FromSeveralMatches)) {
            sendMatch(chosen, snippetTrigger);
        } else {
            sendSnippet(chosen.first, chosen.second, snippetTrigger);
        }
    });
}

bool AutoText::snippetQuickSearchWindowVisible() const {
    return snippetQuickSearchController_ && snippetQuickSearchController_->windowVisible();
}

void AutoText::quickSearch() {
    if (snippetQuickSearchWindowVisible() || !dependencies_.makeQuickSearchController) return;
    initSnippetQuickSearchController();
    snippetQuickSearchController_->showWindowAtCaret();
}

void AutoText::quickSearchAtTopRightCorner() {
    if (!dependencies_.makeQuickSearchController) return;
    initSnippetQuickSearchController();
    snippetQuickSearchController_->showWindowAtTopRightCorner();
}

void AutoText::initSnippetQuickSearchController() {
    if (snippetQuickSearchController_) return;
    snippetQuickSearchController_ = dependencies_.makeQuickSearchController();
    snippetQuickSearchController_->setSnippetGroups(snippetGroups_);
    snippetQuickSearchController_->setSnippetSelectedAction([this] { snippetQuickSearchSnippetSelectedAction(); });
    snippetQuickSearchController_->setSnippetSelectorKeyModifier(snippetSelectorKeyModifier_);
}

void AutoText::snippetQuickSearchSnippetSelectedAction() {
    const std::shared_ptr<Snippet> snippet = snippetQuickSearchController_->selectedSnippet();
    if (!snippet) return;
    sender_.performOnceKeysAreTaken([this, snippet, typed = snippetQuickSearchController_->typedText()] {
        sendSnippet(snippet, typed, SnippetTrigger::Direct);
    });
}

}  // namespace plume
