#include "app/editing/LibraryEditor.h"

#include <algorithm>
#include <unordered_map>
#include <unordered_set>
#include <utility>

namespace plume {

namespace {

// The list with `inserted` before what stands at place `at`; those of them that stand in it already go from there.
template <typename Record>
std::vector<std::shared_ptr<Record>> withInserted(const std::vector<std::shared_ptr<Record>>& list,
                                                  const std::vector<std::shared_ptr<Record>>& inserted,
                                                  std::size_t at) {
    const std::unordered_set<std::shared_ptr<Record>> moved(inserted.begin(), inserted.end());
    std::vector<std::shared_ptr<Record>> result;
    result.reserve(list.size() + inserted.size());
    for (std::size_t i = 0; i < list.size(); ++i) {
        if (i == at) result.insert(result.end(), inserted.begin(), inserted.end());
        if (!moved.contains(list[i])) result.push_back(list[i]);
    }
    if (at >= list.size()) result.insert(result.end(), inserted.begin(), inserted.end());
    return result;
}

template <typename Record>
std::vector<std::shared_ptr<Record>> without(std::vector<std::shared_ptr<Record>> list,
                                             const std::vector<std::shared_ptr<Record>>& removed) {
    const std::unordered_set<std::shared_ptr<Record>> isRemoved(removed.begin(), removed.end());
    std::erase_if(list, [&](const auto& record) { return isRemoved.contains(record); });
    return list;
}

}  // namespace

LibraryEditor::LibraryEditor(DataManager& dataManager, std::function<void(const LibraryChange&)> changed)
    : manager_(dataManager), changed_(std::move(changed)) {
    reloadDuplicateManager();
}

// ---- Changes ----

void LibraryEditor::notifyDataChanged() {
    isChanging_ = true;
    manager_.notifyDataChanged();
    isChanging_ = false;
}

void LibraryEditor::finish(EditRecorder& recorder, EditKind kind, std::size_t count) {
    const LibraryChange change = recorder.change(kind, count);
    if (change.isEmpty()) return;
    changed_(change);
    notifyDataChanged();
}

bool LibraryEditor::undo(const LibraryChange& change) {
    if (!change.canUndo(groups())) return false;
    change.undo(manager_.snippetGroups());
    reloadDuplicateManager();
    notifyDataChanged();
    return true;
}

bool LibraryEditor::redo(const LibraryChange& change) {
    if (!change.canRedo(groups())) return false;
    change.redo(manager_.snippetGroups());
    reloadDuplicateManager();
    notifyDataChanged();
    return true;
}

// ---- Duplicate abbreviations ----

void LibraryEditor::reloadDuplicateManager() {
    duplicateManager_.clear();
    for (const auto& group : groups()) addGroupToDulicateManager(*group);
}

void LibraryEditor::addGroupToDulicateManager(const SnippetGroup& group) {
    for (const auto& snippet : group.items()) duplicateManager_.add(snippet->abbreviationWithPrefix());
}

void LibraryEditor::removeGroupFromDulicateManager(const SnippetGroup& group) {
    for (const auto& snippet : group.items()) duplicateManager_.remove(snippet->abbreviationWithPrefix());
}

bool LibraryEditor::isDuplicated(const Snippet& snippet) const {
    return duplicateManager_.isDuplicated(snippet.abbreviationWithPrefix());
}

// ---- One snippet ----

void LibraryEditor::changeSnippet(const std::shared_ptr<Snippet>& snippet, EditKind kind,
                                  const std::function<void(Snippet&)>& change) {
    EditRecorder recorder(groups());
    recorder.willChange(snippet);
    change(*snippet);
    finish(recorder, kind);
}

bool LibraryEditor::setSnippetAbbreviation(const std::shared_ptr<Snippet>& snippet, const Text& abbreviation) {
    if (snippet->abbreviation().value_or(u"") == abbreviation.value_or(u"")) return false;
    bool concernsOthers = false;
    changeSnippet(snippet, EditKind::Abbreviation, [&](Snippet& changed) {
        const bool wasDuplicate = duplicateManager_.remove(changed.abbreviationWithPrefix());
        changed.setAbbreviation(abbreviation);
        const bool isDuplicate = duplicateManager_.add(changed.abbreviationWithPrefix());
        concernsOthers = wasDuplicate || isDuplicate;
    });
    return concernsOthers;
}

void LibraryEditor::setLabel(const std::shared_ptr<Snippet>& snippet, const Text& label) {
    if (snippet->label().value_or(u"") == label.value_or(u"")) return;
    changeSnippet(snippet, EditKind::Label, [&](Snippet& changed) { changed.setLabel(label); });
}

void LibraryEditor::setNote(const std::shared_ptr<Snippet>& snippet, const Text& note) {
    if (snippet->note().value_or(u"") == note.value_or(u"")) return;
    changeSnippet(snippet, EditKind::Note, [&](Snippet& changed) { changed.setNote(note); });
}

void LibraryEditor::setContentType(const std::shared_ptr<Snippet>& snippet, ContentType type) {
    changeSnippet(snippet, EditKind::Type, [&](Snippet& changed) { changed.setContentType(type); });
}

void LibraryEditor::setContent(const std::shared_ptr<Snippet>& snippet, const AttributedString& content) {
    const bool isRich = snippet->contentType() == ContentType::RichText;
    const AttributedString kept = isRich ? content : AttributedString(content.string());
    if (snippet->richTextContent() == kept) return;
    changeSnippet(snippet, EditKind::Content, [&](Snippet& changed) { changed.setRichTextContent(kept); });
}

void LibraryEditor::keepEdit(const std::shared_ptr<Snippet>& snippet, const Snippet& before, const Snippet& edited) {
    changeSnippet(snippet, EditKind::KeptEdit, [&](Snippet& changed) { changed.takeDifferences(before, edited); });
    reloadDuplicateManager();
}

void LibraryEditor::setCaseSensitivity(const Snippets& snippets, CaseSensitivity value) {
    EditRecorder recorder(groups());
    for (const auto& snippet : snippets) {
        recorder.willChange(snippet);
        snippet->setCaseSensitivity(value);
    }
    finish(recorder, EditKind::Case, snippets.size());
}

// ---- Groups' settings ----

void LibraryEditor::setName(const std::shared_ptr<SnippetGroup>& group, const Text& name) {
    if (group->name().value_or(u"") == name.value_or(u"")) return;
    changeSettings(
        group, [&](SnippetGroup& changed) { changed.setName(name); }, EditKind::GroupName);
}

void LibraryEditor::changeSettings(const std::shared_ptr<SnippetGroup>& group,
                                   const std::function<void(SnippetGroup&)>& change, EditKind kind) {
    EditRecorder recorder(groups());
    recorder.willChangeSettings(group);
    removeGroupFromDulicateManager(*group);
    change(*group);
    addGroupToDulicateManager(*group);
    finish(recorder, kind);
}

void LibraryEditor::resetSnippetCaseSensitivity(const std::shared_ptr<SnippetGroup>& group, CaseSensitivity value) {
    EditRecorder recorder(groups());
    for (const auto& snippet : group->items()) {
        recorder.willChange(snippet);
        snippet->setCaseSensitivity(value);
    }
    finish(recorder, EditKind::CaseReset, group->items().size());
}

// ---- What is in the library ----

void LibraryEditor::insertSnippets(const Snippets& snippets, const std::shared_ptr<SnippetGroup>& group, std::size_t at,
                                   EditKind kind) {
    EditRecorder recorder(groups());
    recorder.willChangeItems(group);
    group->replaceItems(withInserted(group->items(), snippets, at));
    reloadDuplicateManager();
    finish(recorder, kind, snippets.size());
}

void LibraryEditor::insertGroups(const SnippetGroups& inserted, std::size_t at, EditKind kind) {
    EditRecorder recorder(groups());
    manager_.snippetGroups() = withInserted(groups(), inserted, at);
    reloadDuplicateManager();
    finish(recorder, kind, inserted.size());
}

void LibraryEditor::takeOut(const Snippets& snippets, EditRecorder& recorder) {
    std::unordered_map<std::shared_ptr<SnippetGroup>, Snippets> byGroup;
    for (const auto& snippet : snippets) {
        if (auto group = snippet->parentGroup()) byGroup[std::move(group)].push_back(snippet);
    }
    for (const auto& [group, removed] : byGroup) {
        recorder.willChangeItems(group);
        group->replaceItems(without(group->items(), removed));
    }
}

void LibraryEditor::remove(const LibrarySelection& selection) {
    EditRecorder recorder(groups());
    takeOut(selection.snippets, recorder);
    manager_.snippetGroups() = without(groups(), selection.groups);
    reloadDuplicateManager();
    finish(recorder, EditKind::Deletion, selection.groups.size() + selection.snippets.size());
}

void LibraryEditor::moveSnippets(const Snippets& snippets, const std::shared_ptr<SnippetGroup>& group, std::size_t at) {
    EditRecorder recorder(groups());
    recorder.willChangeItems(group);
    const Snippets target = withInserted(group->items(), snippets, at);
    takeOut(snippets, recorder);
    group->replaceItems(target);
    reloadDuplicateManager();
    finish(recorder, EditKind::Move, snippets.size());
}

void LibraryEditor::moveGroups(const SnippetGroups& moved, std::size_t at) {
    insertGroups(moved, at, EditKind::Move);
}

void LibraryEditor::import(const ImportedLibrary& imported) {
    EditRecorder recorder(groups());
    // Those that are filled anew.
    for (const auto& group : imported.groups) {
        if (const auto known = manager_.groupWithName(group->name().value_or(u""))) recorder.willChangeItems(known);
    }
    manager_.append(imported);
    reloadDuplicateManager();
    finish(recorder, EditKind::Import, imported.groups.size());
}

LibrarySelection LibraryEditor::duplicate(const LibrarySelection& selection) {
    EditRecorder recorder(groups());
    LibrarySelection copies;
    for (const auto& snippet : selection.snippets) {
        const auto group = snippet->parentGroup();
        if (!group) continue;
        recorder.willChangeItems(group);
        const auto copy = snippet->copySnippet();
        duplicateManager_.add(copy->abbreviation());
        group->addItem(copy);
        copies.snippets.push_back(copy);
    }
    for (const auto& group : selection.groups) {
        const auto copy = group->copySnippetGroup(true);
        copy->setName(group->name().value_or(u"") + u" - Copy");
        addGroupToDulicateManager(*copy);
        manager_.snippetGroups().push_back(copy);
        copies.groups.push_back(copy);
    }
    finish(recorder, EditKind::Duplication, copies.snippets.size() + copies.groups.size());
    return copies;
}

std::vector<DuplicatedSnippets> LibraryEditor::duplicatedSnippets() const {
    return duplicatedSnippetsIn(groups(), [this](const Snippet& snippet) { return isDuplicated(snippet); });
}

void LibraryEditor::deleteDuplicatedSnippets(const std::vector<DuplicatedSnippets>& found) {
    EditRecorder recorder(groups());
    Snippets removed;
    for (const auto& find : found) removed.insert(removed.end(), find.others.begin(), find.others.end());
    for (const auto& snippet : removed) duplicateManager_.remove(snippet->abbreviationWithPrefix());
    takeOut(removed, recorder);
    finish(recorder, EditKind::DeletionOfDuplicates, removed.size());
}

// ---- Order ----

void LibraryEditor::sort(SortBy by) {
    sortAscending_ = by != sortBy_ || !sortAscending_;
    sortBy_ = by;
    if (by == SortBy::None) return;
    EditRecorder recorder(groups());
    for (const auto& group : groups()) {
        recorder.willChangeItems(group);
        group->replaceItems(sorted(group->items(), by, sortAscending_));
    }
    finish(recorder, EditKind::Sorting);
}

void LibraryEditor::sortGroups() {
    EditRecorder recorder(groups());
    manager_.snippetGroups() = sortedByName(groups());
    finish(recorder, EditKind::SortingOfGroups);
}

}  // namespace plume
