#include "app/qt/PopupPlace.h"

#include <QCursor>
#include <QGuiApplication>
#include <QScreen>
#include <QWidget>
#include <algorithm>

namespace plume {

namespace {

constexpr int Gap = 4;
constexpr int CornerMargin = 12;

// Screens begin at their own pixels, and are counted in Qt's from there on.
QRect ownPixels(const QScreen& screen) {
    return {screen.geometry().topLeft(), screen.geometry().size() * screen.devicePixelRatio()};
}

QScreen* screenOf(const Rectangle& rectangle) {
    const QPoint place(qRound(rectangle.origin.x), qRound(rectangle.origin.y));
    for (QScreen* screen : QGuiApplication::screens()) {
        if (ownPixels(*screen).contains(place)) return screen;
    }
    return nullptr;
}

QScreen* pointerScreen() {
    QScreen* const screen = QGuiApplication::screenAt(QCursor::pos());
    return screen ? screen : QGuiApplication::primaryScreen();
}

QRect inQtPixels(const Rectangle& rectangle, const QScreen& screen) {
    const double ratio = screen.devicePixelRatio();
    const QPoint origin = screen.geometry().topLeft();
    return {origin.x() + qRound((rectangle.origin.x - origin.x()) / ratio),
            origin.y() + qRound((rectangle.origin.y - origin.y()) / ratio), qRound(rectangle.size.width / ratio),
            qRound(rectangle.size.height / ratio)};
}

bool runsFromRight() {
    return QGuiApplication::layoutDirection() == Qt::RightToLeft;
}

}  // namespace

QRect popupGeometry(const CaretPlace& place, QSize size) {
    QScreen* screen = place.kind == CaretPlace::Kind::Unknown ? nullptr : screenOf(place.rectangle);
    const bool isKnown = screen != nullptr;
    if (!screen) screen = pointerScreen();
    const QRect beside = isKnown ? inQtPixels(place.rectangle, *screen) : QRect(QCursor::pos(), QSize(0, 0));
    const QRect room = screen->availableGeometry();
    size = size.boundedTo(room.size());

    const int below = beside.y() + beside.height() + Gap;
    const int above = beside.y() - Gap - size.height();
    const bool fitsBelow = below + size.height() <= room.bottom() + 1;
    const int y = fitsBelow || above < room.top() ? below : above;
    const int x = runsFromRight() ? beside.x() + beside.width() - size.width() : beside.x();
    return {std::clamp(x, room.left(), room.right() + 1 - size.width()),
            std::clamp(y, room.top(), room.bottom() + 1 - size.height()), size.width(), size.height()};
}

QRect cornerGeometry(QSize size) {
    const QRect room = pointerScreen()->availableGeometry();
    size = size.boundedTo(room.size());
    const int x = runsFromRight() ? room.left() + CornerMargin : room.right() + 1 - CornerMargin - size.width();
    return {std::max(x, room.left()), std::min(room.top() + CornerMargin, room.bottom() + 1 - size.height()),
            size.width(), size.height()};
}

Rectangle screenFrame(const QWidget& window) {
    const QScreen& screen = *window.screen();
    const double ratio = screen.devicePixelRatio();
    const QPoint origin = screen.geometry().topLeft();
    const QRect frame = window.frameGeometry();
    return {{origin.x() + (frame.x() - origin.x()) * ratio, origin.y() + (frame.y() - origin.y()) * ratio},
            {frame.width() * ratio, frame.height() * ratio}};
}

}  // namespace plume
