// Keeps records of a second thread in step with those of the library, by messages.
//
// The library's thread asks LibraryFeed what has changed and sends the update; the other thread has FedLibrary put it
// into its own records. An update costs what has changed, and shares no record with the library.
#pragma once

#include <cstddef>
#include <memory>
#include <optional>
#include <utility>
#include <vector>

#include "library/LibraryArchive.h"
#include "library/RecordedLibrary.h"

namespace plume {

// Records in it belong to whoever holds it; one that the library lists twice is two here. By places, as the library's
// changes are.
struct LibraryUpdate {
    struct Group {
        std::size_t place = 0;                   // in the list of after the change
        std::shared_ptr<SnippetGroup> settings;  // null: as they were
        ListChange items;
        std::vector<std::shared_ptr<Snippet>> added;
        std::vector<std::pair<std::size_t, std::shared_ptr<Snippet>>> changed;  // places after the change
    };

    ListChange groups;
    SnippetGroups added;
    std::vector<Group> changed;
};

// Belongs to the library's thread.
class LibraryFeed {
  public:
    // What has happened since the last call, the first time everything; nothing when nothing has.
    std::optional<LibraryUpdate> changesTo(const SnippetGroups& groups);

  private:
    RecordedLibrary sent_{RecordedLibrary::Keep::Revisions};
};

// Belongs to the thread that the updates are sent to.
class FedLibrary {
  public:
    const SnippetGroups& groups() const { return groups_; }
    // Updates come in the order of their making, none left out. Afterwards the update holds what went out of the
    // library, so that another thread can have the work of freeing it.
    void apply(LibraryUpdate& update);

  private:
    SnippetGroups groups_;
};

}  // namespace plume
