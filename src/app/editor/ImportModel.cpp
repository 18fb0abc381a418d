#include "app/editor/ImportModel.h"

#include <algorithm>
#include <utility>

#include "app/FirstLine.h"
#include "app/qt/Text.h"

namespace plume {

namespace {

// In the index of a snippet's row: the place of its group plus one.
constexpr quintptr GroupRow = 0;

// Of a group's row, and of that of one of its snippets.
std::size_t groupOf(const QModelIndex& index) {
    const bool isGroup = index.internalId() == GroupRow;
    return isGroup ? static_cast<std::size_t>(index.row()) : static_cast<std::size_t>(index.internalId()) - 1;
}

QString nameOf(const SnippetGroup& group) {
    return toQString(group.name().value_or(u""));
}

QString countOfSnippets(std::size_t count) {
    if (count == 0) return ImportModel::tr("No snippets");
    if (count == 1) return ImportModel::tr("1 snippet");
    return ImportModel::tr("%n snippets", "", static_cast<int>(count));
}

}  // namespace

void ImportModel::show(ImportPreview preview) {
    beginResetModel();
    preview_ = std::move(preview);
    rows_.assign(preview_.groups.size(), {});
    for (std::size_t i = 0; i < rows_.size(); ++i) {
        const auto& conflicts = preview_.groups[i].conflicts;
        for (std::size_t at = 0; at < conflicts.size(); ++at) {
            rows_[i].conflicts.try_emplace(conflicts[at].snippet.get(), at);
        }
    }
    endResetModel();
}

std::size_t ImportModel::chosenCount() const {
    return static_cast<std::size_t>(
        std::count_if(rows_.begin(), rows_.end(), [](const Row& row) { return row.isChosen; }));
}

SnippetGroups ImportModel::chosenGroups() const {
    SnippetGroups groups;
    for (std::size_t i = 0; i < rows_.size(); ++i) {
        if (rows_[i].isChosen) groups.push_back(preview_.groups[i].group);
    }
    return groups;
}

// ---- Places ----

QModelIndex ImportModel::index(int row, int column, const QModelIndex& parent) const {
    if (!hasIndex(row, column, parent)) return {};
    return createIndex(row, column, parent.isValid() ? static_cast<quintptr>(parent.row()) + 1 : GroupRow);
}

QModelIndex ImportModel::parent(const QModelIndex& child) const {
    if (!child.isValid() || child.internalId() == GroupRow) return {};
    return createIndex(static_cast<int>(child.internalId() - 1), 0, GroupRow);
}

int ImportModel::rowCount(const QModelIndex& parent) const {
    if (!parent.isValid()) return static_cast<int>(rows_.size());
    if (parent.internalId() != GroupRow || parent.column() != 0) return 0;
    return static_cast<int>(preview_.groups[static_cast<std::size_t>(parent.row())].group->items().size());
}

// ---- Texts ----

QVariant ImportModel::headerData(int section, Qt::Orientation orientation, int role) const {
    if (orientation != Qt::Horizontal || role != Qt::DisplayRole) return {};
    switch (section) {
        case NameColumn:
            return tr("Group, Abbreviation");
        case ContentColumn:
            return tr("Content");
        case RemarkColumn:
            return tr("In Your Library");
        default:
            return {};
    }
}

QVariant ImportModel::data(const QModelIndex& index, int role) const {
    if (!index.isValid()) return {};
    const bool isGroup = index.internalId() == GroupRow;
    const std::size_t group = groupOf(index);
    if (isGroup && role == Qt::CheckStateRole && index.column() == NameColumn) {
        return rows_[group].isChosen ? Qt::Checked : Qt::Unchecked;
    }
    if (role != Qt::DisplayRole && role != Qt::ToolTipRole) return {};
    if (isGroup) return groupText(group, index.column());
    return snippetText(group, *preview_.groups[group].group->items()[static_cast<std::size_t>(index.row())],
                       index.column());
}

QString ImportModel::groupText(std::size_t group, int column) const {
    const ImportPreview::Group& shown = preview_.groups[group];
    if (column == NameColumn) return nameOf(*shown.group);
    if (column == ContentColumn) return countOfSnippets(shown.group->items().size());
    return groupRemark(shown);
}

QString ImportModel::groupRemark(const ImportPreview::Group& group) {
    if (group.replaces) return tr("Takes the place of your group of this name");
    const auto same = static_cast<std::size_t>(
        std::count_if(group.conflicts.begin(), group.conflicts.end(), [](const auto& each) { return each.isSame; }));
    const std::size_t other = group.conflicts.size() - same;
    if (same == group.group->items().size() && same > 0) return tr("All of it is there already");
    QStringList remarks;
    if (same == 1) remarks += tr("1 is there already");
    if (same > 1) remarks += tr("%n are there already", "", static_cast<int>(same));
    if (other == 1) remarks += tr("1 abbreviation is taken");
    if (other > 1) remarks += tr("%n abbreviations are taken", "", static_cast<int>(other));
    return remarks.join(QLatin1String(", "));
}

QString ImportModel::snippetText(std::size_t group, const Snippet& snippet, int column) const {
    if (column == NameColumn) return toQString(snippet.abbreviationWithPrefix().value_or(u""));
    if (column == RemarkColumn) return snippetRemark(group, snippet);
    if (snippet.label() && !snippet.label()->empty()) return toQString(*snippet.label());
    return toQString(firstLine(snippet.plainTextContent().value_or(u"")));
}

QString ImportModel::snippetRemark(std::size_t group, const Snippet& snippet) const {
    const auto found = rows_[group].conflicts.find(&snippet);
    if (found == rows_[group].conflicts.end()) return {};
    const ImportPreview::Conflict& conflict = preview_.groups[group].conflicts[found->second];
    const QString with = nameOf(*conflict.withGroup);
    if (!conflict.isInLibrary) return tr("Comes twice, also in “%1”").arg(with);
    return (conflict.isSame ? tr("Is there already, in “%1”") : tr("Is taken by another one in “%1”")).arg(with);
}

// ---- Choosing ----

bool ImportModel::setData(const QModelIndex& index, const QVariant& value, int role) {
    if (role != Qt::CheckStateRole || !index.isValid() || index.internalId() != GroupRow) return false;
    rows_[groupOf(index)].isChosen = value.toInt() == Qt::Checked;
    Q_EMIT dataChanged(index.siblingAtColumn(0), index.siblingAtColumn(ColumnCount - 1));
    const QModelIndex group = index.siblingAtColumn(0);
    const int snippets = rowCount(group);
    if (snippets > 0) Q_EMIT dataChanged(this->index(0, 0, group), this->index(snippets - 1, ColumnCount - 1, group));
    return true;
}

// Snippets of a group that is left out are grey.
Qt::ItemFlags ImportModel::flags(const QModelIndex& index) const {
    if (!index.isValid()) return Qt::NoItemFlags;
    if (index.internalId() == GroupRow) {
        const Qt::ItemFlags usual = Qt::ItemIsEnabled | Qt::ItemIsSelectable;
        return index.column() == NameColumn ? usual | Qt::ItemIsUserCheckable : usual;
    }
    const Qt::ItemFlags leaf = Qt::ItemIsSelectable | Qt::ItemNeverHasChildren;
    return rows_[groupOf(index)].isChosen ? leaf | Qt::ItemIsEnabled : leaf;
}

}  // namespace plume
