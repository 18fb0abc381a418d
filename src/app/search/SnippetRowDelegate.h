// Draws rows of snippets: abbreviation, label and content in one line, the group and the shortcut at its end.
//
// On the main thread; its list owns it.
#pragma once

#include <QStyledItemDelegate>

#include "app/search/SnippetRow.h"

namespace plume {

class SnippetRowDelegate final : public QStyledItemDelegate {
    Q_OBJECT
  public:
    using QStyledItemDelegate::QStyledItemDelegate;

    void paint(QPainter* painter, const QStyleOptionViewItem& option, const QModelIndex& index) const override;
    QSize sizeHint(const QStyleOptionViewItem& option, const QModelIndex& index) const override;
    // What the row takes when nothing of it is left out.
    static int fullWidth(const QFont& font, const SnippetRow& row);
};

}  // namespace plume
