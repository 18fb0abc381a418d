#include "app/editing/EditRecorder.h"

#include <algorithm>
#include <utility>

namespace plume {

namespace {

template <typename Record>
LibraryChange::ListStep<Record> stepBetween(const std::vector<std::shared_ptr<Record>>& before,
                                            const std::vector<std::shared_ptr<Record>>& after) {
    const auto first = std::mismatch(before.begin(), before.end(), after.begin(), after.end());
    const auto last = std::mismatch(before.rbegin(), std::make_reverse_iterator(first.first), after.rbegin(),
                                    std::make_reverse_iterator(first.second));
    return {static_cast<std::size_t>(first.first - before.begin()),
            {first.first, last.first.base()},
            {first.second, last.second.base()}};
}

}  // namespace

EditRecorder::EditRecorder(const SnippetGroups& library) : library_(library), before_(library) {}

// Nothing is named twice by the edits that there are, which touch thousands of records at most once each.
void EditRecorder::willChange(const std::shared_ptr<Snippet>& snippet) {
    snippets_.push_back({snippet, snippet->snapshot(), nullptr});
}

void EditRecorder::willChangeSettings(const std::shared_ptr<SnippetGroup>& group) {
    groups_.push_back({group, group->snapshot(), nullptr});
}

void EditRecorder::willChangeItems(const std::shared_ptr<SnippetGroup>& group) {
    const auto isNamed = [&](const LibraryChange::ItemsStep& step) { return step.group == group; };
    if (std::any_of(items_.begin(), items_.end(), isNamed)) return;
    items_.push_back({group, {0, group->items(), {}}});
}

LibraryChange EditRecorder::change(EditKind kind, std::size_t count) {
    LibraryChange change;
    change.kind = kind;
    change.count = count;
    for (auto& step : snippets_) {
        if (step.record->revision() == step.before->revision()) continue;
        step.after = step.record->snapshot();
        if (!step.after->isSameRecordAs(*step.before)) change.snippets.push_back(std::move(step));
    }
    for (auto& step : groups_) {
        if (step.record->hasSameSettings(*step.before)) continue;
        step.after = step.record->snapshot();
        change.groups.push_back(std::move(step));
    }
    for (auto& [group, list] : items_) {
        auto step = stepBetween(list.removed, group->items());
        if (!step.isEmpty()) change.items.push_back({group, std::move(step)});
    }
    change.groupList = stepBetween(before_, library_);
    return change;
}

}  // namespace plume
