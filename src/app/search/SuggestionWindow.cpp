#include "app/search/SuggestionWindow.h"

#include <QBoxLayout>
#include <QLabel>
#include <QListView>
#include <QLocale>
#include <QStandardItemModel>
#include <QWheelEvent>
#include <algorithm>

#include "app/qt/PopupPlace.h"
#include "app/qt/Text.h"
#include "app/search/SnippetRowDelegate.h"

namespace plume {

namespace {

constexpr int NarrowestList = 260;
constexpr int WidestList = 560;
constexpr int WheelStep = 40;  // eighths of a degree for one row: three rows a notch

SnippetRow shownRow(const SuggestionRow& row, std::int64_t selectorKeyModifier) {
    SnippetRow shown;
    shown.abbreviation = {inOneLine(row.abbreviation), {Range{0, row.typedLength}}};
    shown.label = {inOneLine(row.label), {}};
    shown.content = {inOneLine(row.content), {}};
    shown.shortcut = digitShortcut(row.digit, selectorKeyModifier);
    return shown;
}

}  // namespace

SuggestionWindow::SuggestionWindow()
    : QFrame(nullptr, Qt::ToolTip | Qt::FramelessWindowHint | Qt::WindowDoesNotAcceptFocus | Qt::WindowStaysOnTopHint),
      model_(new QStandardItemModel(this)),
      list_(new QListView),
      count_(new QLabel) {
    setAttribute(Qt::WA_ShowWithoutActivating);
    setFrameShape(QFrame::Box);
    setForegroundRole(QPalette::Mid);
    setFocusPolicy(Qt::NoFocus);
    setWindowTitle(tr("Suggestions"));
    setAccessibleName(tr("Suggestions"));
    list_->setModel(model_);
    list_->setItemDelegate(new SnippetRowDelegate(list_));
    list_->setAccessibleName(tr("Suggested snippets"));
    list_->setFocusPolicy(Qt::NoFocus);
    list_->setFrameShape(QFrame::NoFrame);
    list_->setUniformItemSizes(true);
    // A few rows are less than a list would like to have.
    list_->setMinimumSize(1, 1);
    list_->setEditTriggers(QAbstractItemView::NoEditTriggers);
    list_->setVerticalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    list_->setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    connect(list_, &QListView::clicked, this, &SuggestionWindow::rowClicked);
    count_->setAlignment(Qt::AlignTrailing | Qt::AlignVCenter);
    count_->setContentsMargins(8, 0, 8, 2);
    count_->setForegroundRole(QPalette::PlaceholderText);

    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins({});
    layout->setSpacing(0);
    layout->addWidget(list_);
    layout->addWidget(count_);
}

void SuggestionWindow::show(const SuggestionPage& page, const CaretPlace& place) {
    place_ = place;
    wheelRest_ = 0;
    width_ = NarrowestList;
    fill(page);
    placeWindow();
    QFrame::show();
    raise();
    if (events_.placed) events_.placed(screenFrame(*this));
}

void SuggestionWindow::update(const SuggestionPage& page) {
    if (!isVisible()) return;
    fill(page);
    placeWindow();
    if (events_.placed) events_.placed(screenFrame(*this));
}

void SuggestionWindow::fill(const SuggestionPage& page) {
    const bool sameRows = page.rows == page_.rows && page.selectorKeyModifier == page_.selectorKeyModifier &&
                          model_->rowCount() == static_cast<int>(page.rows.size());
    page_ = page;
    if (!sameRows) {
        model_->clear();
        for (const SuggestionRow& row : page.rows) {
            const SnippetRow shown = shownRow(row, page.selectorKeyModifier);
            auto* item = new QStandardItem(shown.abbreviation.text);
            item->setData(QVariant::fromValue(shown), SnippetRow::Role);
            item->setAccessibleText(shown.spoken());
            model_->appendRow(item);
        }
    }
    const bool inSight = page.selected >= page.first && page.selected < page.first + page.rows.size();
    const int row = inSight ? static_cast<int>(page.selected - page.first) : -1;
    list_->setCurrentIndex(model_->index(row, 0));
    fillCount(page);
}

void SuggestionWindow::fillCount(const SuggestionPage& page) {
    count_->setVisible(page.total > page.rows.size());
    const QLocale locale;
    const auto number = [&locale](std::size_t value) { return locale.toString(static_cast<qulonglong>(value)); };
    count_->setText(
        tr("%1 to %2 of %3").arg(number(page.first + 1), number(page.first + page.rows.size()), number(page.total)));
}

// It does not become narrower while one goes through it: the rows would jump.
QSize SuggestionWindow::fittingSize() {
    for (int row = 0; row < model_->rowCount(); ++row) {
        const auto shown = model_->index(row, 0).data(SnippetRow::Role).value<SnippetRow>();
        width_ = std::clamp(SnippetRowDelegate::fullWidth(list_->font(), shown), width_, WidestList);
    }
    const int rowHeight = std::max(1, list_->sizeHintForRow(0));
    const int countHeight = count_->isVisibleTo(this) ? count_->sizeHint().height() : 0;
    const int frame = 2 * frameWidth();
    return {width_ + frame, rowHeight * model_->rowCount() + countHeight + frame};
}

void SuggestionWindow::placeWindow() {
    setGeometry(popupGeometry(place_, fittingSize()));
}

void SuggestionWindow::rowClicked(const QModelIndex& index) const {
    if (events_.clicked) events_.clicked(page_.number, page_.first + static_cast<std::size_t>(index.row()));
}

void SuggestionWindow::wheelEvent(QWheelEvent* event) {
    event->accept();
    wheelRest_ -= event->angleDelta().y();
    const int rows = wheelRest_ / WheelStep;
    wheelRest_ -= rows * WheelStep;
    if (rows != 0 && events_.scrolled) events_.scrolled(rows);
}

}  // namespace plume
