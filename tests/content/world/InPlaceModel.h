// The content language as plainly as it can be written: a text that is edited in place, one unit after the other. Slow,
// and a measure for the scanner.
#pragma once

#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "content/ContentEnvironment.h"
#include "content/ExpansionContext.h"
#include "content/SnippetParser.h"

namespace plume {

struct InPlaceExpansion {
    std::u16string text;
    std::vector<std::shared_ptr<SnippetVariable>> variables;
};

class InPlaceModel {
  public:
    // Gives up after so many replacements.
    InPlaceModel(const ContentEnvironment& environment, const std::shared_ptr<Snippet>& snippet,
                 const SnippetParser::Groups& groups, std::size_t maximumReplacements)
        : environment_(environment), snippet_(snippet), groups_(groups), left_(maximumReplacements) {}

    // The snippet's content as plain text.
    std::optional<InPlaceExpansion> expand();

    // As in rich text, where an optional date is a date.
    bool optionalDatesBecomeFields = true;

  private:
    InPlaceExpansion expand(const std::u16string& text);
    // Replaces the placeholder in `range`; the result is where scanning goes on.
    std::size_t replace(InPlaceExpansion& expansion, const Range& range);
    std::size_t replaceByNested(InPlaceExpansion& expansion, const Range& range,
                                const std::shared_ptr<SnippetAbbreviationVariable>& variable);

    const ContentEnvironment& environment_;
    std::shared_ptr<Snippet> snippet_;
    const SnippetParser::Groups& groups_;
    std::size_t left_;
    std::chrono::nanoseconds patternTimeLeft_ = ExpansionContext::MaximumPatternTime;
};

}  // namespace plume
