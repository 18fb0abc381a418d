// Corrects two slips while the user types: sentences that start in lower case, and words that start with two capitals.
//
// A correction is sent like a snippet of one letter, so it can be undone like one. Owned by the composition root,
// outlives the engine; everything belongs to the thread that delivers the key events. A key that corrects nothing is
// judged from the buffer alone, without a copy of it.
#pragma once

#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "engine/AutoCorrector.h"
#include "engine/SnippetSender.h"
#include "input/BundleIdentifierResolver.h"
#include "input/InputService.h"
#include "library/PLFunctionAvailability.h"
#include "platform/Accessibility.h"
#include "platform/InputSources.h"

namespace plume {

class AutoCorrection final : public AutoCorrector {
  public:
    // Not owned, and outlives the corrector.
    struct Dependencies {
        InputService& inputService;
        BundleIdentifierResolver& bundleIdentifierResolver;
        const InputSources& inputSources;
        const Accessibility& accessibility;
        SnippetSender& sender;
    };

    // Starts with both corrections off.
    explicit AutoCorrection(Dependencies dependencies);

    void autoCorrect(EngineState& engine, ZDKeyEventArgs& event, std::u16string_view context) override;

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
    bool isAllowedHere();
    std::optional<std::u16string> capitalizedSentenceStart(std::u16string_view text) const;
    std::optional<std::u16string> loweredSecondCapital(std::u16string_view text) const;
    bool endsWithExcludedAbbreviation(std::u16string_view text) const;
    void send(EngineState& engine, ZDKeyEventArgs& event, char16_t wrong, const std::u16string& corrected);

    Dependencies dependencies_;
    bool capitalizeNewSentences_ = false;
    bool correctDoubleCapitals_ = false;
    PLFunctionAvailability autoCorrectAvailability_;
    Words capitalizationExcludedAbbreviations_;
    Words doubleCapitalsCorrectionExclusion_;
    std::shared_ptr<SnippetGroup> autocorrectGroup_;
    std::shared_ptr<Snippet> autocorrectSnippet_;
};

}  // namespace plume
