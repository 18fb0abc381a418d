// What a file would bring, as a list: groups that can be left out, below each its snippets.
//
// On the main thread; the window owns it.
#pragma once

#include <QAbstractItemModel>
#include <cstddef>
#include <unordered_map>
#include <vector>

#include "app/editing/ImportPreview.h"

namespace plume {

class ImportModel final : public QAbstractItemModel {
    Q_OBJECT
  public:
    enum Column { NameColumn, ContentColumn, RemarkColumn, ColumnCount };

    using QAbstractItemModel::QAbstractItemModel;

    // All groups are chosen.
    void show(ImportPreview preview);
    const ImportPreview& preview() const { return preview_; }
    std::size_t chosenCount() const;
    SnippetGroups chosenGroups() const;

    QModelIndex index(int row, int column, const QModelIndex& parent = {}) const override;
    QModelIndex parent(const QModelIndex& child) const override;
    int rowCount(const QModelIndex& parent = {}) const override;
    int columnCount(const QModelIndex& /*parent*/ = {}) const override { return ColumnCount; }
    QVariant headerData(int section, Qt::Orientation orientation, int role) const override;
    QVariant data(const QModelIndex& index, int role) const override;
    bool setData(const QModelIndex& index, const QVariant& value, int role) override;
    Qt::ItemFlags flags(const QModelIndex& index) const override;

  private:
    struct Row {
        bool isChosen = true;
        std::unordered_map<const Snippet*, std::size_t> conflicts;  // places in the group's list
    };

    QString groupText(std::size_t group, int column) const;
    QString snippetText(std::size_t group, const Snippet& snippet, int column) const;
    static QString groupRemark(const ImportPreview::Group& group);
    QString snippetRemark(std::size_t group, const Snippet& snippet) const;

    ImportPreview preview_;
    std::vector<Row> rows_;  // as many as groups
};

}  // namespace plume
