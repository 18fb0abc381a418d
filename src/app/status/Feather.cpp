#include "app/status/Feather.h"

#include <QPainter>
#include <QPainterPath>

namespace plume::feather {

namespace {

constexpr double Gap = 4;

QPainterPath stroked(const QPainterPath& line, double width) {
    QPainterPathStroker stroker;
    stroker.setWidth(width);
    stroker.setCapStyle(Qt::RoundCap);
    stroker.setJoinStyle(Qt::RoundJoin);
    return stroker.createStroke(line);
}

QPainterPath lineFrom(double x1, double y1, double x2, double y2) {
    QPainterPath line(QPointF(x1, y1));
    line.lineTo(x2, y2);
    return line;
}

void cut(QPainter& painter, const QPainterPath& shape) {
    painter.save();
    painter.setCompositionMode(QPainter::CompositionMode_Clear);
    painter.fillPath(shape, Qt::black);
    painter.restore();
}

// What lies on the feather, with the gap around it. Made once: outlines take longer than drawing.
struct Shape {
    QPainterPath ink;
    QPainterPath gap;
};

void drawApart(QPainter& painter, const Shape& shape, const QBrush& brush) {
    cut(painter, shape.gap);
    painter.fillPath(shape.ink, brush);
}

Shape withGap(const QPainterPath& ink) {
    return {ink, ink.united(stroked(ink, 2 * Gap))};
}

Shape padlock() {
    constexpr QRectF Inside(40, 38, 16, 8);
    QPainterPath body;
    body.addRoundedRect(QRectF(34, 44, 28, 19), 3.5, 3.5);
    QPainterPath shackle(QPointF(40, 45));
    shackle.lineTo(40, 39);
    shackle.arcTo(QRectF(40, 31, 16, 16), 180, -180);
    shackle.lineTo(56, 45);
    Shape lock = withGap(body.united(stroked(shackle, 5)));
    QPainterPath inside;
    inside.addRect(Inside);
    lock.gap = lock.gap.united(inside);
    return lock;
}

Shape cross() {
    return withGap(stroked(lineFrom(39, 39, 58, 58), 7.5).united(stroked(lineFrom(58, 39, 39, 58), 7.5)));
}

QPainterPath vane() {
    QPainterPath path(QPointF(60, 4));
    path.cubicTo(37, 3, 10, 16, 13, 48);
    path.cubicTo(13.5, 50, 14.5, 50.5, 16, 50.5);
    path.cubicTo(27, 51, 36, 48, 42, 42.5);
    path.lineTo(35.5, 40.5);
    path.cubicTo(42, 40, 47, 37, 50.5, 32);
    path.lineTo(44, 29.5);
    path.cubicTo(54, 27, 59, 16, 60, 4);
    return path;
}

}  // namespace

void drawFeather(QPainter& painter, const QBrush& brush) {
    QPainterPath shaft(QPointF(6, 59));
    shaft.quadTo(22, 36, 42, 20);
    painter.fillPath(vane(), brush);
    cut(painter, stroked(shaft, 4));
    // The quill, below the vane.
    painter.fillPath(stroked(lineFrom(6.5, 58, 13.5, 48.5), 5), brush);
}

void drawStrike(QPainter& painter, const QBrush& brush) {
    static const Shape strike = withGap(stroked(lineFrom(8, 9, 55, 56), 6));
    drawApart(painter, strike, brush);
}

void drawPadlock(QPainter& painter, const QBrush& brush) {
    static const Shape lock = padlock();
    drawApart(painter, lock, brush);
}

void drawCross(QPainter& painter, const QBrush& brush) {
    static const Shape lines = cross();
    drawApart(painter, lines, brush);
}

}  // namespace plume::feather
