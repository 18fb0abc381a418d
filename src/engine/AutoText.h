// The expansion engine: follows what the user types and has snippets sent when their abbreviations are complete.
//
// Owned by the composition root. Everything here runs on the thread that delivers the input service's key events, which
// the engine hears from its construction to its destruction; the key handlers run inside the callback that decides
// whether the application gets the key. A key that completes nothing costs no copy of the buffer and no allocation.
// Destroying the engine waits for scripts that run, so whoever does it stops the script runner first.
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
#include "engine/AutoCorrection.h"
#include "engine/DecisionLog.h"
#include "engine/KeyDestination.h"
#include "engine/QuickSearchController.h"
#include "engine/SnippetMatcher.h"
#include "engine/SnippetSender.h"
#include "engine/SuggestionController.h"
#include "engine/TypedLetters.h"
#include "input/MacInputService.h"
#include "platform/Accessibility.h"
#include "platform/InputSources.h"
#include "platform/UserDefaults.h"

namespace plume {

class AutoText {
  public:
    using Match = SnippetMatcher::Match;
    using Groups = SnippetMatcher::Groups;

    // What the engine works with; not owned, and outlives it.
    struct Dependencies {
        MacInputService& inputService;
        BundleIdentifierResolver& bundleIdentifierResolver;
        const InputSources& inputSources;
        const Accessibility& accessibility;
        const UserDefaults& userDefaults;
        SnippetParser& snippetParser;
        ScriptRunner& scriptRunner;
        Sounds& sounds;
        // Tells the user that something cannot work, in one sentence. Never empty.
        std::function<void(const std::string&)> report;
        // Make a window when it is first needed, and never make null. What is empty never shows.
        FieldsEditor::Factory makeFieldsEditor = {};
        std::function<std::unique_ptr<SuggestionController>()> makeSuggestionController = {};
        std::function<std::unique_ptr<QuickSearchController>()> makeQuickSearchController = {};
        // Told of each snippet that was sent. Empty: nobody is.
        std::function<void(const Snippet&)> snippetUsed = {};
    };

    // Starts disabled.
    explicit AutoText(Dependencies dependencies);
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

    // Empties the buffer and closes the lists that are open.
    void clear();
    // What was typed since the last reset.
    const std::u16string& letters() const { return letters_.text(); }
    // The library, in user order.
    const Groups& snippetGroups() const { return snippetGroups_; }
    // How content is adapted to the case in which its abbreviation was typed.
    std::int64_t snippetAdaptToAbbreviationCaseOption() const { return snippetAdaptToAbbreviationCaseOption_; }
    void setSnippetAdaptToAbbreviationCaseOption(std::int64_t option) {
        snippetAdaptToAbbreviationCaseOption_ = option;
    }
    // Kept until the next key.
    const std::optional<UndoInformation>& undoInfo() const { return undoInfo_; }

    AutoCorrection& correction() { return correction_; }
    SnippetSender& sender() { return sender_; }

    // ---- Matching ----
    // Expands what stands at the end of the buffer; for the hot key that does that.
    void expandAtHotkey();
    // Remembers what was refused.
    std::vector<Match> findSnippetsInLetters(std::u16string_view letters, char16_t trigger,
                                             std::u16string_view lettersWithoutSeparator);
    // The groups of the library, in order, that admit the application which received the last key.
    Groups filteredGroupsByApplication() const;
    // For those who derive other triggers from what is typed; does nothing.
    static void processTrigger(char16_t /*trigger*/, std::u16string_view /*triggerString*/,
                               std::u16string_view /*letters*/, std::u16string_view /*lettersWithoutSeparator*/) {}

    // ---- Sending ----
    // `abbreviation` is the text that was typed for the snippet and is erased, nothing when it was chosen in another
    // way. Empties the buffer first, and fills it with what stands before the caret then. Whether the key that
    // triggered it must be swallowed; false when nothing was sent.
    bool sendSnippet(const std::shared_ptr<Snippet>& snippet, const std::optional<std::u16string>& abbreviation,
                     SnippetTriggers snippetTrigger);
    // Sends a snippet that was chosen without typing.
    void sendSnippetDirectly(const std::shared_ptr<Snippet>& snippet);
    // Takes the last expansion back, for the hot keys that do that. False when there is nothing to take back.
    bool undo(bool withTrigger);

    // ---- Why did it not expand? ----
    // What became lately of the abbreviations that were typed, the newest last.
    std::vector<MatchDecision> recentDecisions() const;
    void forgetDecisions() { decisions_.clear(); }
    // Keys stay away from now on, or come again: for whoever hears of that, which happens on another thread.
    void noteSecureInput(bool began);

    // ---- The list at the caret ----
    const SuggestionList& suggestions() const { return suggestions_; }
    // The list shown, or about to be, is one of several matches to choose from.
    bool selectingSnippet() const { return selectingSnippet_; }
    bool snippetSuggestionWindowVisible() const;
    // Offers what the buffer may become; for the hot key that does that.
    void suggestAbbreviations();
    // The same without being asked, when the user pauses after two letters or more of something. Off at first.
    void setSuggestsByItself(bool suggests);
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
    Route tabPressed();
    Route functionKeyPressed(KeyCode key);

    // The modifier set that picks entries; nothing when the setting names none.
    std::optional<KeyModifiers> selectorModifiers() const;
    void processSelectorKey(ZDKeyEventArgs& event);
    bool processSnippetSelectorHotKey(char16_t digit);

    void processDelivered(ZDKeyEventArgs& event);
    void processNormalKeyDown(ZDKeyEventArgs& event);
    void sendTypedMatch(const Match& match, ZDKeyEventArgs& event);
    void offerMatches(std::vector<Match> matches);
    void keyCompletedNothing(ZDKeyEventArgs& event);
    void sendCorrection(const AutoCorrection::Correction& correction, ZDKeyEventArgs& event);
    // sendSnippet() for an abbreviation that was typed to its end.
    bool sendMatch(const Match& match, SnippetTriggers snippetTrigger);
    std::optional<SnippetSender::Sent> send(const std::shared_ptr<Snippet>& snippet,
                                            const std::optional<std::u16string>& abbreviation,
                                            SnippetTriggers snippetTrigger);

    void noteSwitch();
    void noteRefusals();
    void noteMatch(MatchDecision::Outcome outcome, const std::shared_ptr<Snippet>& snippet);

    KeyDestination lastKeyDestination() const;
    void follow(const SnippetSender::Sent& sent);

    Groups suggestingGroups() const;
    void waitToSuggest();
    void suggestAfterPause();
    bool isEnoughToSuggestFor() const;
    void snippetSuggestionSuggestionSelected();
    void initSnippetQuickSearchController();
    void snippetQuickSearchSnippetSelectedAction();

    Dependencies dependencies_;
    SnippetMatcher matcher_;
    SnippetMatcher::Refusals refusals_;  // of one key; kept for its capacity
    DecisionLog decisions_;
    bool isKnownAsEnabled_ = true;  // from the decisions; nobody wonders about a start that is switched on
    std::array<Subscription, 4> subscriptions_;
    Groups snippetGroups_;
    TypedLetters letters_;
    std::optional<UndoInformation> undoInfo_;
    bool enabled_ = false;
    bool selectingSnippet_ = false;
    std::int64_t snippetSelectorKeyModifier_ = 0;
    std::int64_t snippetAdaptToAbbreviationCaseOption_;
    SuggestionList suggestions_;
    std::unique_ptr<SuggestionController> snippetSuggestionController_;
    std::unique_ptr<QuickSearchController> snippetQuickSearchController_;
    Timer listOpening_;
    bool suggestsByItself_ = false;
    Timer pauseWatch_;       // looks whether the user pauses
    double lastChange_ = 0;  // of the buffer by a key, in the run loop's time
    AutoCorrection correction_;
    SnippetSender sender_;
};

}  // namespace plume
