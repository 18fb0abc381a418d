// The engine's two lists: suggestions at the caret, and quick search.
#include <utility>

#include "engine/AutoText.h"

namespace plume {

bool AutoText::snippetSuggestionWindowVisible() const {
    return snippetSuggestionController_ && snippetSuggestionController_->windowVisible();
}

void AutoText::suggestAbbreviations() {
    refreshSuggestions();
    showSnippetSuggestion();
}

void AutoText::refreshSuggestions() {
    suggestions_.clear();
    if (letters().empty() || !dependencies_.suggest) return;
    suggestions_ = dependencies_.suggest(letters(), filteredGroupsByApplication());
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

void AutoText::hideSnippetSuggestion() {
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
    if (snippet) sendSnippetDirectly(snippet);
}

}  // namespace plume
