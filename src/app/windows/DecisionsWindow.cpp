#include "app/windows/DecisionsWindow.h"

#include <QBoxLayout>
#include <QDateTime>
#include <QFrame>
#include <QHeaderView>
#include <QLabel>
#include <QLocale>
#include <QPointer>
#include <QPushButton>
#include <QShortcut>
#include <QShowEvent>
#include <QStackedWidget>
#include <QStandardItemModel>
#include <QTreeView>
#include <algorithm>
#include <chrono>

#include "app/qt/Labels.h"
#include "app/qt/WindowPlaces.h"
#include "app/windows/DecisionWords.h"

namespace plume {

namespace {

enum Column : int { Time, Abbreviation, Group, Reason };
constexpr int UsualLines = 5;  // of an explanation

// With seconds, and without the time zone that long formats have.
QString timeText(Date date) {
    const auto milliseconds = std::chrono::floor<std::chrono::milliseconds>(date.time_since_epoch()).count();
    const QDateTime moment = QDateTime::fromMSecsSinceEpoch(milliseconds);
    const QLocale locale;
    QString format = locale.timeFormat(QLocale::LongFormat);
    format.remove(QStringLiteral("(t)")).remove(QLatin1Char('t'));
    QString time = locale.toString(moment.time(), format.simplified());
    if (moment.date() == QDate::currentDate()) return time;
    return locale.toString(moment.date(), QLocale::ShortFormat) + QLatin1Char(' ') + time;
}

QList<QStandardItem*> rowOf(const MatchDecision& decision) {
    const DecisionWords words = DecisionWords::of(decision);
    const QString time = timeText(decision.time);
    QList<QStandardItem*> row;
    for (const QString& text : {time, words.abbreviation, words.group, words.reason}) {
        row.append(new QStandardItem(text));
    }
    const QString all = words.sentence + QLatin1Char(' ') + words.advice;
    row[Time]->setAccessibleText(time + QStringLiteral(": ") + all.trimmed());
    return row;
}

}  // namespace

DecisionsWindow::DecisionsWindow(Services services, WritableUserDefaults& settings)
    : SmallWindow(tr("Why Didn't It Expand?")),
      services_(std::move(services)),
      model_(new QStandardItemModel(this)),
      pages_(new QStackedWidget) {
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(makeTextLabel(
        tr("What became of the abbreviations that you typed last, the newest first. Plume remembers twenty of "
           "them until it ends, and nothing else of what you type.")));
    auto* told = new QWidget;
    auto* toldLayout = new QVBoxLayout(told);
    toldLayout->setContentsMargins({});
    toldLayout->addWidget(makeList(), 1);
    toldLayout->addWidget(makeExplanation());
    pages_->addWidget(told);
    pages_->addWidget(makeEmptyPage());
    layout->addWidget(pages_, 1);
    layout->addLayout(makeButtons());
    connect(new QShortcut(QKeySequence(Qt::Key_F5), this), &QShortcut::activated, this, &DecisionsWindow::ask);
    resize(800, 480);
    rememberPlace(*this, settings, "Decisions");
}

QWidget* DecisionsWindow::makeList() {
    list_ = new QTreeView;
    list_->setModel(model_);
    list_->setAccessibleName(tr("Abbreviations that you typed last"));
    list_->setRootIsDecorated(false);
    list_->setUniformRowHeights(true);
    list_->setAlternatingRowColors(true);
    list_->setAllColumnsShowFocus(true);
    list_->setEditTriggers(QAbstractItemView::NoEditTriggers);
    model_->setHorizontalHeaderLabels({tr("Time"), tr("Abbreviation"), tr("Group"), tr("What happened")});
    connect(list_->selectionModel(), &QItemSelectionModel::currentRowChanged, this, &DecisionsWindow::explain);
    return list_;
}

QWidget* DecisionsWindow::makeExplanation() {
    auto* frame = new QFrame;
    frame->setFrameShape(QFrame::StyledPanel);
    auto* layout = new QVBoxLayout(frame);
    explanation_ = makeTextLabel();
    explanation_->setTextInteractionFlags(Qt::TextSelectableByMouse | Qt::TextSelectableByKeyboard);
    explanation_->setFocusPolicy(Qt::StrongFocus);
    explanation_->setAlignment(Qt::AlignLeading | Qt::AlignTop);
    // The list does not jump where one explanation is longer than another.
    explanation_->setMinimumHeight(UsualLines * explanation_->fontMetrics().lineSpacing());
    layout->addWidget(explanation_);
    return frame;
}

QWidget* DecisionsWindow::makeEmptyPage() {
    QLabel* text =
        makeTextLabel(tr("Nothing to tell yet. Type an abbreviation in any program and come back: what became of "
                         "it stands here then."));
    text->setAlignment(Qt::AlignCenter);
    return text;
}

QLayout* DecisionsWindow::makeButtons() {
    forgetButton_ = new QPushButton(tr("&Forget These"));
    forgetButton_->setEnabled(false);
    refreshButton_ = new QPushButton(tr("&Refresh"));
    connect(forgetButton_, &QPushButton::clicked, this, &DecisionsWindow::forget);
    connect(refreshButton_, &QPushButton::clicked, this, &DecisionsWindow::ask);
    refreshButton_->setDefault(true);
    forgetButton_->setAutoDefault(false);
    auto* buttons = new QHBoxLayout;
    buttons->addWidget(forgetButton_);
    buttons->addStretch();
    buttons->addWidget(refreshButton_);
    return buttons;
}

void DecisionsWindow::showEvent(QShowEvent* event) {
    SmallWindow::showEvent(event);
    if (!event->spontaneous()) ask();
}

bool DecisionsWindow::event(QEvent* event) {
    if (event->type() == QEvent::WindowActivate) ask();
    return SmallWindow::event(event);
}

void DecisionsWindow::ask() {
    services_.ask([window = QPointer(this)](std::vector<MatchDecision> decisions) {
        if (window) window->take(std::move(decisions));
    });
}

void DecisionsWindow::forget() {
    services_.forget();
    refreshButton_->setFocus();
    ask();
}

void DecisionsWindow::take(std::vector<MatchDecision> decisions) {
    std::ranges::reverse(decisions);
    pages_->setCurrentIndex(decisions.empty() ? 1 : 0);
    forgetButton_->setEnabled(!decisions.empty());
    // A reader is not thrown back to the top for nothing.
    if (decisions == decisions_) return;
    const auto row = static_cast<std::size_t>(std::max(list_->currentIndex().row(), 0));
    auto chosen = decisions.begin();
    // Whoever stays with the newest one wants to see the newest.
    if (row > 0) chosen = std::ranges::find(decisions, decisions_[row]);
    const auto newRow = chosen == decisions.end() ? 0 : chosen - decisions.begin();
    decisions_ = std::move(decisions);
    fillList();
    list_->setCurrentIndex(model_->index(static_cast<int>(newRow), Time));
}

void DecisionsWindow::fillList() {
    const int rowHeight = list_->fontMetrics().lineSpacing() * 3 / 2;
    model_->removeRows(0, model_->rowCount());
    for (const MatchDecision& decision : decisions_) {
        model_->appendRow(rowOf(decision));
        // The last column takes the width that is left, so that only the height counts.
        model_->item(model_->rowCount() - 1, Reason)->setSizeHint(QSize(0, rowHeight));
    }
    fitColumns();
}

void DecisionsWindow::fitColumns() {
    const int character = list_->fontMetrics().averageCharWidth();
    for (const int column : {Time, Abbreviation, Group}) {
        list_->resizeColumnToContents(column);
        list_->setColumnWidth(column, std::min(list_->columnWidth(column) + 2 * character, 24 * character));
    }
}

void DecisionsWindow::explain(const QModelIndex& row) {
    if (!row.isValid()) return;
    const DecisionWords words = DecisionWords::of(decisions_[static_cast<std::size_t>(row.row())]);
    explanation_->setText(words.advice.isEmpty() ? words.sentence
                                                 : words.sentence + QStringLiteral("\n\n") + words.advice);
}

}  // namespace plume
