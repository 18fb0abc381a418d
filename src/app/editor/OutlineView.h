// The list of groups and snippets in the editor's window.
//
// On the main thread; the window owns it and its model. What is selected, which groups are open and where the keyboard
// is stay with the records when the rows are made anew.
#pragma once

#include <QSet>
#include <QStringList>
#include <QTreeView>
#include <functional>

#include "app/editor/OutlineModel.h"

namespace plume {

class OutlineView final : public QTreeView {
    Q_OBJECT
  public:
    // The model outlives it.
    explicit OutlineView(OutlineModel& model);

    // Has the model show other rows. While a search is shown all groups are open, and what is opened and closed then
    // is forgotten with it.
    void reload(const std::function<void()>& showRows, bool isSearch);

    LibrarySelection selection() const;
    // Those that are shown; their groups are opened. The first one has the keyboard, and is scrolled to.
    void select(const LibrarySelection& selection);
    void startRenaming(const SnippetGroup& group);
    // The row that has the keyboard; its group, or that around it.
    std::shared_ptr<SnippetGroup> currentGroup() const;

    // By their identities.
    QStringList openGroups() const;
    void setOpenGroups(const QStringList& identities);
    void openAll();

    Q_SIGNAL void selectionWasChanged();

  protected:
    void selectionChanged(const QItemSelection& selected, const QItemSelection& deselected) override;

  private:
    void openKnownGroups();
    void noteOpened(const QModelIndex& index, bool isOpen);

    OutlineModel& model_;
    QSet<QString> open_;
    bool isSearch_ = false;
    bool isReloading_ = false;
};

}  // namespace plume
