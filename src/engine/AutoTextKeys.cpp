// What the engine does at each key: the way it takes by its code, the digits that pick from a list, and the buffer.
#include <algorithm>
#include <array>
#include <utility>

#include "Foundation/Strings.h"
#include "engine/AutoText.h"

namespace plume {

namespace {

bool isSingleUnit(const std::optional<std::u16string>& text) {
    return text && text->size() == 1;
}

// F1 to F20, in the order of their codes.
constexpr std::array FunctionKeys = {KeyCode::F17, KeyCode::F18, KeyCode::F19, KeyCode::F20, KeyCode::F5,
                                     KeyCode::F6,  KeyCode::F7,  KeyCode::F3,  KeyCode::F8,  KeyCode::F9,
                                     KeyCode::F11, KeyCode::F13, KeyCode::F16, KeyCode::F14, KeyCode::F10,
                                     KeyCode::F12, KeyCode::F15, KeyCode::F4,  KeyCode::F2,  KeyCode::F1};
static_assert(std::ranges::is_sorted(FunctionKeys));

bool isFunctionKey(KeyCode key) {
    return std::ranges::binary_search(FunctionKeys, key);
}

bool isDigit(char16_t unit) {
    return unit >= u'0' && unit <= u'9';
}

}  // namespace

void AutoText::onSystemInputServiceKeyDown(ZDKeyEventArgs& event) {
    if (!enabled_) return;
    undoInfo_.reset();
    if (dependencies_.inputService.isSameProcess()) return;
    if (event.delivered) return processDelivered(event);
    if (snippetQuickSearchWindowVisible()) {
        if (isSingleUnit(event.s)) processSelectorKey(event);
        return;
    }
    if (routeByKeyCode(event) == Route::Done || !isSingleUnit(event.s)) return;
    processSelectorKey(event);
    if (!event.cancel) processNormalKeyDown(event);
}

// From an input method: a text, or a key that it passed on.
void AutoText::processDelivered(ZDKeyEventArgs& event) {
    if (event.key == KeyCode::Delete) return deleteLastLetter();
    // What the key does is unknown; it may have moved the caret.
    if (!event.s || event.s->empty()) return clear();
    const std::u16string text = *std::exchange(event.s, std::u16string(1, event.c));
    letters_.append(std::u16string_view(text).substr(0, text.size() - 1));
    // What would be erased is not in front of the caret yet.
    if (event.composing) {
        pauseWatch_.cancel();
        return letters_.append(*event.s);
    }
    processNormalKeyDown(event);
}

AutoText::Route AutoText::routeByKeyCode(ZDKeyEventArgs& event) {
    switch (event.key) {
        case KeyCode::Delete:
            deleteLastLetter();
            return Route::Done;
        case KeyCode::Escape:
            escapePressed(event);
            return Route::Done;
        case KeyCode::Return:
        case KeyCode::KeypadEnter:
            return returnPressed(event);
        case KeyCode::Space:
            return spacePressed(event);
        case KeyCode::Home:
        case KeyCode::PageUp:
        case KeyCode::End:
        case KeyCode::PageDown:
        case KeyCode::Left:
        case KeyCode::Right:
        case KeyCode::Help:
        case KeyCode::Menu:
            clear();
            return Route::Done;
        case KeyCode::Down:
        case KeyCode::Up:
            verticalArrowPressed(event);
            return Route::Done;
        case KeyCode::ForwardDelete:
            // What was typed before the caret still stands there.
            return Route::Done;
        case KeyCode::Tab:
            return tabPressed();
        default:
            return functionKeyPressed(event.key);
    }
}

void AutoText::deleteLastLetter() {
    const bool wasEmpty = letters().empty();
    letters_.eraseLast();
    if (wasEmpty) return;
    refreshSnippetSuggestionController();
    waitToSuggest();
}

void AutoText::escapePressed(ZDKeyEventArgs& event) {
    if (snippetSuggestionWindowVisible()) {
        hideSnippetSuggestion();
        event.cancel = true;
    } else {
        clear();
    }
}

void AutoText::verticalArrowPressed(ZDKeyEventArgs& event) {
    if (!snippetSuggestionWindowVisible()) {
        clear();
        return;
    }
    if (event.key == KeyCode::Down) {
        snippetSuggestionController_->nextSuggestion();
    } else {
        snippetSuggestionController_->previousSuggestion();
    }
    event.cancel = true;
}

AutoText::Route AutoText::returnPressed(ZDKeyEventArgs& event) {
    if (!snippetSuggestionWindowVisible()) return spacePressed(event);
    event.cancel = true;
    acceptSuggestion();
    return Route::Done;
}

AutoText::Route AutoText::spacePressed(const ZDKeyEventArgs& event) {
    if (dependencies_.inputService.keyModifier() != KeyModifier::Shift) return Route::Character;
    // Shift is the way to write an abbreviation out: the text is kept, nothing is looked for.
    if (event.s) {
        letters_.append(*event.s);
        waitToSuggest();
    }
    return Route::Done;
}

AutoText::Route AutoText::tabPressed() {
    if (!dependencies_.inputService.keyModifier().contains(KeyModifier::Shift)) return Route::Character;
    // Back to another field: what is typed there does not follow what was typed here.
    clear();
    return Route::Done;
}

AutoText::Route AutoText::functionKeyPressed(KeyCode key) {
    if (!isFunctionKey(key)) return Route::Character;
    // What it does in the program is unknown; it may have moved the caret.
    clear();
    return Route::Done;
}

std::optional<KeyModifiers> AutoText::selectorModifiers() const {
    constexpr std::int64_t LastModifier = 31;
    if (snippetSelectorKeyModifier_ < 0 || snippetSelectorKeyModifier_ > LastModifier) return std::nullopt;
    if (snippetSelectorKeyModifier_ == 0) return KeyModifiers();
    return KeyModifiers::fromBits(std::int32_t{1} << (snippetSelectorKeyModifier_ - 1));
}

void AutoText::processSelectorKey(ZDKeyEventArgs& event) {
    const MacInputService& service = dependencies_.inputService;
    if (selectorModifiers() != service.keyModifier()) return;

    char16_t character = event.c;
    // These two change what the key produces; the digit is what it would be without them.
    if (service.keyModifier().containsAny(KeyModifier::Shift | KeyModifier::Option)) {
        const std::optional<std::u16string> plain = service.stringForKeyCode(event.key, {});
        character = plain && !plain->empty() ? plain->front() : u'\0';
    }
    if (isDigit(character)) event.cancel = processSnippetSelectorHotKey(character);
}

bool AutoText::processSnippetSelectorHotKey(char16_t digit) {
    const std::size_t index = digit < u'1' ? 9 : static_cast<std::size_t>(digit - u'1');
    // One past the end counts as used too: it closes the list instead of typing a digit into the text.
    if (snippetSuggestionWindowVisible() && index <= suggestions_.size()) {
        sendSuggestionAtIndex(index, SnippetTrigger::Digit);
        return true;
    }
    if (!snippetQuickSearchWindowVisible()) return false;
    const std::shared_ptr<Snippet> snippet = snippetQuickSearchController_->snippetAtIndex(index);
    if (!snippet) return false;
    snippetQuickSearchController_->close();
    sendSnippetDirectly(snippet);
    return true;
}

void AutoText::onSystemInputServiceUnregisteredHotKeyPressed(ZDUnregisteredHotKeyPressedEventArgs& event) {
    // Without a modifier the digits arrive as ordinary keys.
    if (snippetSelectorKeyModifier_ == 0 || selectorModifiers() != event.hotKey.modifiers) return;
    if (isDigit(event.c)) event.cancel = processSnippetSelectorHotKey(event.c);
}

void AutoText::processNormalKeyDown(ZDKeyEventArgs& event) {
    const std::size_t lengthBefore = letters().size();
    letters_.append(*event.s);
    const std::u16string_view withKey = letters();
    std::vector<Match> matches = findSnippetsInLetters(withKey, event.s->front(), withKey.substr(0, lengthBefore));

    if (matches.empty()) {
        keyCompletedNothing(event);
    } else if (matches.size() == 1) {
        letters_.shrink(lengthBefore);
        sendTypedMatch(matches.front(), event);
    } else {
        offerMatches(std::move(matches));
    }
}

void AutoText::sendTypedMatch(const Match& match, ZDKeyEventArgs& event) {
    hideSnippetSuggestion();
    event.cancel = sendMatch(match, SnippetTrigger::Typed);
    // The kept delimiter stands behind the expansion, in the text as in the buffer.
    const std::shared_ptr<SnippetGroup> group = match.first->parentGroup();
    if (group && group->expandTrigger() == ExpandTrigger::DelimiterKept) letters_.append(*event.s);
}

void AutoText::offerMatches(std::vector<Match> matches) {
    hideSnippetSuggestion();
    const bool canOffer = dependencies_.makeSuggestionController != nullptr;
    for (const Match& match : matches) {
        noteMatch(canOffer ? MatchDecision::Outcome::Offered : MatchDecision::Outcome::Failed, match.first);
    }
    if (!canOffer) {
        return dependencies_.report("Several snippets match \"" + toUtf8(matches.front().second) +
                                    "\", and there is no list here to choose from.");
    }
    suggestions_.reserve(matches.size());
    for (Match& match : matches) suggestions_.append(std::move(match.first), std::move(match.second));
    selectingSnippet_ = true;
    // Not from inside the callback: the application has to get the key first.
    listOpening_ = dependencies_.inputService.runLoop().performAfterDelay(0, [this] { showSnippetSuggestion(); });
}

void AutoText::keyCompletedNothing(ZDKeyEventArgs& event) {
    // Engines that compose have capitals of their own.
    if (!event.delivered) {
        const auto correction = correction_.autoCorrect(letters(), *event.s, lastKeyDestination());
        if (correction) sendCorrection(*correction, event);
    }
    if (selectingSnippet_) {
        hideSnippetSuggestion();
    } else {
        refreshSnippetSuggestionController();
    }
    waitToSuggest();
}

void AutoText::sendCorrection(const AutoCorrection::Correction& correction, ZDKeyEventArgs& event) {
    std::u16string corrected = letters();
    event.cancel = sendSnippet(correction.snippet, correction.typed, SnippetTrigger::Typed);
    if (corrected.size() >= 2) corrected.replace(corrected.size() - 2, 1, correction.corrected);
    letters_.reset(corrected);
}

}  // namespace plume
