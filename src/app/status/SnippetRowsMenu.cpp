#include "app/status/SnippetRowsMenu.h"

#include <QAction>
#include <algorithm>

namespace plume {

namespace {

template <typename T>
bool isSame(const std::weak_ptr<T>& one, const std::weak_ptr<T>& other) {
    return !one.owner_before(other) && !other.owner_before(one);
}

// How many pieces make it possible to reach each of `count` snippets with the fewest submenus on the way.
std::size_t piecesFor(std::size_t count) {
    std::size_t piece = SnippetRowsMenu::MostRows;
    while (count > piece * SnippetRowsMenu::MostRows) piece *= SnippetRowsMenu::MostRows;
    return (count + piece - 1) / piece;
}

}  // namespace

bool SnippetRowsMenu::Row::isSameAs(const Row& other) const {
    return text == other.text && isSame(snippet, other.snippet) && isSame(range.group, other.range.group) &&
           range.first == other.range.first && range.end == other.range.end;
}

SnippetRowsMenu::SnippetRowsMenu(Range range, MenuHome home, Choose choose, QWidget* parent)
    : QMenu(parent), range_(std::move(range)), home_(home), choose_(std::move(choose)) {
    connect(this, &QMenu::aboutToShow, this, &SnippetRowsMenu::fill);
}

void SnippetRowsMenu::expire() {
    isFresh_ = false;
    for (auto* menu : findChildren<SnippetRowsMenu*>(Qt::FindDirectChildrenOnly)) menu->expire();
}

void SnippetRowsMenu::fill() {
    // A panel does not always tell when a menu is opened anew.
    if (isFresh_ && home_ == MenuHome::Widget) return;
    isFresh_ = true;
    std::vector<Row> rows = rowsOfNow();
    // A panel's click on a row names the row that it was sent: rows that are right stay.
    if (std::equal(rows.begin(), rows.end(), rows_.begin(), rows_.end(),
                   [](const Row& one, const Row& other) { return one.isSameAs(other); })) {
        return;
    }
    clear();
    qDeleteAll(findChildren<SnippetRowsMenu*>(Qt::FindDirectChildrenOnly));
    rows_ = std::move(rows);
    for (const Row& row : rows_) addRow(row);
}

std::vector<SnippetRowsMenu::Row> SnippetRowsMenu::rowsOfNow() const {
    std::vector<Row> rows;
    const auto group = range_.group.lock();
    if (!group) return rows;
    const auto& items = group->items();
    const std::size_t end = std::min(range_.end, items.size());
    const std::size_t count = end > range_.first ? end - range_.first : 0;
    if (count <= MostRows) {
        for (std::size_t i = range_.first; i < end; ++i) {
            rows.push_back({asMenuText(snippetLine(*items[i]), home_), items[i]});
        }
        return rows;
    }
    const std::size_t pieces = piecesFor(count);
    for (std::size_t piece = 0; piece < pieces; ++piece) {
        const std::size_t from = range_.first + count * piece / pieces;
        const std::size_t to = range_.first + count * (piece + 1) / pieces;
        //: The first and the last of a range of snippets.
        const QString title = tr("%1 … %2").arg(snippetName(*items[from]), snippetName(*items[to - 1]));
        rows.push_back({asMenuText(title, home_), {}, {range_.group, from, to}});
    }
    return rows;
}

void SnippetRowsMenu::addRow(const Row& row) {
    if (row.range.end == NotFound) {
        connect(addAction(row.text), &QAction::triggered, this, [this, chosen = row.snippet] { choose_(chosen); });
        return;
    }
    auto* menu = new SnippetRowsMenu(row.range, home_, choose_, this);
    menu->setTitle(row.text);
    menu->setFont(font());
    addMenu(menu);
}

}  // namespace plume
