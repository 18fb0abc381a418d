// What a search found, row by row, with a divider above what is similar alone.
//
// On the main thread; the window owns it.
#pragma once

#include <QAbstractListModel>
#include <memory>
#include <string>
#include <vector>

#include "app/ranking/SnippetRanking.h"
#include "app/search/SnippetRow.h"

namespace plume {

class QuickSearchModel final : public QAbstractListModel {
    Q_OBJECT
  public:
    using QAbstractListModel::QAbstractListModel;

    // The snippets in the order in which they are shown, and what was searched for.
    void setResults(std::vector<RankedSnippet> results, std::u16string query, const SearchRule& rule);
    // What is held to pick with a digit: see QuickSearchController.
    void setSelectorKeyModifier(std::int64_t modifier);

    // Null for the divider and beyond the rows.
    std::shared_ptr<Snippet> snippetAt(int row) const;
    // The divider not counted; null past the end.
    std::shared_ptr<Snippet> snippetAtIndex(std::size_t index) const;
    std::vector<std::shared_ptr<Snippet>> firstSnippets(std::size_t count) const;

    int rowCount(const QModelIndex& parent = {}) const override;
    QVariant data(const QModelIndex& index, int role) const override;
    Qt::ItemFlags flags(const QModelIndex& index) const override;

  private:
    bool isDivider(int row) const { return row == dividerRow_; }
    std::size_t indexOf(int row) const;
    SnippetRow shownAt(int row) const;

    std::vector<RankedSnippet> results_;
    std::u16string query_;
    SearchRule rule_;
    std::int64_t selectorKeyModifier_ = 0;
    int dividerRow_ = -1;
};

}  // namespace plume
