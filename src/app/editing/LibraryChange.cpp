#include "app/editing/LibraryChange.h"

#include <algorithm>

namespace plume {

namespace {

template <typename Record>
std::vector<std::shared_ptr<Record>> replaced(const std::vector<std::shared_ptr<Record>>& list, std::size_t at,
                                              const std::vector<std::shared_ptr<Record>>& out,
                                              const std::vector<std::shared_ptr<Record>>& in) {
    const std::size_t first = std::min(at, list.size());
    const std::size_t last = std::min(first + out.size(), list.size());
    std::vector<std::shared_ptr<Record>> result;
    result.reserve(list.size() - (last - first) + in.size());
    result.insert(result.end(), list.begin(), list.begin() + static_cast<std::ptrdiff_t>(first));
    result.insert(result.end(), in.begin(), in.end());
    result.insert(result.end(), list.begin() + static_cast<std::ptrdiff_t>(last), list.end());
    return result;
}

template <typename Record>
bool standsAt(std::size_t at, const std::vector<std::shared_ptr<Record>>& records,
              const std::vector<std::shared_ptr<Record>>& list) {
    return at <= list.size() && records.size() <= list.size() - at &&
           std::equal(records.begin(), records.end(), list.begin() + static_cast<std::ptrdiff_t>(at));
}

}  // namespace

bool LibraryChange::isEmpty() const {
    return snippets.empty() && groups.empty() && !changesLists();
}

bool LibraryChange::canUndo(const SnippetGroups& library) const {
    const auto fits = [](const ItemsStep& step) {
        return standsAt(step.items.at, step.items.added, step.group->items());
    };
    return standsAt(groupList.at, groupList.added, library) && std::ranges::all_of(items, fits);
}

bool LibraryChange::canRedo(const SnippetGroups& library) const {
    const auto fits = [](const ItemsStep& step) {
        return standsAt(step.items.at, step.items.removed, step.group->items());
    };
    return standsAt(groupList.at, groupList.removed, library) && std::ranges::all_of(items, fits);
}

void LibraryChange::undo(SnippetGroups& library) const {
    library = replaced(library, groupList.at, groupList.added, groupList.removed);
    for (const auto& [group, list] : items) {
        group->replaceItems(replaced(group->items(), list.at, list.added, list.removed));
    }
    for (const auto& step : groups) step.record->takeSettings(*step.before);
    for (const auto& step : snippets) step.record->takeDifferences(*step.after, *step.before);
}

void LibraryChange::redo(SnippetGroups& library) const {
    for (const auto& step : snippets) step.record->takeDifferences(*step.before, *step.after);
    for (const auto& step : groups) step.record->takeSettings(*step.after);
    for (const auto& [group, list] : items) {
        group->replaceItems(replaced(group->items(), list.at, list.removed, list.added));
    }
    library = replaced(library, groupList.at, groupList.removed, groupList.added);
}

bool LibraryChange::absorb(const LibraryChange& later) {
    if (kind != later.kind || changesLists() || later.changesLists()) return false;
    const auto isAboutOne = [](const LibraryChange& change) {
        return change.snippets.size() + change.groups.size() == 1;
    };
    if (!isAboutOne(*this) || !isAboutOne(later) || snippets.size() != later.snippets.size()) return false;
    if (!snippets.empty()) {
        if (snippets.front().record != later.snippets.front().record) return false;
        snippets.front().after = later.snippets.front().after;
        return true;
    }
    if (groups.front().record != later.groups.front().record) return false;
    groups.front().after = later.groups.front().after;
    return true;
}

}  // namespace plume
