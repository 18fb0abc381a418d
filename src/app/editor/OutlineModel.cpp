#include "app/editor/OutlineModel.h"

#include <QMimeData>
#include <algorithm>
#include <array>
#include <utility>

#include "Foundation/Strings.h"
#include "app/FirstLine.h"
#include "app/editing/RowsAsText.h"
#include "app/qt/Text.h"

namespace plume {

namespace {

// What an index carries: for a group's row nothing, for a snippet's the place of its group, from 1 on.
quintptr idOfChildren(int groupRow) {
    return static_cast<quintptr>(groupRow) + 1;
}

}  // namespace

OutlineModel::OutlineModel(IsDuplicated isDuplicated, QObject* parent)
    : QAbstractItemModel(parent), isDuplicated_(std::move(isDuplicated)) {}

// ---- What is shown ----

void OutlineModel::show(const SnippetGroups& groups) {
    beginResetModel();
    nodes_.clear();
    for (const auto& group : groups) nodes_.push_back({group, group->items()});
    marked_.clear();
    isFiltered_ = false;
    endResetModel();
}

void OutlineModel::showFound(const SnippetGroups& groups, const SnippetSearch::Found& found, std::u16string filter,
                             bool isPattern) {
    beginResetModel();
    nodes_.clear();
    for (const auto& group : groups) nodes_.push_back({group, found.at(group)});
    marked_ = isPattern ? std::u16string() : std::move(filter);
    isFiltered_ = true;
    endResetModel();
}

void OutlineModel::update(const Snippet& snippet) {
    const QModelIndex changed = indexOf(snippet);
    if (changed.isValid()) Q_EMIT dataChanged(changed, changed);
}

void OutlineModel::updateAll() {
    if (nodes_.empty()) return;
    const int last = static_cast<int>(nodes_.size()) - 1;
    Q_EMIT dataChanged(index(0, 0), index(last, 0));
    for (int row = 0; row <= last; ++row) {
        const QModelIndex parent = index(row, 0);
        const int count = rowCount(parent);
        if (count > 0) Q_EMIT dataChanged(index(0, 0, parent), index(count - 1, 0, parent));
    }
}

// ---- Rows and records ----

const OutlineModel::Node* OutlineModel::nodeOf(const QModelIndex& index) const {
    if (!index.isValid()) return nullptr;
    const auto row = index.internalId() == 0 ? static_cast<std::size_t>(index.row())
                                             : static_cast<std::size_t>(index.internalId() - 1);
    return row < nodes_.size() ? &nodes_[row] : nullptr;
}

std::shared_ptr<SnippetGroup> OutlineModel::groupAt(const QModelIndex& index) const {
    return index.isValid() && index.internalId() == 0 ? groupAround(index) : nullptr;
}

std::shared_ptr<Snippet> OutlineModel::snippetAt(const QModelIndex& index) const {
    if (!index.isValid() || index.internalId() == 0) return nullptr;
    const Node* node = nodeOf(index);
    const auto row = static_cast<std::size_t>(index.row());
    return node && row < node->snippets.size() ? node->snippets[row] : nullptr;
}

std::shared_ptr<SnippetGroup> OutlineModel::groupAround(const QModelIndex& index) const {
    const Node* node = nodeOf(index);
    return node ? node->group : nullptr;
}

QModelIndex OutlineModel::indexOf(const SnippetGroup& group) const {
    const auto found = std::ranges::find(nodes_, &group, [](const Node& node) { return node.group.get(); });
    return found == nodes_.end() ? QModelIndex() : index(static_cast<int>(found - nodes_.begin()), 0);
}

QModelIndex OutlineModel::indexOf(const Snippet& snippet) const {
    const auto group = snippet.parentGroup();
    const QModelIndex parent = group ? indexOf(*group) : QModelIndex();
    if (!parent.isValid()) return {};
    const auto& shown = nodeOf(parent)->snippets;
    const auto found = std::ranges::find(shown, &snippet, [](const auto& each) { return each.get(); });
    return found == shown.end() ? QModelIndex() : index(static_cast<int>(found - shown.begin()), 0, parent);
}

LibrarySelection OutlineModel::rows(const QModelIndexList& indexes) const {
    QModelIndexList ordered = indexes;
    const auto place = [](const QModelIndex& index) {
        const bool isGroup = index.internalId() == 0;
        return std::pair(isGroup ? static_cast<quintptr>(index.row()) : index.internalId() - 1,
                         isGroup ? -1 : index.row());
    };
    std::ranges::sort(ordered, {}, place);
    LibrarySelection selection;
    for (const QModelIndex& index : std::as_const(ordered)) {
        if (auto snippet = snippetAt(index)) {
            selection.snippets.push_back(std::move(snippet));
        } else if (auto group = groupAt(index)) {
            selection.groups.push_back(std::move(group));
        }
    }
    return selection;
}

// ---- The model ----

QModelIndex OutlineModel::index(int row, int column, const QModelIndex& parent) const {
    if (!hasIndex(row, column, parent)) return {};
    return createIndex(row, column, parent.isValid() ? idOfChildren(parent.row()) : 0);
}

QModelIndex OutlineModel::parent(const QModelIndex& child) const {
    if (!child.isValid() || child.internalId() == 0) return {};
    return createIndex(static_cast<int>(child.internalId()) - 1, 0, quintptr{0});
}

int OutlineModel::rowCount(const QModelIndex& parent) const {
    if (!parent.isValid()) return static_cast<int>(nodes_.size());
    if (parent.internalId() != 0) return 0;
    const Node* node = nodeOf(parent);
    return node ? static_cast<int>(node->snippets.size()) : 0;
}

Qt::ItemFlags OutlineModel::flags(const QModelIndex& index) const {
    // Groups go between groups.
    if (!index.isValid()) return isFiltered_ ? Qt::NoItemFlags : Qt::ItemIsDropEnabled;
    Qt::ItemFlags flags = Qt::ItemIsSelectable | Qt::ItemIsEnabled | Qt::ItemIsEditable | Qt::ItemIsDragEnabled;
    // Places among what is found say nothing about places in the group.
    if (index.internalId() == 0 && !isFiltered_) flags |= Qt::ItemIsDropEnabled;
    if (index.internalId() != 0) flags |= Qt::ItemNeverHasChildren;
    return flags;
}

QVariant OutlineModel::data(const QModelIndex& index, int role) const {
    const Node* node = nodeOf(index);
    if (!node) return {};
    const auto snippet = snippetAt(index);
    const auto shown = [&] { return snippet ? rowOf(*snippet) : rowOf(*node->group, node->snippets.size()); };
    switch (role) {
        case SnippetRow::Role:
            return QVariant::fromValue(shown());
        case Qt::DisplayRole:
            return shown().abbreviation.text;
        case Qt::EditRole:
            return toQString((snippet ? snippet->abbreviation() : node->group->name()).value_or(u""));
        case Qt::AccessibleTextRole:
            return shown().spoken();
        default:
            return {};
    }
}

bool OutlineModel::setData(const QModelIndex& index, const QVariant& value, int role) {
    if (role != Qt::EditRole || !index.isValid()) return false;
    const QString text = value.toString();
    if (text != data(index, Qt::EditRole).toString()) Q_EMIT renamed(index, text);
    return true;
}

// ---- What a row says ----

SnippetRow OutlineModel::rowOf(const SnippetGroup& group, std::size_t shown) {
    SnippetRow row;
    const std::u16string name = group.name().value_or(u"");
    row.abbreviation.text = name.empty() ? tr("Untitled group") : inOneLine(name);
    row.group = QString::number(shown);
    if (group.expandTrigger() == ExpandTrigger::Never) row.shortcut = tr("Off");
    return row;
}

SnippetRow OutlineModel::rowOf(const Snippet& snippet) const {
    SnippetRow row;
    row.abbreviation = marked(snippet.abbreviationWithPrefix().value_or(u""));
    row.label = marked(snippet.label().value_or(u""));
    const auto& content = snippet.richTextContent();
    if (content) row.content = marked(shownLine(content->string()));
    row.shortcut = marksOf(snippet);
    return row;
}

std::u16string OutlineModel::shownLine(const std::u16string& content) const {
    const std::size_t found = marked_.empty() ? NotFound : findIgnoringCase(content, marked_);
    if (found == NotFound) return firstLine(content);
    const std::size_t lineEnd = content.find_last_of(u"\n\u2028\u2029", found);
    // Enough before it to be understood, little enough to be seen.
    constexpr std::size_t MostBefore = 24;
    const std::size_t lineStart = lineEnd == std::u16string::npos ? 0 : lineEnd + 1;
    if (found - lineStart <= MostBefore) return firstLine(std::u16string_view(content).substr(lineStart));
    return u"…" + firstLine(std::u16string_view(content).substr(found - MostBefore));
}

MarkedText OutlineModel::marked(const std::u16string& text) const {
    MarkedText result{inOneLine(text), {}};
    if (marked_.empty()) return result;
    for (const Range& range : rangesOfString(text, marked_, true)) result.marks.append(range);
    return result;
}

QString OutlineModel::marksOf(const Snippet& snippet) const {
    QStringList marks;
    if (isDuplicated_(snippet)) marks.append(tr("Duplicate"));
    if (snippet.isScript()) marks.append(tr("Script"));
    if (snippet.contentType() == ContentType::RichText) marks.append(tr("Formatted"));
    return marks.join(QStringLiteral(" · "));
}

// ---- Dragging ----

QStringList OutlineModel::mimeTypes() const {
    return {QString::fromLatin1(RowsType), QStringLiteral("text/plain")};
}

QMimeData* OutlineModel::mimeData(const QModelIndexList& indexes) const {
    dragged_ = rows(indexes);
    auto* data = new QMimeData;
    // Only this list can take its rows: what is dragged stays here.
    data->setData(QString::fromLatin1(RowsType), QByteArray());
    if (!dragged_.snippets.empty()) data->setText(toQString(textFromRows(dragged_.snippets)));
    return data;
}

bool OutlineModel::dropMimeData(const QMimeData* data, Qt::DropAction action, int row, int /*column*/,
                                const QModelIndex& parent) {
    const auto group = groupAt(parent);
    const std::size_t end = group ? group->items().size() : nodes_.size();
    const std::size_t at = row < 0 ? end : static_cast<std::size_t>(row);
    if (data->hasFormat(QString::fromLatin1(RowsType))) {
        Q_EMIT dropped(std::exchange(dragged_, {}), group, at, action == Qt::CopyAction);
    } else if (data->hasText()) {
        Q_EMIT textDropped(data->text(), group, at);
    }
    // Whoever heard it has moved the rows: the view has nothing to remove.
    return false;
}

}  // namespace plume
