// Finds entries by the beginning of a text, whatever its case, in a sorted array: for what the user may be typing.
//
// Entries are numbers from 0 that the owner gives out; each is filed at most once. Only the first few units of a text
// are kept, so that an entry is small: what comes out for a longer beginning are candidates. Filing and removing take
// constant time; the next look-up after that sorts what is new and merges it in. Owned by the index, on its thread.
#pragma once

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <string_view>
#include <vector>

namespace plume {

class BeginningTable {
  public:
    // Makes room for `count` entries, numbered below `end`.
    void reserve(std::size_t count, std::size_t end);
    void add(std::uint32_t entry, std::u16string_view text);
    void remove(std::uint32_t entry);

    // Calls with each entry whose text may begin with `beginning`, which is not empty, in no particular order.
    template <typename Visit>
    void visit(std::u16string_view beginning, Visit&& visit) const {
        if (sorted_ < filed_.size()) mergeAdded();
        const Limits limits = limitsOf(beginning);
        const auto isBefore = [](const Filed& filed, std::uint64_t units) { return filed.units < units; };
        auto filed = std::lower_bound(filed_.begin(), filed_.end(), limits.first, isBefore);
        for (; filed != filed_.end() && filed->units <= limits.last; ++filed) {
            if (isCurrent(*filed)) visit(filed->entry);
        }
    }

  private:
    struct Filed {
        std::uint64_t units;  // the first of the text, folded, the first one in the highest bits
        std::uint32_t entry;
        std::uint32_t version;
    };
    struct Limits {
        std::uint64_t first;
        std::uint64_t last;
    };

    static Limits limitsOf(std::u16string_view beginning);
    bool isCurrent(const Filed& filed) const { return filed.version == versions_[filed.entry]; }
    void mergeAdded() const;
    void dropRemoved();

    mutable std::vector<Filed> filed_;     // those that were removed stay for a while
    mutable std::size_t sorted_ = 0;       // so many at the start of `filed_` are in order
    std::vector<std::uint32_t> versions_;  // by entry: counts its filings and removals
    std::size_t removed_ = 0;
};

}  // namespace plume
