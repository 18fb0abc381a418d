// The library as it was when it was last written down, to tell what has changed since.
//
// Every snippet is kept as the record that others change and as a copy that nobody changes any more, so looking for
// changes compares one number a snippet, and a save on another thread reads the copies in peace. Belongs to the thread
// that owns the library.
#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <vector>

#include "library/LibraryArchive.h"

namespace plume {

// In a list: from place `at` on, `removed` elements are gone and `added` ones stand there.
struct ListChange {
    std::size_t at = 0;
    std::size_t removed = 0;
    std::size_t added = 0;

    bool isEmpty() const { return removed == 0 && added == 0; }
};

struct GroupChange {
    std::size_t group = 0;  // its place in the list of today
    bool settings = false;
    ListChange items;
    std::vector<std::size_t> changed;  // places in the items of today, without those in `items`
};

// By places, so that it can be told exactly also where identities are missing or repeated.
struct LibraryDelta {
    bool identity = false;  // the version, or another value of the whole library
    ListChange groups;
    std::vector<GroupChange> groupChanges;  // of groups that stood there before

    bool isEmpty() const { return !identity && groups.isEmpty() && groupChanges.empty(); }
};

class RecordedLibrary {
  public:
    struct RecordedSnippet {
        std::shared_ptr<Snippet> live;
        std::uint64_t revision = 0;
        std::shared_ptr<Snippet> state;  // null when revisions alone are kept
    };
    struct RecordedGroup {
        std::shared_ptr<SnippetGroup> live;
        std::shared_ptr<SnippetGroup> state;  // without items
        std::vector<RecordedSnippet> items;
    };

    // For who wants to know that a snippet has changed, its revision is enough; contents() needs its state.
    enum class Keep : std::uint8_t { States, Revisions };

    explicit RecordedLibrary(Keep keep = Keep::States) : keep_(keep) {}

    void record(const LibraryContents& library);
    // Microseconds for ten thousand snippets.
    LibraryDelta changesTo(const LibraryContents& library) const;
    // The same as record(), for the work of the delta, which changesTo() gave for this library.
    void record(const LibraryContents& library, const LibraryDelta& delta);

    const std::vector<RecordedGroup>& groups() const { return groups_; }
    // What was recorded, as records that nobody changes.
    LibraryContents contents() const;

  private:
    RecordedSnippet recorded(const std::shared_ptr<Snippet>& snippet) const;
    RecordedGroup recorded(const std::shared_ptr<SnippetGroup>& group) const;
    template <typename Recorded, typename Today>
    void replay(const ListChange& change, std::vector<Recorded>& before, const std::vector<Today>& now) const;

    Keep keep_;
    LibraryContents identity_;  // without groups
    std::vector<RecordedGroup> groups_;
};

}  // namespace plume
