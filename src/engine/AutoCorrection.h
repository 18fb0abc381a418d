// Corrects two slips while the user types: sentences that start in lower case, and words that start with two capitals.
//
// A correction is sent like a snippet of one letter, so it can be undone like one. Owned by the engine; everything
// belongs to the thread that delivers the key events. A key that corrects nothing is judged from the buffer alone,
// without a copy of it, and allocates nothing.
#pragma once

#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "engine/KeyDestination.h"
#include "input/MacInputService.h"
#include "library/PLFunctionAvailability.h"
#include "library/SnippetGroup.h"
#include "platform/Accessibility.h"

namespace plume {

class AutoCorrection {
  public:
    // The snippet to send in place of the letter before the key.
    struct Correction {
        std::shared_ptr<Snippet> snippet;
        std::u16string typed;
        std::u16string corrected;
    };

    // Starts with both corrections off. Nothing is owned; all of it outlives the corrector.
    AutoCorrection(MacInputService& inputService, const Accessibility& accessibility);

    // After a key that completed no snippet and went there: `letters` is the buffer, and ends with the key's
    // characters, one or more. Nothing when there is nothing to correct; else the snippet is good until the next
    // correction.
    std::optional<Correction> autoCorrect(std::u16string_view letters, std::u16string_view key,
                                          const KeyDestination& destination);

    // What the second-to-last character of the text, which ends with the key that is being typed, should have been;
    // nothing when it is right.
    std::optional<std::u16string> capitalize(std::u16string_view text) const;

    bool capitalizeNewSentences() const { return capitalizeNewSentences_; }
    void setCapitalizeNewSentences(bool value) { capitalizeNewSentences_ = value; }
    bool correctDoubleCapitals() const { return correctDoubleCapitals_; }
    void setCorrectDoubleCapitals(bool value) { correctDoubleCapitals_ = value; }
    // Where corrections are made.
    PLFunctionAvailability& autoCorrectAvailability() { return autoCorrectAvailability_; }

    using Words = std::vector<std::u16string>;
    // Words that end with a period, and after which no sentence starts; in any case.
    const Words& capitalizationExcludedAbbreviations() const { return capitalizationExcludedAbbreviations_; }
    void setCapitalizationExcludedAbbreviations(Words words) {
        capitalizationExcludedAbbreviations_ = std::move(words);
    }
    // Beginnings of words, two capitals and a small letter, that are right as they are.
    const Words& doubleCapitalsCorrectionExclusion() const { return doubleCapitalsCorrectionExclusion_; }
    void setDoubleCapitalsCorrectionExclusion(Words words) { doubleCapitalsCorrectionExclusion_ = std::move(words); }

  private:
    bool isAllowedAt(const KeyDestination& destination) const;
    Correction makeCorrection(char16_t wrong, std::u16string corrected) const;
    std::optional<std::u16string> capitalizedSentenceStart(std::u16string_view text) const;
    std::optional<std::u16string> loweredSecondCapital(std::u16string_view text) const;
    bool endsWithExcludedAbbreviation(std::u16string_view text) const;

    MacInputService& inputService_;
    const Accessibility& accessibility_;
    bool capitalizeNewSentences_ = false;
    bool correctDoubleCapitals_ = false;
    PLFunctionAvailability autoCorrectAvailability_;
    Words capitalizationExcludedAbbreviations_;
    Words doubleCapitalsCorrectionExclusion_;
    std::shared_ptr<SnippetGroup> autocorrectGroup_;
    std::shared_ptr<Snippet> autocorrectSnippet_;
};

}  // namespace plume
