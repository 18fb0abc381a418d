#include "app/editor/OutlineView.h"

#include <utility>

#include "app/qt/Text.h"
#include "app/search/SnippetRowDelegate.h"

namespace plume {

namespace {

// Empty when an archive gave the group none.
QString identityOf(const SnippetGroup& group) {
    return group.uuid() ? toQString(group.uuid()->toString()) : QString();
}

}  // namespace

OutlineView::OutlineView(OutlineModel& model) : model_(model) {
    setModel(&model);
    setItemDelegate(new SnippetRowDelegate(this));
    setHeaderHidden(true);
    setUniformRowHeights(true);
    setSelectionMode(ExtendedSelection);
    setEditTriggers(EditKeyPressed);
    setDragEnabled(true);
    setAcceptDrops(true);
    setDropIndicatorShown(true);
    setDragDropMode(DragDrop);
    setDefaultDropAction(Qt::MoveAction);
    setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    setVerticalScrollMode(ScrollPerPixel);
    setAccessibleName(tr("Groups and snippets"));
    connect(this, &QTreeView::expanded, this, [this](const QModelIndex& index) { noteOpened(index, true); });
    connect(this, &QTreeView::collapsed, this, [this](const QModelIndex& index) { noteOpened(index, false); });
}

void OutlineView::reload(const std::function<void()>& showRows, bool isSearch) {
    const LibrarySelection selected = selection();
    const auto snippet = model_.snippetAt(currentIndex());
    const auto group = model_.groupAt(currentIndex());
    isReloading_ = true;
    isSearch_ = isSearch;
    showRows();
    isSearch ? expandToDepth(0) : openKnownGroups();
    select(selected);
    const QModelIndex current = snippet ? model_.indexOf(*snippet) : group ? model_.indexOf(*group) : QModelIndex();
    if (current.isValid()) selectionModel()->setCurrentIndex(current, QItemSelectionModel::NoUpdate);
    isReloading_ = false;
    Q_EMIT selectionWasChanged();
}

LibrarySelection OutlineView::selection() const {
    return model_.rows(selectionModel()->selectedRows());
}

void OutlineView::select(const LibrarySelection& selection) {
    QItemSelection rows;
    QModelIndex first;
    const auto add = [&](const QModelIndex& index) {
        if (!index.isValid()) return;
        if (index.parent().isValid()) expand(index.parent());
        if (!first.isValid()) first = index;
        rows.select(index, index);
    };
    for (const auto& group : selection.groups) add(model_.indexOf(*group));
    for (const auto& snippet : selection.snippets) add(model_.indexOf(*snippet));
    selectionModel()->select(rows, QItemSelectionModel::ClearAndSelect);
    if (!first.isValid()) return;
    selectionModel()->setCurrentIndex(first, QItemSelectionModel::NoUpdate);
    scrollTo(first);
}

void OutlineView::startRenaming(const SnippetGroup& group) {
    const QModelIndex index = model_.indexOf(group);
    if (index.isValid()) edit(index);
}

std::shared_ptr<SnippetGroup> OutlineView::currentGroup() const {
    return model_.groupAround(currentIndex());
}

// ---- Which groups are open ----

void OutlineView::noteOpened(const QModelIndex& index, bool isOpen) {
    const auto group = model_.groupAt(index);
    if (isReloading_ || isSearch_ || !group) return;
    isOpen ? static_cast<void>(open_.insert(identityOf(*group))) : static_cast<void>(open_.remove(identityOf(*group)));
}

void OutlineView::openKnownGroups() {
    for (int row = 0; row < model_.rowCount(); ++row) {
        const QModelIndex index = model_.index(row, 0);
        if (open_.contains(identityOf(*model_.groupAt(index)))) expand(index);
    }
}

QStringList OutlineView::openGroups() const {
    return open_.values();
}

void OutlineView::setOpenGroups(const QStringList& identities) {
    open_ = {identities.begin(), identities.end()};
    openKnownGroups();
}

void OutlineView::openAll() {
    expandToDepth(0);
}

void OutlineView::selectionChanged(const QItemSelection& selected, const QItemSelection& deselected) {
    QTreeView::selectionChanged(selected, deselected);
    if (!isReloading_) Q_EMIT selectionWasChanged();
}

}  // namespace plume
