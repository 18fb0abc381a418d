#include "app/editor/TypedLine.h"

#include <QFocusEvent>
#include <chrono>

#include "app/qt/Text.h"

namespace plume {

namespace {

constexpr std::chrono::milliseconds PauseInALine{500};

}  // namespace

TypedLine::TypedLine(QWidget* parent) : QLineEdit(parent) {
    pause_.setSingleShot(true);
    pause_.setInterval(PauseInALine);
    connect(&pause_, &QTimer::timeout, this, &TypedLine::finish);
    connect(this, &QLineEdit::returnPressed, this, &TypedLine::finish);
    connect(this, &QLineEdit::textEdited, this, [this] { pause_.start(); });
}

void TypedLine::showText(const std::u16string& text) {
    if (text == held_) return;
    pause_.stop();
    held_ = text;
    setText(toQString(text));
    setCursorPosition(0);
}

void TypedLine::finish() {
    pause_.stop();
    // An archive may hold what a line does not keep as it is, like a line break: what nobody typed is not told.
    if (!isModified()) return;
    setModified(false);
    const std::u16string typed = fromQString(text());
    if (typed == held_) return;
    held_ = typed;
    Q_EMIT edited(held_);
}

void TypedLine::focusOutEvent(QFocusEvent* event) {
    finish();
    QLineEdit::focusOutEvent(event);
    if (event->reason() != Qt::PopupFocusReason) Q_EMIT left();
}

}  // namespace plume
