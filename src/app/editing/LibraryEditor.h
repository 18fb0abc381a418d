// The editor's operations on the library. Each that changes something is one change, which can be undone, and ends in
// DataManager::notifyDataChanged(); one that changes nothing does neither.
//
// Owned by the editor's window; belongs to the thread that owns the library, which outlives it. Records that are handed
// over are listed in the library, selections are in its order; places count what is there before the operation.
#pragma once

#include <cstddef>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "app/editing/DuplicatedSnippets.h"
#include "app/editing/EditRecorder.h"
#include "app/editing/LibraryChange.h"
#include "app/editing/SnippetOrder.h"
#include "app/editing/ZDDuplicateManager.h"
#include "library/DataManager.h"

namespace plume {

// What is selected in the list of groups and snippets.
struct LibrarySelection {
    SnippetGroups groups;
    std::vector<std::shared_ptr<Snippet>> snippets;

    bool isEmpty() const { return groups.empty() && snippets.empty(); }
};

class LibraryEditor {
  public:
    using Text = std::optional<std::u16string>;
    using Snippets = std::vector<std::shared_ptr<Snippet>>;

    // `changed` is called after each change, before the library's own event.
    LibraryEditor(DataManager& dataManager, std::function<void(const LibraryChange& change)> changed);

    const SnippetGroups& groups() const { return manager_.snippetGroups(); }
    // A change of the library that is told now is this editor's own.
    bool isChanging() const { return isChanging_; }
    // False, and nothing is done, when others have changed the lists that it is about.
    bool undo(const LibraryChange& change);
    bool redo(const LibraryChange& change);

    // ---- Duplicate abbreviations ----
    void reloadDuplicateManager();
    void addGroupToDulicateManager(const SnippetGroup& group);
    void removeGroupFromDulicateManager(const SnippetGroup& group);
    bool isDuplicated(const Snippet& snippet) const;

    // ---- One snippet ----
    // True when the marks of other rows may be others now.
    bool setSnippetAbbreviation(const std::shared_ptr<Snippet>& snippet, const Text& abbreviation);
    void setLabel(const std::shared_ptr<Snippet>& snippet, const Text& label);
    void setNote(const std::shared_ptr<Snippet>& snippet, const Text& note);
    void setContentType(const std::shared_ptr<Snippet>& snippet, ContentType type);
    // Without its attributes where the snippet is not rich text.
    void setContent(const std::shared_ptr<Snippet>& snippet, const AttributedString& content);
    // What an edit made of `before`, in a snippet of the library that has come meanwhile.
    void keepEdit(const std::shared_ptr<Snippet>& snippet, const Snippet& before, const Snippet& edited);
    void setCaseSensitivity(const Snippets& snippets, CaseSensitivity value);

    // ---- Groups' settings ----
    void setName(const std::shared_ptr<SnippetGroup>& group, const Text& name);
    void changeSettings(const std::shared_ptr<SnippetGroup>& group, const std::function<void(SnippetGroup&)>& change,
                        EditKind kind = EditKind::GroupSettings);
    void resetSnippetCaseSensitivity(const std::shared_ptr<SnippetGroup>& group, CaseSensitivity value);

    // ---- What is in the library ----
    // New records; a place past the end appends.
    void insertSnippets(const Snippets& snippets, const std::shared_ptr<SnippetGroup>& group, std::size_t at,
                        EditKind kind = EditKind::NewSnippet);
    void insertGroups(const SnippetGroups& inserted, std::size_t at, EditKind kind = EditKind::NewGroup);
    void remove(const LibrarySelection& selection);
    void moveSnippets(const Snippets& snippets, const std::shared_ptr<SnippetGroup>& group, std::size_t at);
    void moveGroups(const SnippetGroups& moved, std::size_t at);
    // Appends them as DataManager::append() does.
    void import(const ImportedLibrary& imported);

    // The copies. A snippet's copy counts by its bare abbreviation until the counts are made anew.
    LibrarySelection duplicate(const LibrarySelection& selection);

    std::vector<DuplicatedSnippets> duplicatedSnippets() const;
    void deleteDuplicatedSnippets(const std::vector<DuplicatedSnippets>& found);

    // By another key in ascending order, by the same one again the other way round.
    void sort(SortBy by);
    SortBy sortBy() const { return sortBy_; }
    bool sortAscending() const { return sortAscending_; }
    void sortGroups();

  private:
    void changeSnippet(const std::shared_ptr<Snippet>& snippet, EditKind kind,
                       const std::function<void(Snippet&)>& change);
    // Watched by the recorder, which then stands for the whole edit.
    static void takeOut(const Snippets& snippets, EditRecorder& recorder);
    void finish(EditRecorder& recorder, EditKind kind, std::size_t count = 1);
    void notifyDataChanged();

    DataManager& manager_;
    const std::function<void(const LibraryChange&)> changed_;
    ZDDuplicateManager duplicateManager_;
    SortBy sortBy_ = SortBy::None;
    bool sortAscending_ = true;
    bool isChanging_ = false;
};

}  // namespace plume
