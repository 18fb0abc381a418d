#include "app/form/UnsentTextWindow.h"

#include <QCloseEvent>
#include <QDialogButtonBox>
#include <QLabel>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QVBoxLayout>
#include <string_view>
#include <utility>

#include "app/qt/Labels.h"
#include "app/qt/PopupPlace.h"
#include "app/qt/Sentences.h"
#include "app/qt/Text.h"

namespace plume {

namespace {

constexpr std::size_t MostShown = 4000;
constexpr int LinesShown = 6;
constexpr int LeastLines = 2;  // when other things need more room

QString beginningOf(const std::u16string& text) {
    const QString shown = toQString(std::u16string_view(text).substr(0, MostShown));
    return text.size() > MostShown ? shown + QChar(u'…') : shown;
}

}  // namespace

UnsentTextWindow::UnsentTextWindow(const std::u16string& text, const std::string& reason, Actions actions)
    : QDialog(nullptr, Qt::Window | Qt::WindowStaysOnTopHint | Qt::WindowTitleHint | Qt::WindowSystemMenuHint |
                           Qt::WindowCloseButtonHint),
      actions_(std::move(actions)),
      remark_(makeTextLabel()),
      copyButton_(new QPushButton(tr("&Copy"))) {
    setAttribute(Qt::WA_ShowWithoutActivating);
    setAttribute(Qt::WA_QuitOnClose, false);
    setWindowTitle(tr("Text Not Inserted"));
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(makeHeading(tr("The text was not inserted")));
    layout->addWidget(makeTextLabel(inUsersLanguage(reason)));
    QWidget* box = makeTextBox(text);
    layout->addWidget(box, 1);
    layout->addWidget(remark_);
    layout->addWidget(makeButtons());
    copyButton_->setFocus();
    tell(tr("Plume keeps it until you close this window."));
    const int width = 28 * fontMetrics().height();
    const int height = layout->totalHeightForWidth(width) - box->sizeHint().height() + box->minimumHeight();
    resize(width, height + (LinesShown - LeastLines) * fontMetrics().lineSpacing());
    move(cornerGeometry(size()).topLeft());
}

QWidget* UnsentTextWindow::makeTextBox(const std::u16string& text) {
    auto* box = new QPlainTextEdit(beginningOf(text));
    box->setReadOnly(true);
    box->setTabChangesFocus(true);
    box->setAccessibleName(tr("The text"));
    // It can be read, and its parts copied, without the pointer, too.
    box->setTextInteractionFlags(Qt::TextSelectableByMouse | Qt::TextSelectableByKeyboard);
    const int frame = 2 * (box->frameWidth() + qRound(box->document()->documentMargin()));
    box->setMinimumHeight(LeastLines * box->fontMetrics().lineSpacing() + frame);
    return box;
}

QWidget* UnsentTextWindow::makeButtons() {
    auto* buttons = new QDialogButtonBox;
    buttons->addButton(copyButton_, QDialogButtonBox::ActionRole);
    const auto* tryButton = buttons->addButton(tr("&Try Again"), QDialogButtonBox::ActionRole);
    const auto* dropButton = buttons->addButton(tr("&Discard"), QDialogButtonBox::DestructiveRole);
    connect(copyButton_, &QPushButton::clicked, this, &UnsentTextWindow::copy);
    connect(tryButton, &QPushButton::clicked, this, [this] { end(actions_.tryAgain); });
    connect(dropButton, &QPushButton::clicked, this, [this] { end(actions_.drop); });
    // What does no harm is what an unexpected Return does.
    copyButton_->setDefault(true);
    return buttons;
}

void UnsentTextWindow::copy() {
    isSafe_ = true;
    tell(tr("Copied. The text is in the clipboard now."));
    post(actions_.copy);
}

void UnsentTextWindow::tell(const QString& remark) {
    remark_->setText(remark);
}

void UnsentTextWindow::reject() {
    if (isSafe_) {
        end(actions_.drop);
        return;
    }
    isSafe_ = true;
    tell(tr("Discard the text? Press Esc or close the window once more to discard it."));
}

void UnsentTextWindow::closeEvent(QCloseEvent* event) {
    event->ignore();
    reject();
}

// The window is destroyed by the action, perhaps, and so never inside a call of its own.
void UnsentTextWindow::end(std::function<void()> action) {
    if (!std::exchange(isEnded_, true)) post(std::move(action));
}

void UnsentTextWindow::post(std::function<void()> action) {
    posted_.push_back(std::move(action));
    QMetaObject::invokeMethod(this, "perform", Qt::QueuedConnection);
}

void UnsentTextWindow::perform() {
    const auto action = std::move(posted_.front());
    posted_.pop_front();
    action();
}

}  // namespace plume
