#include "app/preferences/SettingControls.h"

#include <QEvent>
#include <QFocusEvent>

#include "app/qt/Text.h"

namespace plume {

namespace {

constexpr int Pause = 400;  // milliseconds
constexpr int VisibleLines = 4;

}  // namespace

LinesEdit::LinesEdit(QWidget* parent) : QPlainTextEdit(parent) {
    setTabChangesFocus(true);
    setFixedHeight(fontMetrics().lineSpacing() * VisibleLines + 2 * (frameWidth() + int(document()->documentMargin())));
    pause_.setSingleShot(true);
    pause_.setInterval(Pause);
    connect(&pause_, &QTimer::timeout, this, [this] { tell(); });
    connect(this, &QPlainTextEdit::textChanged, this, [this] {
        if (!showing_) pause_.start();
    });
}

void LinesEdit::showText(const std::u16string& text) {
    // What came back from being told keeps the caret where it is.
    if (text == held_ && !pause_.isActive()) return;
    pause_.stop();
    held_ = text;
    showing_ = true;
    setPlainText(toQString(text));
    showing_ = false;
}

void LinesEdit::focusOutEvent(QFocusEvent* event) {
    finish();
    QPlainTextEdit::focusOutEvent(event);
}

void LinesEdit::finish() {
    if (!pause_.isActive()) return;
    pause_.stop();
    tell();
}

void LinesEdit::tell() {
    held_ = fromQString(toPlainText());
    Q_EMIT edited(held_);
}

}  // namespace plume
