// Which snippets have just been completed at the end of what was typed.
//
// Owned by the engine; everything here runs on the thread that delivers the key events, inside the key callback. A key
// that completes nothing costs the same at every library size and allocates nothing. Observes the groups it was given,
// so that any change of the library is seen by the next key.
#pragma once

#include <cstddef>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "Foundation/CharacterSet.h"
#include "Foundation/ZDPair.h"
#include "engine/DecisionLog.h"
#include "engine/KeyDestination.h"
#include "library/SnippetGroup.h"

namespace plume {

class AbbreviationIndex;
struct SuggestionList;

class SnippetMatcher {
  public:
    // The snippet, and the text exactly as it was typed for it (prefix included).
    using Match = ZDPair<std::shared_ptr<Snippet>, std::u16string>;
    using Groups = std::vector<std::shared_ptr<SnippetGroup>>;
    // A snippet whose abbreviation stands there, and what keeps it from expanding.
    struct Refusal {
        DecisionLog::Verdict verdict;
        std::shared_ptr<Snippet> snippet;
        std::shared_ptr<SnippetGroup> group;
        std::size_t length;  // of what was typed for it
    };
    using Refusals = std::vector<Refusal>;

    explicit SnippetMatcher(const CharacterSet& defaultDelimiters);
    ~SnippetMatcher();

    // The library, in user order.
    void setSnippetGroups(const Groups& groups);

    // `letters` is the buffer with the typed characters appended, `trigger` the typed unit or 0 when the expand hot key
    // asks, `lettersWithoutSeparator` the buffer before the key. Every match, in library order. Where the key went is
    // asked only when a snippet limited to applications or input sources could match. `refusals` comes empty and is
    // given those that are longer than every match, as many as the log keeps.
    std::vector<Match> findSnippetsInLetters(std::u16string_view letters, char16_t trigger,
                                             std::u16string_view lettersWithoutSeparator,
                                             const KeyDestination& destination, Refusals& refusals) const;

    // Appends what the end of the letters may become among the snippets of these groups, the best first
    // (engine/SuggestionFinder.h).
    void findSuggestions(std::u16string_view letters, const Groups& groups, SuggestionList& suggestions) const;

    // Whether what stands before `index` satisfies the group's expandAfter rule.
    bool checkGroup(const SnippetGroup& group, std::u16string_view text, std::size_t index) const;
    // The characters at which the group expands.
    const CharacterSet& delimitersOf(const SnippetGroup& group) const;

  private:
    CharacterSet defaultDelimiters_;
    std::unique_ptr<AbbreviationIndex> index_;
};

}  // namespace plume
