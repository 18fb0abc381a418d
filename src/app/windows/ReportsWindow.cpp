#include "app/windows/ReportsWindow.h"

#include <QClipboard>
#include <QDateTime>
#include <QDialogButtonBox>
#include <QGuiApplication>
#include <QHeaderView>
#include <QLabel>
#include <QLocale>
#include <QPushButton>
#include <QScrollBar>
#include <QStandardItemModel>
#include <QStyledItemDelegate>
#include <QTreeView>
#include <QVBoxLayout>
#include <algorithm>
#include <chrono>

#include "app/qt/Labels.h"
#include "app/qt/Sentences.h"
#include "app/qt/WindowPlaces.h"

namespace plume {

namespace {

enum Column { TimeColumn, SentenceColumn, ActionColumn };
constexpr int NumberRole = Qt::UserRole;
constexpr int Padding = 5;

// Rows as high as the sentence in the width of its column. Rows of a tree view are as high as one line otherwise.
class WrappingDelegate final : public QStyledItemDelegate {
  public:
    explicit WrappingDelegate(QTreeView& view) : QStyledItemDelegate(&view), view_(view) {}

    QSize sizeHint(const QStyleOptionViewItem& option, const QModelIndex& index) const override {
        const QSize oneLine = QStyledItemDelegate::sizeHint(option, index);
        if (index.column() != SentenceColumn) return oneLine + QSize(0, 2 * Padding);
        const int margin = view_.style()->pixelMetric(QStyle::PM_FocusFrameHMargin, nullptr, &view_) + 1;
        const int width = std::max(1, view_.columnWidth(SentenceColumn) - 2 * margin);
        const QRect text =
            view_.fontMetrics().boundingRect(QRect(0, 0, width, 1 << 20), Qt::TextWordWrap, index.data().toString());
        return {oneLine.width(), text.height() + 2 * Padding};
    }

    // The text begins below the row's upper edge, as that of its button does.
    void paint(QPainter* painter, const QStyleOptionViewItem& option, const QModelIndex& index) const override {
        QStyleOptionViewItem background = option;
        view_.style()->drawPrimitive(QStyle::PE_PanelItemViewItem, &background, painter, &view_);
        QStyleOptionViewItem inner = option;
        inner.rect.adjust(0, Padding, 0, -Padding);
        QStyledItemDelegate::paint(painter, inner, index);
    }

  private:
    const QTreeView& view_;
};

// A button that is not stretched to the height of its row.
QWidget* atTop(QPushButton* button) {
    auto* holder = new QWidget;
    auto* layout = new QVBoxLayout(holder);
    layout->setContentsMargins(Padding, 1, Padding, 1);
    layout->addWidget(button);
    layout->addStretch();
    return holder;
}

QString timeOf(const LoggedReport& report) {
    const auto seconds = std::chrono::floor<std::chrono::seconds>(report.time).time_since_epoch().count();
    const QDateTime time = QDateTime::fromSecsSinceEpoch(seconds);
    return QLocale().toString(time.date(), QLocale::ShortFormat) + QLatin1Char(' ') +
           QLocale().toString(time.time(), QStringLiteral("HH:mm:ss"));
}

QString sentenceOf(const LoggedReport& report) {
    QString sentence = inUsersLanguage(report.sentence);
    if (report.count == 1) return sentence;
    return ReportsWindow::tr("%1 (%n times)", "", static_cast<int>(report.count)).arg(sentence);
}

}  // namespace

ReportsWindow::ReportsWindow(ReportLog& log, WritableUserDefaults& settings)
    : SmallWindow(tr("Recent Reports")),
      log_(log),
      model_(new QStandardItemModel(this)),
      list_(new QTreeView),
      nothing_(makeTextLabel(tr("Plume has had nothing to report."))) {
    makeList();
    makeLayout(settings);
    fill();
    subscription_ = log_.changedEvent.addObserver(this, &ReportsWindow::logChanged);
}

void ReportsWindow::makeList() {
    model_->setHorizontalHeaderLabels({tr("Time"), tr("Report"), tr("What you can do")});
    list_->setModel(model_);
    list_->setItemDelegate(new WrappingDelegate(*list_));
    list_->setRootIsDecorated(false);
    list_->setWordWrap(true);
    list_->setAllColumnsShowFocus(true);
    list_->setAlternatingRowColors(true);
    list_->setVerticalScrollMode(QAbstractItemView::ScrollPerPixel);
    list_->setAccessibleName(tr("Reports, newest first"));
    QHeaderView* header = list_->header();
    header->setStretchLastSection(false);
    header->setSectionsMovable(false);
    header->setSectionResizeMode(TimeColumn, QHeaderView::ResizeToContents);
    header->setSectionResizeMode(SentenceColumn, QHeaderView::Stretch);
    header->setSectionResizeMode(ActionColumn, QHeaderView::ResizeToContents);
    // Rows become as high as the new width demands.
    connect(header, &QHeaderView::sectionResized, model_, [this](int column) {
        if (column == SentenceColumn) Q_EMIT model_->layoutChanged();
    });
    connect(list_, &QTreeView::activated, this,
            [this](const QModelIndex& index) { runAction(index.siblingAtColumn(0).data(NumberRole).toULongLong()); });
}

void ReportsWindow::makeLayout(WritableUserDefaults& settings) {
    auto* buttons = new QDialogButtonBox;
    copyButton_ = buttons->addButton(tr("&Copy All"), QDialogButtonBox::ActionRole);
    clearButton_ = buttons->addButton(tr("C&lear"), QDialogButtonBox::ActionRole);
    for (QPushButton* button : {copyButton_, clearButton_}) button->setAutoDefault(false);
    connect(copyButton_, &QPushButton::clicked, this, &ReportsWindow::copyAll);
    connect(clearButton_, &QPushButton::clicked, this, [this] { log_.clear(); });
    auto* layout = new QVBoxLayout(this);
    nothing_->setAlignment(Qt::AlignCenter);
    layout->addWidget(nothing_, 1);
    layout->addWidget(list_, 1);
    layout->addWidget(buttons);
    const int em = fontMetrics().height();
    resize(42 * em, 22 * em);
    rememberPlace(*this, settings, "Reports");
}

void ReportsWindow::logChanged(ReportLogEvent& /*event*/) {
    const auto number = list_->currentIndex().siblingAtColumn(0).data(NumberRole);
    const QWidget* focused = focusWidget();
    const auto focusedNumber = focused && focused != list_ ? focused->property("number") : QVariant();
    const bool atTop = list_->verticalScrollBar()->value() == 0;
    fill();
    for (int row = 0; row < model_->rowCount(); ++row) {
        const QModelIndex index = model_->index(row, 0);
        const QVariant own = index.data(NumberRole);
        if (number.isValid() && own == number) list_->setCurrentIndex(index);
        const QWidget* action = list_->indexWidget(index.siblingAtColumn(ActionColumn));
        if (action && focusedNumber.isValid() && own == focusedNumber) action->findChild<QPushButton*>()->setFocus();
    }
    if (atTop) list_->scrollToTop();
}

void ReportsWindow::fill() {
    model_->removeRows(0, model_->rowCount());
    const auto& reports = log_.reports();
    for (auto report = reports.rbegin(); report != reports.rend(); ++report) addRow(*report);
    nothing_->setVisible(reports.empty());
    list_->setVisible(!reports.empty());
    copyButton_->setEnabled(!reports.empty());
    clearButton_->setEnabled(!reports.empty());
}

void ReportsWindow::addRow(const LoggedReport& report) {
    QList<QStandardItem*> row{new QStandardItem(timeOf(report)), new QStandardItem(sentenceOf(report)),
                              new QStandardItem};
    for (QStandardItem* item : row) {
        item->setEditable(false);
        item->setTextAlignment(Qt::AlignLeft | Qt::AlignTop);
    }
    const auto number = static_cast<qulonglong>(report.number);
    row.front()->setData(number, NumberRole);
    model_->appendRow(row);
    if (report.action.label.empty()) return;
    auto* button = new QPushButton(inUsersLanguage(report.action.label));
    button->setAutoDefault(false);
    button->setProperty("number", number);
    connect(button, &QPushButton::clicked, this, [this, number = report.number] { runAction(number); });
    list_->setIndexWidget(row.back()->index(), atTop(button));
}

void ReportsWindow::copyAll() {
    QString text;
    for (int row = 0; row < model_->rowCount(); ++row) {
        const QModelIndex time = model_->index(row, TimeColumn);
        text += time.data().toString() + QLatin1Char('\t') + time.siblingAtColumn(SentenceColumn).data().toString() +
                QLatin1Char('\n');
    }
    QGuiApplication::clipboard()->setText(text);
}

void ReportsWindow::runAction(std::uint64_t number) {
    const auto& reports = log_.reports();
    const auto found = std::find_if(reports.begin(), reports.end(),
                                    [&](const LoggedReport& report) { return report.number == number; });
    if (found == reports.end() || !found->action.run) return;
    // What it does may be reported, which may take the report out of the log.
    const auto run = found->action.run;
    run();
}

}  // namespace plume
