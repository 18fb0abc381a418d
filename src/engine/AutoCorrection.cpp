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

AutoCorrection::AutoCorrection(MacInputService& inputService, const Accessibility& accessibility)
    : inputService_(inputService),
      accessibility_(accessibility),
      autocorrectGroup_(SnippetGroup::make()),
      autocorrectSnippet_(std::make_shared<Snippet>()) {
    autocorrectGroup_->setExpandTrigger(ExpandTrigger::DelimiterKept);
    autocorrectGroup_->addItem(autocorrectSnippet_);
}

std::optional<AutoCorrection::Correction> AutoCorrection::autoCorrect(std::u16string_view letters,
                                                                      std::u16string_view key,
                                                                      const KeyDestination& destination) {
    if (!capitalizeNewSentences_ && !correctDoubleCapitals_) return std::nullopt;
    if (!mayFollowCorrection(key.back())) return std::nullopt;

    const std::u16string_view context = letters.substr(0, letters.size() - key.size());
    if (context.size() >= NeededContext) {
        const std::optional<std::u16string> corrected = capitalize(letters);
        if (!corrected || !isAllowedAt(destination)) return std::nullopt;
        return makeCorrection(context.back(), *corrected);
    }
    if (!isAllowedAt(destination)) return std::nullopt;
    const auto text = AXUtils::getTextBeforeCaretWithMaxLength(accessibility_, AskedContext);
    if (!text || text->empty()) return std::nullopt;
    const std::optional<std::u16string> corrected = capitalize(std::u16string(*text).append(key));
    if (!corrected) return std::nullopt;
    return makeCorrection(text->back(), *corrected);
}

bool AutoCorrection::isAllowedAt(const KeyDestination& destination) const {
    return !inputService_.refreshContextInputSetting()->has(InputFlag::DisableCapitalization) &&
           destination.isAdmittedBy(autoCorrectAvailability_);
}

AutoCorrection::Correction AutoCorrection::makeCorrection(char16_t wrong, std::u16string corrected) const {
    const std::u16string typed(1, wrong);
    autocorrectSnippet_->setAbbreviation(typed);
    autocorrectSnippet_->setPlainTextContent(corrected);
    return {autocorrectSnippet_, typed, std::move(corrected)};
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
    constexpr std::size_t SpaceWordAndKey = 3;
    if (text.size() < SpaceWordAndKey) return false;
    const std::u16string_view before = text.substr(0, text.size() - SpaceWordAndKey);
    const auto standsAtEnd = [&](const std::u16string& word) {
        return !word.empty() && word.size() <= before.size() &&
               equalsIgnoringCase(before.substr(before.size() - word.size()), word);
    };
    return std::any_of(capitalizationExcludedAbbreviations_.begin(), capitalizationExcludedAbbreviations_.end(),
                       standsAtEnd);
}

std::optional<std::u16string> AutoCorrection::loweredSecondCapital(std::u16string_view text) const {
    constexpr std::size_t ThreeLetters = 3;
    if (text.back() == u' ' || text.size() < ThreeLetters) return std::nullopt;
    const std::u16string_view word = text.substr(text.size() - ThreeLetters);
    if (!isUpper(word[0]) || !isUpper(word[1])) return std::nullopt;
    if (text.size() > ThreeLetters && !startsWord(text[text.size() - ThreeLetters - 1])) return std::nullopt;
    const Words& excluded = doubleCapitalsCorrectionExclusion_;
    if (std::find(excluded.begin(), excluded.end(), word) != excluded.end()) return std::nullopt;
    return lowercased(word.substr(1, 1));
}

}  // namespace plume
