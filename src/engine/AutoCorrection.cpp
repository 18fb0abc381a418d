#include "engine/AutoCorrection.h"

#include <algorithm>
#include <utility>

#include "Foundation/CharacterSet.h"
#include "Foundation/Strings.h"
#include "engine/AutoTextUtils.h"
#include "input/AXUtils.h"

namespace plume {

namespace {

// How much of what stands before the caret tells enough.
constexpr std::size_t NeededContext = 2;
constexpr std::int64_t AskedContext = 3;

bool isLower(char16_t unit) {
    return CharacterSet::lowercaseLetters().contains(unit);
}

bool isUpper(char16_t unit) {
    return CharacterSet::uppercaseLetters().contains(unit);
}

bool mayFollowCorrection(char16_t key) {
    return key == u' ' || isLower(key);
}

bool startsWord(char16_t before) {
    return before == u' ' || before == u'\n' || before == u'\r' || before == u'\u0003';
}

}  // namespace

AutoCorrection::AutoCorrection(Dependencies dependencies)
    : dependencies_(dependencies),
      autocorrectGroup_(SnippetGroup::make()),
      autocorrectSnippet_(std::make_shared<Snippet>()) {
    autocorrectGroup_->setExpandTrigger(ExpandTrigger::DelimiterKept);
    autocorrectGroup_->addItem(autocorrectSnippet_);
}

void AutoCorrection::autoCorrect(EngineState& engine, ZDKeyEventArgs& event, std::u16string_view context) {
    if (!capitalizeNewSentences_ && !correctDoubleCapitals_) return;
    if (!event.s || event.s->empty() || !mayFollowCorrection(event.s->back())) return;

    if (context.size() >= NeededContext) {
        const std::optional<std::u16string> corrected = capitalize(engine.letters());
        if (corrected && isAllowedHere()) send(engine, event, context.back(), *corrected);
        return;
    }
    if (!isAllowedHere()) return;
    const auto text = AXUtils::getTextBeforeCaretWithMaxLength(dependencies_.accessibility, AskedContext);
    if (!text || text->empty()) return;
    const std::optional<std::u16string> corrected = capitalize(*text + *event.s);
    if (corrected) send(engine, event, text->back(), *corrected);
}

bool AutoCorrection::isAllowedHere() {
    InputService& service = dependencies_.inputService;
    if (service.refreshContextInputSetting()->has(InputFlag::DisableCapitalization)) return false;
    const auto& application =
        dependencies_.bundleIdentifierResolver.getBundleIdentifier(service.lastProcessReceivedKeyEvent());
    return autoCorrectAvailability_.admitsApplication(application) &&
           autoCorrectAvailability_.admitsInputSource(dependencies_.inputSources.currentInputSourceIdentifier());
}

void AutoCorrection::send(EngineState& engine, ZDKeyEventArgs& event, char16_t wrong, const std::u16string& corrected) {
    const std::u16string abbreviation(1, wrong);
    autocorrectSnippet_->setAbbreviation(abbreviation);
    autocorrectSnippet_->setPlainTextContent(corrected);
    std::u16string letters = engine.letters();
    event.cancel = dependencies_.sender.sendSnippet(engine, autocorrectSnippet_, abbreviation, SnippetTrigger::Typed);
    if (letters.size() >= 2) letters.replace(letters.size() - 2, 1, corrected);
    engine.setLetters(letters);
}

std::optional<std::u16string> AutoCorrection::capitalize(std::u16string_view text) const {
    if (text.size() < 2 || !mayFollowCorrection(text.back())) return std::nullopt;
    const bool smallLetter = isLower(text[text.size() - 2]);
    if (smallLetter) return capitalizeNewSentences_ ? capitalizedSentenceStart(text) : std::nullopt;
    return correctDoubleCapitals_ ? loweredSecondCapital(text) : std::nullopt;
}

std::optional<std::u16string> AutoCorrection::capitalizedSentenceStart(std::u16string_view text) const {
    // Two characters alone are the start of the whole text.
    if (text.size() != 2 && !AutoTextUtils::shouldCapitalize(text)) return std::nullopt;
    if (endsWithExcludedAbbreviation(text)) return std::nullopt;
    return uppercased(text.substr(text.size() - 2, 1));
}

// Just before the one space in front of the word that was begun.
bool AutoCorrection::endsWithExcludedAbbreviation(std::u16string_view text) const {
    constexpr std::size_t spaceWordAndKey = 3;
    if (text.size() < spaceWordAndKey) return false;
    const std::u16string_view before = text.substr(0, text.size() - spaceWordAndKey);
    const auto standsAtEnd = [&](const std::u16string& word) {
        return !word.empty() && word.size() <= before.size() &&
               equalsIgnoringCase(before.substr(before.size() - word.size()), word);
    };
    return std::any_of(capitalizationExcludedAbbreviations_.begin(), capitalizationExcludedAbbreviations_.end(),
                       standsAtEnd);
}

std::optional<std::u16string> AutoCorrection::loweredSecondCapital(std::u16string_view text) const {
    constexpr std::size_t threeLetters = 3;
    if (text.back() == u' ' || text.size() < threeLetters) return std::nullopt;
    const std::u16string_view word = text.substr(text.size() - threeLetters);
    if (!isUpper(word[0]) || !isUpper(word[1])) return std::nullopt;
    if (text.size() > threeLetters && !startsWord(text[text.size() - threeLetters - 1])) return std::nullopt;
    const Words& excluded = doubleCapitalsCorrectionExclusion_;
    if (std::find(excluded.begin(), excluded.end(), word) != excluded.end()) return std::nullopt;
    return lowercased(word.substr(1, 1));
}

}  // namespace plume
