// One edit of the library, which can be taken back and done again.
//
// Made by an EditRecorder. It holds the records themselves, so that what comes back is the very record that went, with
// its identity and dates. It fits the library as long as that is changed by such edits alone; where others have changed
// other fields of a snippet meanwhile (its last use), those stay. Belongs to the thread that owns the library.
#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <vector>

#include "library/LibraryArchive.h"

namespace plume {

enum class EditKind : std::uint8_t {
    Abbreviation,
    Label,
    Note,
    Case,
    Type,
    Content,
    GroupName,
    GroupSettings,
    NewSnippet,
    NewGroup,
    Deletion,
    Move,
    Copy,
    Duplication,
    DeletionOfDuplicates,
    Sorting,
    SortingOfGroups,
    CaseReset,
    Addition,  // of groups that came with Plume
    Import,
    KeptEdit  // put back what was edited here while another library came
};

class LibraryChange {
  public:
    // Copies of a record that nobody changes.
    template <typename Record>
    struct RecordStep {
        std::shared_ptr<Record> record;
        std::shared_ptr<const Record> before;
        std::shared_ptr<const Record> after;
    };
    // From place `at` on, `added` stand where `removed` stood.
    template <typename Record>
    struct ListStep {
        std::size_t at = 0;
        std::vector<std::shared_ptr<Record>> removed;
        std::vector<std::shared_ptr<Record>> added;

        bool isEmpty() const { return removed.empty() && added.empty(); }
    };
    struct ItemsStep {
        std::shared_ptr<SnippetGroup> group;
        ListStep<Snippet> items;
    };

    EditKind kind = EditKind::Content;
    std::size_t count = 1;  // of the snippets or groups that it is about
    std::vector<RecordStep<Snippet>> snippets;
    std::vector<RecordStep<SnippetGroup>> groups;  // their settings and names
    std::vector<ItemsStep> items;
    ListStep<SnippetGroup> groupList;

    bool isEmpty() const;
    // Rows have come, gone or moved.
    bool changesLists() const { return !items.empty() || !groupList.isEmpty(); }
    // The lists are as they were after the edit, or before it: somebody else may have put other rows into them.
    bool canUndo(const SnippetGroups& library) const;
    bool canRedo(const SnippetGroups& library) const;
    // Only where they can.
    void undo(SnippetGroups& library) const;
    void redo(SnippetGroups& library) const;
    // Takes in what follows it when both are about the same field of the same record; false, and nothing is done,
    // otherwise.
    bool absorb(const LibraryChange& later);
};

}  // namespace plume
