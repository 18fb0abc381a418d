// The groups and their snippets as the editor's list shows them: all of them, or those that a search has found.
//
// On the main thread; the window owns it. It keeps lists of its own, so that rows stay what they are until show() is
// called after a change of the library. What is typed into a row, dragged and dropped is told by signals, and done by
// whoever hears them.
#pragma once

#include <QAbstractItemModel>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "app/editing/LibraryEditor.h"
#include "app/search/SnippetRow.h"
#include "engine/SnippetSearch.h"

namespace plume {

class OutlineModel final : public QAbstractItemModel {
    Q_OBJECT
  public:
    // Of rows that are dragged, and of rows in the clipboard.
    static constexpr const char* RowsType = "OutlineViewItemPasteboardType";

    // What stands in the marks of rows besides what the search has found.
    using IsDuplicated = std::function<bool(const Snippet&)>;
    explicit OutlineModel(IsDuplicated isDuplicated, QObject* parent = nullptr);

    void show(const SnippetGroups& groups);
    // `groups` alone, with these of their snippets; `filter` is marked in them unless it is a pattern.
    void showFound(const SnippetGroups& groups, const SnippetSearch::Found& found, std::u16string filter,
                   bool isPattern);
    // Their rows are drawn anew.
    void update(const Snippet& snippet);
    void updateAll();

    // Null where the row is of the other kind.
    std::shared_ptr<SnippetGroup> groupAt(const QModelIndex& index) const;
    std::shared_ptr<Snippet> snippetAt(const QModelIndex& index) const;
    // The group of the row, or that in which the snippet's row stands; null for no row.
    std::shared_ptr<SnippetGroup> groupAround(const QModelIndex& index) const;
    // No index when it is not shown.
    QModelIndex indexOf(const SnippetGroup& group) const;
    QModelIndex indexOf(const Snippet& snippet) const;
    // In the order of the rows.
    LibrarySelection rows(const QModelIndexList& indexes) const;

    QModelIndex index(int row, int column, const QModelIndex& parent = {}) const override;
    QModelIndex parent(const QModelIndex& child) const override;
    int rowCount(const QModelIndex& parent = {}) const override;
    int columnCount(const QModelIndex& /*parent*/ = {}) const override { return 1; }
    QVariant data(const QModelIndex& index, int role) const override;
    bool setData(const QModelIndex& index, const QVariant& value, int role) override;
    Qt::ItemFlags flags(const QModelIndex& index) const override;
    Qt::DropActions supportedDropActions() const override { return Qt::MoveAction | Qt::CopyAction; }
    QStringList mimeTypes() const override;
    QMimeData* mimeData(const QModelIndexList& indexes) const override;
    bool dropMimeData(const QMimeData* data, Qt::DropAction action, int row, int column,
                      const QModelIndex& parent) override;

    // A name for a group, an abbreviation for a snippet.
    Q_SIGNAL void renamed(const QModelIndex& index, const QString& text);
    // Rows of this list: snippets to `group` before its place `at`, groups before that of all groups.
    Q_SIGNAL void dropped(const LibrarySelection& rows, const std::shared_ptr<SnippetGroup>& group, std::size_t at,
                          bool isCopy);
    Q_SIGNAL void textDropped(const QString& text, const std::shared_ptr<SnippetGroup>& group, std::size_t at);

  private:
    struct Node {
        std::shared_ptr<SnippetGroup> group;
        std::vector<std::shared_ptr<Snippet>> snippets;
    };

    const Node* nodeOf(const QModelIndex& index) const;
    static SnippetRow rowOf(const SnippetGroup& group, std::size_t shown);
    SnippetRow rowOf(const Snippet& snippet) const;
    MarkedText marked(const std::u16string& text) const;
    // The line in which the filter is found, or the first one.
    std::u16string shownLine(const std::u16string& content) const;
    QString marksOf(const Snippet& snippet) const;

    const IsDuplicated isDuplicated_;
    std::vector<Node> nodes_;
    std::u16string marked_;  // what is marked in texts; empty: nothing
    bool isFiltered_ = false;
    mutable LibrarySelection dragged_;  // a drag ends before the next one begins
};

}  // namespace plume
