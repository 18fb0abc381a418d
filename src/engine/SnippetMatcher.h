// Which snippets have just been completed at the end of what was typed.
//
// Owned by the engine; everything here runs on the thread that delivers the key events, inside the key callback. A key
// that completes nothing costs the same at every library size and allocates nothing. Observes the groups it was given,
// so that any change of the library is seen by the next key.
#pragma once

#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "Foundation/CharacterSet.h"
#include "Foundation/ZDPair.h"
#include "engine/KeyDestination.h"
#include "library/SnippetGroup.h"

namespace plume {

class AbbreviationIndex;

class SnippetMatcher {
  public:
    // The snippet, and the text exactly as it was typed for it (prefix included).
    using Match = ZDPair<std::shared_ptr<Snippet>, std::u16string>;
    using Groups = std::vector<std::shared_ptr<SnippetGroup>>;

    explicit SnippetMatcher(const CharacterSet& defaultDelimiters);
    ~SnippetMatcher();

    // The library, in user order.
    void setSnippetGroups(const Groups& groups);

    // `letters` is the buffer with the typed characters appended, `trigger` the typed unit or 0 when the expand hot key
    // asks, `lettersWithoutSeparator` the buffer before the key. Every match, in library order. Where the key went is
    // asked only when a snippet limited to applications or input sources could match.
    std::vector<Match> findSnippetsInLetters(std::u16string_view letters, char16_t trigger,
                                             std::u16string_view lettersWithoutSeparator,
                                             const KeyDestination& destination) const;

    // Whether what stands before `index` satisfies the group's expandAfter rule.
    bool checkGroup(const SnippetGroup& group, std::u16string_view text, std::size_t index) const;
    // The typed text at the end of `letters` that matches the abbreviation, which must not be longer than `letters`.
    std::optional<std::u16string_view> checkAbbreviation(std::u16string_view abbreviation, std::u16string_view letters,
                                                         const SnippetGroup& group, bool caseSensitive) const;

    // The characters at which the group expands.
    const CharacterSet& delimitersOf(const SnippetGroup& group) const;

  private:
    CharacterSet defaultDelimiters_;
    std::unique_ptr<AbbreviationIndex> index_;
};

}  // namespace plume
