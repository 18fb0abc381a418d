// The expansion engine: follows what the user types and has snippets sent when their abbreviations are complete.
//
// Owned by the composition root. Everything here runs on the thread that delivers the input service's key events, which
// the engine hears from its construction to its destruction; the key handlers run inside the callback that decides
// whether the application gets the key. A key that completes nothing costs no copy of the buffer and no allocation.
#pragma once

#include <array>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "Foundation/Subscription.h"
#include "engine/AutoCorrector.h"
#include "engine/EngineState.h"
#include "engine/QuickSearchController.h"
#include "engine/SnippetMatcher.h"
#include "engine/SnippetSender.h"
#include "engine/SuggestionController.h"
#include "engine/SuggestionList.h"
#include "engine/SuggestionSource.h"
#include "input/BundleIdentifierResolver.h"
#include "input/InputService.h"
#include "platform/InputSources.h"
#include "platform/UserDefaults.h"

namespace plume {

class AutoText final : public EngineState {
  public:
    using Match = SnippetMatcher::Match;

    // What the engine works with; not owned, and outlives it.
    struct Dependencies {
        InputService& inputService;
        BundleIdentifierResolver& bundleIdentifierResolver;
        const InputSources& inputSources;
        const UserDefaults& userDefaults;
        SnippetSender& sender;
        const SuggestionSource& suggestionSource;
        AutoCorrector* autoCorrector;  // null: nothing is corrected
        // Make a window when it is first needed; never null, never make null.
        std::function<std::unique_ptr<SuggestionController>()> makeSuggestionController;
        std::function<std::unique_ptr<QuickSearchController>()> makeQuickSearchController;
    };

    // Starts disabled.
    explicit AutoText(Dependencies dependencies);
    ~AutoText();
    AutoText(const AutoText&) = delete;
    AutoText& operator=(const AutoText&) = delete;

    // The characters that end and separate abbreviations where a group names none of its own.
    static const CharacterSet& defaultDelimiters();

    bool enabled() const { return enabled_; }
    // Also empties the buffer.
    void setEnabled(bool enabled);
    void setSnippetGroups(Groups groups);
    // Which modifier is held to pick entries of a list with digit keys: 0 none, n the one of bit n - 1 (KeyModifier).
    std::int64_t snippetSelectorKeyModifier() const { return snippetSelectorKeyModifier_; }
    void setSnippetSelectorKeyModifier(std::int64_t modifier);

    // ---- EngineState ----
    void clear() override;
    const std::u16string& letters() const override { return letters_; }
    void setLetters(std::u16string_view letters) override { letters_ = letters; }
    const Groups& snippetGroups() const override { return snippetGroups_; }
    std::int64_t snippetAdaptToAbbreviationCaseOption() const override { return snippetAdaptToAbbreviationCaseOption_; }
    const std::optional<UndoInformation>& undoInfo() const override { return undoInfo_; }
    void setUndoInfo(std::optional<UndoInformation> undoInfo) override { undoInfo_ = std::move(undoInfo); }

    // ---- Matching ----
    // Expands what stands at the end of the buffer; for the hot key that does that.
    void expandAtHotkey();
    std::vector<Match> findSnippetsInLetters(std::u16string_view letters, char16_t trigger,
                                             std::u16string_view lettersWithoutSeparator) const;
    // The groups of the library, in order, that admit the application which received the last key.
    Groups filteredGroupsByApplication() const;
    // For those who derive other triggers from what is typed; does nothing.
    static void processTrigger(char16_t /*trigger*/, std::u16string_view /*triggerString*/,
                               std::u16string_view /*letters*/, std::u16string_view /*lettersWithoutSeparator*/) {}

    // Sends a snippet that was chosen without typing.
    void sendSnippetDirectly(const std::shared_ptr<Snippet>& snippet);
    // Takes the last expansion back, for the hot keys that do that. False when there is nothing to take back.
    bool undo(bool withTrigger) { return dependencies_.sender.undo(*this, withTrigger); }

    // ---- The list at the caret ----
    const SuggestionList& suggestions() const { return suggestions_; }
    // The list shown, or about to be, is one of several matches to choose from.
    bool selectingSnippet() const { return selectingSnippet_; }
    bool snippetSuggestionWindowVisible() const;
    // Offers what the buffer may become; for the hot key that does that.
    void suggestAbbreviations();
    void refreshSuggestions();
    void showSnippetSuggestion();
    void hideSnippetSuggestion();
    // Brings a visible list up to date with the buffer, and closes it when nothing is left.
    void refreshSnippetSuggestionController();
    // Sends the selected entry.
    void acceptSuggestion();
    // An index past the end closes the list.
    void sendSuggestionAtIndex(std::size_t index, SnippetTriggers snippetTrigger);

    // ---- Quick search ----
    bool snippetQuickSearchWindowVisible() const;
    void quickSearch();
    void quickSearchAtTopRightCorner();

  private:
    class LastKeyContext;

    void onSystemInputServiceKeyDown(ZDKeyEventArgs& event);
    void onSystemInputServiceInputContextChanged(InputContextChange& change);
    void onSystemInputServiceMouseDown(ZDMouseEventArgs& event);
    void onSystemInputServiceUnregisteredHotKeyPressed(ZDUnregisteredHotKeyPressedEventArgs& event);

    enum class Route { Done, Character };
    Route routeByKeyCode(ZDKeyEventArgs& event);
    void deleteLastLetter();
    void escapePressed(ZDKeyEventArgs& event);
    void verticalArrowPressed(ZDKeyEventArgs& event);
    Route returnPressed(ZDKeyEventArgs& event);
    Route spacePressed(const ZDKeyEventArgs& event);

    // The modifier set that picks entries; nothing when the setting names none.
    std::optional<KeyModifiers> selectorModifiers() const;
    void processSelectorKey(ZDKeyEventArgs& event);
    bool processSnippetSelectorHotKey(char16_t digit);

    void processNormalKeyDown(ZDKeyEventArgs& event);
    void sendTypedMatch(const Match& match, ZDKeyEventArgs& event);
    void offerMatches(std::vector<Match> matches);
    void keyCompletedNothing(ZDKeyEventArgs& event, std::size_t lengthBefore);

    void snippetSuggestionSuggestionSelected();
    void initSnippetQuickSearchController();
    void snippetQuickSearchSnippetSelectedAction();

    Dependencies dependencies_;
    SnippetMatcher matcher_;
    std::array<Subscription, 4> subscriptions_;
    Groups snippetGroups_;
    std::u16string letters_;
    std::optional<UndoInformation> undoInfo_;
    bool enabled_ = false;
    bool selectingSnippet_ = false;
    std::int64_t snippetSelectorKeyModifier_ = 0;
    std::int64_t snippetAdaptToAbbreviationCaseOption_;
    SuggestionList suggestions_;
    std::unique_ptr<SuggestionController> snippetSuggestionController_;
    std::unique_ptr<QuickSearchController> snippetQuickSearchController_;
    RunLoop::CallId scheduledList_ = 0;
    RunLoop::CallId scheduledSuggestion_ = 0;
};

}  // namespace plume
