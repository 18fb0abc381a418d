#include "library/LibraryFeed.h"

#include <iterator>

namespace plume {

namespace {

// With more than that at once it is cheaper to make the list of a group anew than to tell of every snippet.
constexpr std::size_t FewItems = 8;

template <typename Record>
auto placeIn(std::vector<Record>& list, std::size_t place) {
    return list.begin() + static_cast<std::ptrdiff_t>(place);
}

// Puts `added` where the change says; what stood there is in `added` then.
template <typename Record>
void exchange(std::vector<Record>& list, const ListChange& change, std::vector<Record>& added) {
    const auto first = placeIn(list, change.at);
    const auto end = first + static_cast<std::ptrdiff_t>(change.removed);
    std::vector<Record> removed(std::make_move_iterator(first), std::make_move_iterator(end));
    const auto place = list.erase(first, end);
    list.insert(place, added.begin(), added.end());
    added = std::move(removed);
}

void exchangeItems(SnippetGroup& group, const ListChange& change, std::vector<std::shared_ptr<Snippet>>& added) {
    if (change.removed + change.added > FewItems) {
        auto items = group.items();
        exchange(items, change, added);
        group.replaceItems(items);
        return;
    }
    std::vector<std::shared_ptr<Snippet>> removed;
    for (std::size_t i = 0; i < change.removed; ++i) {
        removed.push_back(group.items()[change.at]);
        group.removeItem(removed.back());
    }
    for (std::size_t i = 0; i < change.added; ++i) group.insertItem(added[i], change.at + i);
    added = std::move(removed);
}

void applyTo(SnippetGroup& group, LibraryUpdate::Group& update) {
    if (update.settings) group.takeSettings(*update.settings);
    exchangeItems(group, update.items, update.added);
    for (auto& [place, snippet] : update.changed) {
        auto previous = group.items()[place];
        group.removeItem(previous);
        group.insertItem(snippet, place);
        snippet = std::move(previous);
    }
}

std::vector<std::shared_ptr<Snippet>> copiesOf(const SnippetGroup& group, std::size_t first, std::size_t count) {
    std::vector<std::shared_ptr<Snippet>> copies;
    copies.reserve(count);
    for (std::size_t i = first; i < first + count; ++i) copies.push_back(group.items()[i]->snapshot());
    return copies;
}

std::shared_ptr<SnippetGroup> copyOf(const SnippetGroup& group) {
    auto copy = group.snapshot();
    copy->addItems(copiesOf(group, 0, group.items().size()));
    return copy;
}

LibraryUpdate::Group updateOf(const SnippetGroup& group, const GroupChange& change) {
    LibraryUpdate::Group update;
    update.place = change.group;
    if (change.settings) update.settings = group.snapshot();
    update.items = change.items;
    update.added = copiesOf(group, change.items.at, change.items.added);
    for (const std::size_t place : change.changed) update.changed.emplace_back(place, group.items()[place]->snapshot());
    return update;
}

}  // namespace

std::optional<LibraryUpdate> LibraryFeed::changesTo(const SnippetGroups& groups) {
    LibraryContents library;
    library.snippetGroups = groups;
    const LibraryDelta delta = sent_.changesTo(library);
    if (delta.isEmpty()) return std::nullopt;
    LibraryUpdate update;
    update.groups = delta.groups;
    for (std::size_t i = 0; i < delta.groups.added; ++i) {
        update.added.push_back(copyOf(*groups[delta.groups.at + i]));
    }
    for (const GroupChange& change : delta.groupChanges) {
        update.changed.push_back(updateOf(*groups[change.group], change));
    }
    sent_.record(library, delta);
    return update;
}

void FedLibrary::apply(LibraryUpdate& update) {
    exchange(groups_, update.groups, update.added);
    for (auto& change : update.changed) applyTo(*groups_[change.place], change);
}

}  // namespace plume
