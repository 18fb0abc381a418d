#include "app/windows/PromptWindow.h"

#include <QCloseEvent>
#include <QDialogButtonBox>
#include <QLabel>
#include <QLocale>
#include <QPushButton>
#include <QTime>
#include <QVBoxLayout>
#include <chrono>
#include <utility>

#include "app/qt/Labels.h"
#include "app/qt/Sentences.h"

namespace plume {

namespace {

// Long enough to read one sentence.
constexpr std::chrono::seconds TimeToRead{3};

}  // namespace

PromptWindow::PromptWindow(const Error& missing, std::function<Result<void>()> checkAgain, std::function<void()> closed)
    : SmallWindow(tr("Plume")),
      checkAgain_(std::move(checkAgain)),
      closed_(std::move(closed)),
      heading_(makeHeading(tr("Plume cannot expand abbreviations yet"))),
      missing_(makeTextLabel(inUsersLanguage(missing.message))),
      advice_(makeTextLabel(tr("Put this right, then choose “Check Again”. You can also continue and do it later: "
                               "until then Plume runs, but abbreviations may stay as you type them."))),
      checkButton_(new QPushButton(tr("Check &Again"))),
      closeButton_(new QPushButton(tr("&Continue Anyway"))) {
    missing_->setTextInteractionFlags(Qt::TextSelectableByMouse | Qt::TextSelectableByKeyboard);
    missing_->setAccessibleName(tr("What is missing"));
    connect(checkButton_, &QPushButton::clicked, this, &PromptWindow::check);
    connect(closeButton_, &QPushButton::clicked, this, &QWidget::close);
    closeTimer_.setSingleShot(true);
    connect(&closeTimer_, &QTimer::timeout, this, &QWidget::close);
    checkButton_->setDefault(true);
    auto* buttons = new QDialogButtonBox;
    buttons->addButton(checkButton_, QDialogButtonBox::AcceptRole);
    buttons->addButton(closeButton_, QDialogButtonBox::RejectRole);
    auto* layout = new QVBoxLayout(this);
    layout->setSpacing(fontMetrics().height());
    layout->addWidget(heading_);
    layout->addWidget(missing_);
    layout->addWidget(advice_);
    layout->addStretch();
    layout->addWidget(buttons);
    fitTo(30 * fontMetrics().height());
    checkButton_->setFocus();
}

void PromptWindow::check() {
    const auto result = checkAgain_();
    if (result) return showThatAllIsWell();
    missing_->setText(inUsersLanguage(result.error().message));
    // The sentence may be the same as before: the time says that somebody has looked.
    advice_->setText(tr("Looked again at %1: it is not right yet. You can also continue and put it right later.")
                         .arg(QLocale().toString(QTime::currentTime(), QStringLiteral("HH:mm:ss"))));
}

void PromptWindow::showThatAllIsWell() {
    heading_->setText(tr("Plume is ready"));
    missing_->setText(tr("All that was missing is there now."));
    advice_->hide();
    checkButton_->hide();
    closeButton_->setText(tr("&Close"));
    closeButton_->setFocus();
    closeTimer_.start(TimeToRead);
}

void PromptWindow::closeEvent(QCloseEvent* event) {
    SmallWindow::closeEvent(event);
    if (const auto closed = std::exchange(closed_, nullptr)) closed();
}

}  // namespace plume
