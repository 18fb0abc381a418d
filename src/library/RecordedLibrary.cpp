#include "library/RecordedLibrary.h"

#include <algorithm>
#include <tuple>
#include <utility>

namespace plume {

namespace {

using RecordedGroup = RecordedLibrary::RecordedGroup;
using RecordedSnippet = RecordedLibrary::RecordedSnippet;

auto identityOf(const LibraryContents& library) {
    return std::tie(library.dateInstalled, library.uuidString, library.versionUUIDString, library.dateCreated);
}

// What is left when the equal elements at both ends are taken away.
template <typename Recorded, typename Today>
ListChange changeOfList(const std::vector<Recorded>& before, const std::vector<Today>& now) {
    const std::size_t shorter = std::min(before.size(), now.size());
    std::size_t front = 0;
    while (front < shorter && before[front].live == now[front]) ++front;
    std::size_t back = 0;
    while (back < shorter - front && before[before.size() - 1 - back].live == now[now.size() - 1 - back]) ++back;
    return {front, before.size() - front - back, now.size() - front - back};
}

// Calls with the places before and now of every element that stands in both lists.
template <typename Call>
void forEachThatStayed(const ListChange& change, std::size_t now, Call call) {
    for (std::size_t i = 0; i < change.at; ++i) call(i, i);
    for (std::size_t i = change.at + change.added; i < now; ++i) call(i - change.added + change.removed, i);
}

GroupChange changesOf(const RecordedGroup& before, const SnippetGroup& now, std::size_t place) {
    GroupChange change;
    change.group = place;
    change.settings = !before.state->hasSameSettings(now);
    change.items = changeOfList(before.items, now.items());
    forEachThatStayed(change.items, now.items().size(), [&](std::size_t was, std::size_t is) {
        const RecordedSnippet& snippet = before.items[was];
        if (snippet.revision != snippet.live->revision()) change.changed.push_back(is);
    });
    return change;
}

}  // namespace

RecordedSnippet RecordedLibrary::recorded(const std::shared_ptr<Snippet>& snippet) const {
    return {snippet, snippet->revision(), keep_ == Keep::States ? snippet->snapshot() : nullptr};
}

RecordedGroup RecordedLibrary::recorded(const std::shared_ptr<SnippetGroup>& group) const {
    RecordedGroup result{group, group->snapshot(), {}};
    result.items.reserve(group->items().size());
    for (const auto& snippet : group->items()) result.items.push_back(recorded(snippet));
    return result;
}

template <typename Recorded, typename Today>
void RecordedLibrary::replay(const ListChange& change, std::vector<Recorded>& before,
                             const std::vector<Today>& now) const {
    const auto at = before.begin() + static_cast<std::ptrdiff_t>(change.at);
    const auto place = before.erase(at, at + static_cast<std::ptrdiff_t>(change.removed));
    std::vector<Recorded> added;
    added.reserve(change.added);
    for (std::size_t i = 0; i < change.added; ++i) added.push_back(recorded(now[change.at + i]));
    before.insert(place, std::make_move_iterator(added.begin()), std::make_move_iterator(added.end()));
}

void RecordedLibrary::record(const LibraryContents& library) {
    identity_ = library;
    identity_.snippetGroups.clear();
    groups_.clear();
    for (const auto& group : library.snippetGroups) groups_.push_back(recorded(group));
}

LibraryDelta RecordedLibrary::changesTo(const LibraryContents& library) const {
    LibraryDelta delta;
    delta.identity = identityOf(identity_) != identityOf(library);
    delta.groups = changeOfList(groups_, library.snippetGroups);
    forEachThatStayed(delta.groups, library.snippetGroups.size(), [&](std::size_t was, std::size_t is) {
        GroupChange change = changesOf(groups_[was], *library.snippetGroups[is], is);
        const bool any = change.settings || !change.items.isEmpty() || !change.changed.empty();
        if (any) delta.groupChanges.push_back(std::move(change));
    });
    return delta;
}

void RecordedLibrary::record(const LibraryContents& library, const LibraryDelta& delta) {
    std::tie(identity_.dateInstalled, identity_.uuidString, identity_.versionUUIDString, identity_.dateCreated) =
        identityOf(library);
    replay(delta.groups, groups_, library.snippetGroups);
    for (const GroupChange& change : delta.groupChanges) {
        const auto& live = library.snippetGroups[change.group];
        RecordedGroup& group = groups_[change.group];
        if (change.settings) group.state = live->snapshot();
        replay(change.items, group.items, live->items());
        for (const std::size_t place : change.changed) group.items[place] = recorded(live->items()[place]);
    }
}

LibraryContents RecordedLibrary::contents() const {
    LibraryContents result = identity_;
    result.snippetGroups.reserve(groups_.size());
    for (const RecordedGroup& group : groups_) {
        auto copy = group.state->snapshot();
        std::vector<std::shared_ptr<Snippet>> items;
        items.reserve(group.items.size());
        for (const RecordedSnippet& snippet : group.items) items.push_back(snippet.state);
        copy->addItems(items);
        result.snippetGroups.push_back(std::move(copy));
    }
    return result;
}

}  // namespace plume
