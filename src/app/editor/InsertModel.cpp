#include "app/editor/InsertModel.h"

#include <QMimeData>
#include <algorithm>
#include <utility>

#include "app/FirstLine.h"
#include "app/qt/Text.h"
#include "content/PlaceholderBody.h"

namespace plume {

namespace {

constexpr std::size_t SearchedOfContent = 200;  // units

std::u16string_view contentOf(const Snippet& snippet) {
    return snippet.hasContent() ? std::u16string_view(snippet.richTextContent()->string()) : std::u16string_view();
}

QString groupNameOf(const Snippet& snippet) {
    const auto group = snippet.parentGroup();
    return group ? toQString(group->name().value_or(u"")) : QString();
}

SnippetRow shownAs(const InsertRow& row) {
    SnippetRow shown;
    if (row.snippet) {
        shown.abbreviation.text = inOneLine(row.snippet->abbreviationWithPrefix().value_or(u""));
        shown.label.text = inOneLine(row.snippet->label().value_or(u""));
        shown.content.text = inOneLine(firstLine(contentOf(*row.snippet)));
        shown.group = groupNameOf(*row.snippet);
    } else {
        shown.label.text = row.title;
        shown.content.text = row.sample;
        shown.group = row.kind;
    }
    return shown;
}

}  // namespace

void InsertModel::setRows(std::vector<InsertRow> rows) {
    beginResetModel();
    rows_ = std::move(rows);
    search_.clear();
    for (const InsertRow& row : rows_) {
        if (row.snippet) {
            const std::u16string rest = row.snippet->label().value_or(u"") + u' ' +
                                        std::u16string(contentOf(*row.snippet).substr(0, SearchedOfContent));
            search_.add(row.snippet->abbreviationWithPrefix().value_or(u""), rest);
        } else {
            search_.add(fromQString(row.title), fromQString(row.words + QLatin1Char(' ') + row.kind));
        }
    }
    shown_ = search_.find({});
    endResetModel();
}

void InsertModel::search(const QString& query) {
    beginResetModel();
    shown_ = search_.find(fromQString(query));
    endResetModel();
}

const InsertRow* InsertModel::rowAt(int row) const {
    return row >= 0 && row < rowCount() ? &rows_[shown_[static_cast<std::size_t>(row)]] : nullptr;
}

int InsertModel::rowOf(const Snippet& snippet) const {
    const auto isIt = [&](std::size_t place) { return rows_[place].snippet.get() == &snippet; };
    const auto found = std::find_if(shown_.begin(), shown_.end(), isIt);
    return found == shown_.end() ? -1 : static_cast<int>(found - shown_.begin());
}

int InsertModel::rowCount(const QModelIndex& parent) const {
    return parent.isValid() ? 0 : static_cast<int>(shown_.size());
}

QVariant InsertModel::data(const QModelIndex& index, int role) const {
    const InsertRow* row = rowAt(index.row());
    if (!row) return {};
    if (role == SnippetRow::Role) return QVariant::fromValue(shownAs(*row));
    return role == Qt::DisplayRole || role == Qt::AccessibleTextRole ? shownAs(*row).spoken() : QVariant();
}

Qt::ItemFlags InsertModel::flags(const QModelIndex& index) const {
    if (!index.isValid()) return Qt::NoItemFlags;
    return Qt::ItemIsEnabled | Qt::ItemIsSelectable | Qt::ItemIsDragEnabled | Qt::ItemNeverHasChildren;
}

QStringList InsertModel::mimeTypes() const {
    return {QStringLiteral("text/plain")};
}

QMimeData* InsertModel::mimeData(const QModelIndexList& indexes) const {
    QString text;
    for (const QModelIndex& index : indexes) {
        const InsertRow* row = rowAt(index.row());
        if (row) text += QChar(OpeningMarker) + toQString(row->body) + QChar(ClosingMarker);
    }
    if (text.isEmpty()) return nullptr;
    auto* data = new QMimeData;
    data->setText(text);
    return data;
}

}  // namespace plume
