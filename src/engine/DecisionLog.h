// The last decisions about abbreviations that were typed, for whoever wonders why one did not expand.
//
// Owned by the engine; belongs to the thread that delivers the key events. Adding takes the same short time always and
// allocates nothing: texts are made when somebody asks. What is typed never comes here, only the snippets whose
// abbreviations it completed; nothing is written anywhere.
#pragma once

#include <array>
#include <cstddef>
#include <memory>
#include <string_view>
#include <vector>

#include "engine/MatchDecision.h"
#include "input/BundleIdentifierResolver.h"
#include "library/SnippetGroup.h"

namespace plume {

class DecisionLog {
  public:
    static constexpr std::size_t Capacity = 20;

    // What there is to tell of one snippet.
    struct Verdict {
        MatchDecision::Outcome outcome = MatchDecision::Outcome::Expanded;
        std::u16string_view detail = {};  // one of the details' names
    };

    // `process` had the keyboard. The same about the same snippet within a second counts once.
    void add(Verdict verdict, const std::shared_ptr<Snippet>& snippet, const std::shared_ptr<SnippetGroup>& group,
             ProcessSerialNumber process);
    // What concerns no snippet.
    void add(MatchDecision::Outcome outcome);

    // The newest last. Snippets and groups are named as they are now; a group that is gone has no name.
    std::vector<MatchDecision> decisions(BundleIdentifierResolver& resolver) const;
    void clear();

  private:
    struct Entry {
        Date time;
        Verdict verdict;
        // It may have gone from the library since. Its group, with all its snippets, is not held for that.
        std::shared_ptr<Snippet> snippet;
        std::weak_ptr<SnippetGroup> group;
        ProcessSerialNumber process;
    };

    static MatchDecision decisionOf(const Entry& entry, BundleIdentifierResolver& resolver);
    bool wasJustAdded(const Entry& entry) const;
    void append(Entry entry);

    std::array<Entry, Capacity> entries_;  // the place of each is its number, modulo the capacity
    std::size_t added_ = 0;
};

}  // namespace plume
