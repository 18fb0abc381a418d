// Which snippets the end of what was typed may become, at a cost that grows with what is found, not with the library.
//
// Made for one look, on the thread that delivers the key events; the index outlives it.
#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <string_view>
#include <vector>

#include "engine/AbbreviationIndex.h"
#include "engine/SuggestionController.h"
#include "library/SnippetGroup.h"

namespace plume {

class SuggestionFinder final : private AbbreviationIndex::Visitor {
  public:
    // Only snippets of these groups are found; groups that the index does not know are left out.
    SuggestionFinder(const AbbreviationIndex& index, const AbbreviationIndex::Groups& groups);

    // Appends them. First those of groups with a prefix, in library order, a snippet once for each place where its
    // prefix stands, from left to right; their filter is what was typed. Then the others, each for the longest text
    // that begins its abbreviation, the longest text first, then in library order; their filter is the beginning of the
    // abbreviation.
    void find(std::u16string_view letters, SuggestionList& suggestions);

  private:
    struct Found {
        std::uint64_t place;  // in the library
        std::size_t length;   // of what was typed for it
        const std::shared_ptr<Snippet>* snippet;
    };
    struct Candidate {
        std::uint64_t place;
        const AbbreviationIndex::IndexedGroup* group;
        const std::shared_ptr<Snippet>* snippet;
    };
    // What may stand before an abbreviation, one bit for each rule.
    using Rules = std::uint8_t;

    static Rules ruleOf(const SnippetGroup& group);
    static Rules rulesAdmitting(char16_t before);
    void lookForLast(std::size_t length);
    void visit(const AbbreviationIndex::Candidate& candidate) override;
    bool beginsWithTyped(const Candidate& candidate) const;
    bool isFoundForMore(std::uint64_t place) const;

    const AbbreviationIndex& index_;
    std::vector<Rules> rules_;  // by the group's place; 0 where the group is not asked
    Rules rulesOfAll_ = 0;
    std::u16string_view letters_;
    std::u16string_view typed_;  // the end of the letters that is looked for
    Rules admitting_ = 0;        // that text in its place
    std::vector<Candidate> candidates_;
    std::vector<Found> prefixed_;
    std::vector<Found> plain_;
    std::vector<std::size_t> ends_;  // where in `plain_` what was found for one length ends
};

}  // namespace plume
