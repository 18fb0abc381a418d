#include "app/form/InlineText.h"

#include <QAbstractTextDocumentLayout>
#include <QEvent>
#include <QScrollBar>
#include <QTextBlock>
#include <QTextDocument>
#include <QTextLayout>
#include <algorithm>
#include <cmath>
#include <utility>

namespace plume {

namespace {

constexpr int WidgetObject = QTextFormat::UserObject + 1;
constexpr int WidgetProperty = QTextFormat::UserProperty + 1;
constexpr double Margin = 8;

InlineWidget* widgetIn(const QTextFormat& format) {
    return qobject_cast<InlineWidget*>(format.property(WidgetProperty).value<QObject*>());
}

// How high a line has to be for a widget, so that its text and the line's stand on one line. The layout puts an
// object's middle half of half an "x" above the line on which text stands.
double heightInLine(const InlineWidget& widget, const QFont& font) {
    const double halfOfX = QFontMetricsF(font).xHeight() / 2;
    const int above = widget.baseline();
    const int below = widget.sizeHint().height() - above;
    return std::max(2 * above - halfOfX, 2 * below + halfOfX);
}

// What is measured of the text when its lines are so long.
template <typename Measure>
double withTextWidth(QTextDocument& text, double width, Measure measure) {
    const double usual = text.textWidth();
    text.setTextWidth(width);
    const double result = measure(text);
    text.setTextWidth(usual);
    return result;
}

// Where an object begins whose place runs with its line or against it. Where the direction changes behind it, the next
// place does not say which, and the paragraph does.
double leftEdge(const QTextLine& line, int index, double width, bool isParagraphFromRight) {
    const double start = line.cursorToX(index);
    const double end = line.cursorToX(index + 1);
    if (std::abs(start + width - end) < 1) return start;
    if (std::abs(start - width - end) < 1) return start - width;
    return isParagraphFromRight ? start - width : start;
}

}  // namespace

int InlineWidget::baseline() const {
    const QFontMetrics letters = fontMetrics();
    return (sizeHint().height() + letters.ascent() - letters.descent()) / 2;
}

bool InlineWidget::event(QEvent* event) {
    if (event->type() == QEvent::LayoutRequest) Q_EMIT resized();
    return QWidget::event(event);
}

InlineText::InlineText() {
    setReadOnly(true);
    setUndoRedoEnabled(false);
    setFocusPolicy(Qt::NoFocus);
    setTextInteractionFlags(Qt::NoTextInteraction);
    viewport()->setCursor(Qt::ArrowCursor);
    setFrameShape(QFrame::NoFrame);
    setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    setWordWrapMode(QTextOption::WrapAtWordBoundaryOrAnywhere);
    // On the window's own background fields can be told from what they stand in.
    viewport()->setBackgroundRole(QPalette::Window);
    document()->setDocumentMargin(Margin);
    document()->documentLayout()->registerHandler(WidgetObject, this);
}

void InlineText::appendText(const QString& text, const QTextCharFormat& format) {
    QTextCursor cursor(document());
    cursor.movePosition(QTextCursor::End);
    cursor.insertText(text, format);
}

void InlineText::appendLineBreak() {
    QTextCursor cursor(document());
    cursor.movePosition(QTextCursor::End);
    cursor.insertBlock();
}

void InlineText::appendWidget(InlineWidget* widget) {
    widget->setParent(viewport());
    widget->show();
    QTextCharFormat format;
    format.setObjectType(WidgetObject);
    format.setProperty(WidgetProperty, QVariant::fromValue<QObject*>(widget));
    format.setVerticalAlignment(QTextCharFormat::AlignMiddle);
    QTextCursor cursor(document());
    cursor.movePosition(QTextCursor::End);
    placed_.push_back({widget, cursor.position(), {}});
    cursor.insertText(QString(QChar::ObjectReplacementCharacter), format);
    connect(widget, &InlineWidget::resized, this, [this, index = placed_.size() - 1] { layOutAgain(index); });
}

int InlineText::idealWidth() const {
    const double width = withTextWidth(*document(), -1, [](const QTextDocument& shown) { return shown.idealWidth(); });
    return static_cast<int>(std::ceil(width)) + verticalScrollBar()->sizeHint().width();
}

int InlineText::heightForWidth(int width) const {
    const double height =
        withTextWidth(*document(), width, [](const QTextDocument& shown) { return shown.size().height(); });
    return static_cast<int>(std::ceil(height));
}

QSize InlineText::sizeHint() const {
    return {idealWidth(), static_cast<int>(document()->size().height())};
}

void InlineText::reveal(const QWidget& inner) {
    const int top = inner.mapTo(viewport(), QPoint(0, 0)).y();
    const int bottom = top + inner.height();
    constexpr int Around = 12;
    QScrollBar& bar = *verticalScrollBar();
    if (bottom + Around > viewport()->height()) bar.setValue(bar.value() + bottom + Around - viewport()->height());
    if (const int above = inner.mapTo(viewport(), QPoint(0, 0)).y() - Around; above < 0) {
        bar.setValue(bar.value() + above);
    }
}

void InlineText::resizeEvent(QResizeEvent* event) {
    QTextEdit::resizeEvent(event);
    placeWidgets();
}

void InlineText::showEvent(QShowEvent* event) {
    QTextEdit::showEvent(event);
    placeWidgets();
}

void InlineText::changeEvent(QEvent* event) {
    QTextEdit::changeEvent(event);
    if (event->type() == QEvent::FontChange || event->type() == QEvent::StyleChange) placeWidgets();
}

void InlineText::scrollContentsBy(int dx, int dy) {
    QTextEdit::scrollContentsBy(dx, dy);
    placeWidgets();
}

QSizeF InlineText::intrinsicSize(QTextDocument* shown, int /*position*/, const QTextFormat& format) {
    InlineWidget* widget = widgetIn(format);
    if (!widget) return {};
    // Without a width lines have no end.
    const bool hasWidth = shown->textWidth() > 0;
    const double room = shown->textWidth() - 2 * shown->documentMargin();
    if (hasWidth) widget->setRoom(static_cast<int>(room));
    const double width = widget->sizeHint().width();
    return {hasWidth ? std::min(width, room) : width, heightInLine(*widget, format.toCharFormat().font())};
}

void InlineText::layOutAgain(std::size_t index) {
    Placed& placed = placed_[index];
    if (placed.widget->sizeHint() == placed.size) return;
    document()->markContentsDirty(placed.position, 1);
    placeSoon();
}

// Once for all that change together.
void InlineText::placeSoon() {
    if (std::exchange(isPlacedSoon_, true)) return;
    QMetaObject::invokeMethod(this, "placeWidgets", Qt::QueuedConnection);
}

void InlineText::placeWidgets() {
    isPlacedSoon_ = false;
    const QPoint scrolled(horizontalScrollBar()->value(), verticalScrollBar()->value());
    const int room = static_cast<int>(document()->textWidth() - 2 * document()->documentMargin());
    for (auto& [widget, position, known] : placed_) {
        known = widget->sizeHint();
        const QTextBlock block = document()->findBlock(position);
        const int index = position - block.position();
        const QPointF blockCorner = document()->documentLayout()->blockBoundingRect(block).topLeft();
        const QTextLine line = block.layout()->lineForTextPosition(index);
        if (!line.isValid()) continue;
        const QSize size(std::min(known.width(), room), known.height());
        const double left = leftEdge(line, index, size.width(), block.textDirection() == Qt::RightToLeft);
        const QPointF corner = blockCorner + QPointF(left, line.y() + line.ascent() - widget->baseline());
        widget->setGeometry(QRect(corner.toPoint() - scrolled, size));
    }
}

}  // namespace plume
