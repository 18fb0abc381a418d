// What can be put into a content, row by row: placeholders in ready variants and the library's snippets; those that a
// search has found.
//
// On the main thread; its menu or form owns it. Rows are dragged as text, with the markers around their body.
#pragma once

#include <QAbstractListModel>
#include <memory>
#include <string>
#include <vector>

#include "app/editing/RowSearch.h"
#include "app/editor/ChipFormServices.h"
#include "app/search/SnippetRow.h"

namespace plume {

struct InsertRow {
    QString title;
    QString words;   // is found by these too
    QString sample;  // what it gives now
    QString kind;
    std::u16string body;
    bool asks = false;                 // its parameters are to be asked for first
    std::shared_ptr<Snippet> snippet;  // null: the texts above say what it is
};

// Nothing but snippets, in library order, without the one that is edited.
std::vector<InsertRow> snippetRows(const ChipFormServices& services);
// Everything: placeholders first.
std::vector<InsertRow> insertRows(const ChipFormServices& services);

class InsertModel final : public QAbstractListModel {
    Q_OBJECT
  public:
    using QAbstractListModel::QAbstractListModel;

    // All of them are shown.
    void setRows(std::vector<InsertRow> rows);
    void search(const QString& query);

    // Null beyond the rows that are shown.
    const InsertRow* rowAt(int row) const;
    // -1 when it is not shown.
    int rowOf(const Snippet& snippet) const;

    int rowCount(const QModelIndex& parent = {}) const override;
    QVariant data(const QModelIndex& index, int role) const override;
    Qt::ItemFlags flags(const QModelIndex& index) const override;
    QStringList mimeTypes() const override;
    QMimeData* mimeData(const QModelIndexList& indexes) const override;
    Qt::DropActions supportedDragActions() const override { return Qt::CopyAction; }

  private:
    std::vector<InsertRow> rows_;
    std::vector<std::size_t> shown_;
    RowSearch search_;
};

}  // namespace plume
