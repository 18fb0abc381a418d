// The searched texts of a library, normalised, in library order.
//
// Main thread. A snippet that has not changed since the texts were read is not read again.
#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <string>
#include <vector>

#include "app/ranking/TermFit.h"
#include "library/LibraryArchive.h"

namespace plume {

class SearchCorpus {
  public:
    struct Entry {
        std::shared_ptr<Snippet> snippet;
        std::shared_ptr<SnippetGroup> group;
        std::uint64_t revision = 0;
        std::u16string prefix;
        // Abbreviation with prefix, label and content, one after another.
        std::u16string units;
        std::string starts;  // of abbreviation and label
        std::size_t abbreviationLength = 0;
        std::size_t labelLength = 0;
        std::array<std::size_t, 3> beginnings{};
    };
    void read(const SnippetGroups& groups);
    void clear();

    std::size_t size() const { return entries_.size(); }
    const Entry& entry(std::size_t index) const { return entries_[index]; }
    // Of the fields whose bits `searchBy` has.
    LetterMasks masks(std::size_t index, std::int64_t searchBy) const;
    SearchedTexts texts(std::size_t index, std::int64_t searchBy) const;
    std::size_t memory() const;

  private:
    std::vector<Entry> entries_;
    // Apart from the entries, because every search looks at all of them.
    std::vector<LetterMasks> masks_;
};

}  // namespace plume
