#include "library/LibraryMerge.h"

#include <algorithm>
#include <map>
#include <utility>

namespace plume {

namespace {

template <typename Record>
std::shared_ptr<Record> withIdentityOf(const std::vector<std::shared_ptr<Record>>& list, const Record& record) {
    const auto found = std::find_if(list.begin(), list.end(),
                                    [&](const auto& other) { return other->uuid() && other->uuid() == record.uuid(); });
    return found == list.end() ? nullptr : *found;
}

// They have given it another content since both knew it.
bool wasChanged(const Snippet& theirs, const Snippet& before) {
    return theirs.dateModified() != before.dateModified();
}

void putInPlace(SnippetGroup& group, const std::shared_ptr<Snippet>& old, const std::shared_ptr<Snippet>& snippet) {
    const auto& items = group.items();
    const auto place = static_cast<std::size_t>(std::find(items.begin(), items.end(), old) - items.begin());
    group.removeItem(old);
    group.insertItem(snippet, place);
}

void takeOver(SnippetGroup& theirs, const std::shared_ptr<Snippet>& mine) {
    const auto other = withIdentityOf(theirs.items(), *mine);
    if (!other) {
        theirs.addItem(mine);
    } else if (other->dateModified() <= mine->dateModified()) {
        putInPlace(theirs, other, mine);
    }
}

void removeFrom(SnippetGroup& theirs, const Snippet& before) {
    const auto other = withIdentityOf(theirs.items(), before);
    if (other && !wasChanged(*other, before)) theirs.removeItem(other);
}

class Merge {
  public:
    Merge(const RecordedLibrary& before, const LibraryContents& mine, LibraryContents& theirs)
        : before_(before), mine_(mine), theirs_(theirs) {}

    void mergeList(const ListChange& change) {
        for (std::size_t i = 0; i < change.removed; ++i) removeGroup(before_.groups()[change.at + i]);
        for (std::size_t i = 0; i < change.added; ++i) addGroup(mine_.snippetGroups[change.at + i]);
    }

    void mergeGroup(const GroupChange& change, const ListChange& list) {
        const auto& mine = mine_.snippetGroups[change.group];
        const bool isBefore = change.group < list.at;
        const auto& before = before_.groups()[isBefore ? change.group : change.group - list.added + list.removed];
        SnippetGroup& theirs = theirGroup(*mine);
        if (change.settings) theirs.takeSettings(*mine);
        for (std::size_t i = 0; i < change.items.removed; ++i) {
            removeFrom(theirs, *before.items[change.items.at + i].state);
        }
        for (std::size_t i = 0; i < change.items.added; ++i) takeOver(theirs, mine->items()[change.items.at + i]);
        for (const std::size_t place : change.changed) takeOver(theirs, mine->items()[place]);
    }

  private:
    // Their group of the same identity; when they have removed it, it comes back without snippets.
    SnippetGroup& theirGroup(const SnippetGroup& mine) {
        if (const auto known = withIdentityOf(theirs_.snippetGroups, mine)) return *known;
        theirs_.snippetGroups.push_back(mine.snapshot());
        return *theirs_.snippetGroups.back();
    }

    void addGroup(const std::shared_ptr<SnippetGroup>& mine) {
        const auto known = withIdentityOf(theirs_.snippetGroups, *mine);
        if (!known) {
            theirs_.snippetGroups.push_back(mine);
            return;
        }
        for (const auto& snippet : mine->items()) takeOver(*known, snippet);
    }

    void removeGroup(const RecordedLibrary::RecordedGroup& before) {
        const auto& now = mine_.snippetGroups;
        if (std::find(now.begin(), now.end(), before.live) != now.end()) return;  // it only moved
        const auto theirs = withIdentityOf(theirs_.snippetGroups, *before.live);
        if (!theirs) return;
        for (const auto& snippet : before.items) removeFrom(*theirs, *snippet.state);
        if (theirs->items().empty()) std::erase(theirs_.snippetGroups, theirs);
    }

    const RecordedLibrary& before_;
    const LibraryContents& mine_;
    LibraryContents& theirs_;
};

using Records = std::map<Uuid, std::shared_ptr<Snippet>>;

// Every record is given once: a library may repeat an identity.
std::shared_ptr<Snippet> keptRecord(Records& mine, const std::shared_ptr<Snippet>& theirs) {
    const auto found = theirs->uuid() ? mine.find(*theirs->uuid()) : mine.end();
    if (found == mine.end() || !found->second->isSameRecordAs(*theirs)) return theirs;
    return mine.extract(found).mapped();
}

}  // namespace

void mergeLibraries(const RecordedLibrary& before, const LibraryContents& mine, const LibraryDelta& delta,
                    LibraryContents& theirs) {
    Merge merge(before, mine, theirs);
    merge.mergeList(delta.groups);
    for (const GroupChange& change : delta.groupChanges) merge.mergeGroup(change, delta.groups);
}

void keepRecords(const LibraryContents& mine, LibraryContents& theirs) {
    Records known;
    for (const auto& group : mine.snippetGroups) {
        for (const auto& snippet : group->items()) {
            if (snippet->uuid()) known.emplace(*snippet->uuid(), snippet);
        }
    }
    SnippetGroups left = mine.snippetGroups;
    for (auto& group : theirs.snippetGroups) {
        std::vector<std::shared_ptr<Snippet>> items;
        items.reserve(group->items().size());
        for (const auto& snippet : group->items()) items.push_back(keptRecord(known, snippet));
        if (const auto kept = withIdentityOf(left, *group)) {
            std::erase(left, kept);
            kept->takeSettings(*group);
            group = kept;
        }
        if (group->items() != items) group->replaceItems(items);
    }
}

}  // namespace plume
