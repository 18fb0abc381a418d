#include "app/preferences/PageIcons.h"

#include <QApplication>
#include <QIconEngine>
#include <QPainter>
#include <QPalette>
#include <vector>

namespace plume {

namespace {

// Places on a grid of 24 by 24.
constexpr qreal Grid = 24;
constexpr qreal PenWidth = 1.7;

struct Shape {
    enum class Kind { Line, Ellipse, Box };
    Kind kind;
    QRectF place;
};

Shape line(qreal x1, qreal y1, qreal x2, qreal y2) {
    return {Shape::Kind::Line, QRectF(QPointF(x1, y1), QPointF(x2, y2))};
}

Shape circle(qreal x, qreal y, qreal radius) {
    return {Shape::Kind::Ellipse, QRectF(x - radius, y - radius, 2 * radius, 2 * radius)};
}

Shape box(qreal x, qreal y, qreal width, qreal height) {
    return {Shape::Kind::Box, QRectF(x, y, width, height)};
}

std::vector<Shape> shapesOf(PageIcon icon) {
    switch (icon) {
        case PageIcon::General:  // sliders
            return {line(3, 7, 21, 7), line(3, 17, 21, 17), circle(9, 7, 2.6), circle(15, 17, 2.6)};
        case PageIcon::Expansion:  // little becomes much
            return {line(3, 12, 7, 12), line(10, 12, 12, 12), line(15, 6, 21, 6), line(15, 12, 21, 12),
                    line(15, 18, 21, 18)};
        case PageIcon::Search:
            return {circle(10, 10, 6.5), line(15, 15, 21, 21)};
        case PageIcon::Typing:  // a clipboard
            return {box(4, 5, 16, 16), box(9, 3, 6, 4), line(8, 12, 16, 12), line(8, 16, 13, 16)};
        case PageIcon::Correction:  // a tick below a line
            return {line(4, 5, 20, 5), line(5, 15, 10, 20), line(10, 20, 19, 10)};
        case PageIcon::HotKeys:  // a keyboard
            return {box(2, 6, 20, 12), line(6, 10, 7, 10), line(11, 10, 13, 10), line(17, 10, 18, 10),
                    line(8, 14, 16, 14)};
        case PageIcon::Applications:  // windows
            return {box(3, 3, 7.5, 7.5), box(13.5, 3, 7.5, 7.5), box(3, 13.5, 7.5, 7.5), box(13.5, 13.5, 7.5, 7.5)};
        case PageIcon::Backups:  // a clock
            return {circle(12, 12, 9), line(12, 7, 12, 12), line(12, 12, 16, 14)};
        case PageIcon::ImportExport:
            return {line(8, 4, 8, 20),   line(4, 8, 8, 4),     line(12, 8, 8, 4),
                    line(16, 4, 16, 20), line(12, 16, 16, 20), line(20, 16, 16, 20)};
        case PageIcon::Advanced:  // a list of names and values
            return {line(3, 6, 8, 6),     line(11, 6, 21, 6), line(3, 12, 8, 12),
                    line(11, 12, 21, 12), line(3, 18, 8, 18), line(11, 18, 21, 18)};
    }
    return {};
}

class PageIconEngine final : public QIconEngine {
  public:
    explicit PageIconEngine(PageIcon icon) : icon_(icon) {}

    void paint(QPainter* painter, const QRect& place, QIcon::Mode mode, QIcon::State /*state*/) override {
        const QPalette palette = QApplication::palette();
        const bool isSelected = mode == QIcon::Selected;
        painter->save();
        painter->setRenderHint(QPainter::Antialiasing);
        painter->translate(place.topLeft());
        painter->scale(place.width() / Grid, place.height() / Grid);
        painter->setPen(QPen(palette.color(isSelected ? QPalette::HighlightedText : QPalette::Text), PenWidth,
                             Qt::SolidLine, Qt::RoundCap, Qt::RoundJoin));
        for (const Shape& shape : shapesOf(icon_)) draw(*painter, shape);
        painter->restore();
    }

    QPixmap pixmap(const QSize& size, QIcon::Mode mode, QIcon::State state) override {
        QPixmap pixmap(size);
        pixmap.fill(Qt::transparent);
        QPainter painter(&pixmap);
        paint(&painter, QRect(QPoint(), size), mode, state);
        return pixmap;
    }

    QIconEngine* clone() const override { return new PageIconEngine(icon_); }

  private:
    static void draw(QPainter& painter, const Shape& shape) {
        constexpr qreal Corner = 2;
        switch (shape.kind) {
            case Shape::Kind::Line:
                return painter.drawLine(shape.place.topLeft(), shape.place.bottomRight());
            case Shape::Kind::Ellipse:
                return painter.drawEllipse(shape.place);
            case Shape::Kind::Box:
                return painter.drawRoundedRect(shape.place, Corner, Corner);
        }
    }

    const PageIcon icon_;
};

}  // namespace

QIcon iconOfPage(PageIcon icon) {
    return QIcon(new PageIconEngine(icon));
}

}  // namespace plume
