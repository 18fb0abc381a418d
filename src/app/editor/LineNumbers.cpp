#include "app/editor/LineNumbers.h"

#include <QMouseEvent>
#include <QPaintEvent>
#include <QPainter>
#include <algorithm>

#include "app/editor/ScriptEdit.h"

namespace plume {

namespace {

// The width does not change while the first lines are written.
constexpr qsizetype FewestDigits = 2;

}  // namespace

LineNumbers::LineNumbers(ScriptEdit& edit) : QWidget(&edit), edit_(edit) {}

QSize LineNumbers::sizeHint() const {
    const qsizetype digits = std::max(QString::number(edit_.blockCount()).size(), FewestDigits);
    const int digit = edit_.fontMetrics().horizontalAdvance(QLatin1Char('9'));
    return {static_cast<int>(digits + 2) * digit, 0};
}

void LineNumbers::paintEvent(QPaintEvent* event) {
    QPainter painter(this);
    painter.fillRect(event->rect(), palette().color(QPalette::AlternateBase));
    painter.setFont(edit_.font());
    const int margin = edit_.fontMetrics().horizontalAdvance(QLatin1Char('9'));
    const int caretLine = edit_.textCursor().blockNumber() + 1;
    for (const ScriptEdit::VisibleLine& line : edit_.visibleLines()) {
        const QRect place(0, line.top, width() - margin, line.height);
        if (!place.intersects(event->rect())) continue;
        painter.setPen(palette().color(line.number == caretLine ? QPalette::Text : QPalette::PlaceholderText));
        painter.drawText(place, Qt::AlignRight | Qt::AlignTop, QString::number(line.number));
    }
}

void LineNumbers::mousePressEvent(QMouseEvent* event) {
    edit_.setTextCursor(edit_.cursorForPosition({0, event->position().toPoint().y()}));
    edit_.setFocus(Qt::MouseFocusReason);
}

}  // namespace plume
