#include "app/status/StatusIcons.h"

#include <QLinearGradient>
#include <QPainter>
#include <QPainterPath>
#include <functional>

#include "app/status/Feather.h"

namespace plume {

namespace {

const QString Enabled = QStringLiteral("AutoText");
const QString Disabled = QStringLiteral("AutoText-Disabled");
const QString Caution = QStringLiteral("AutoTextCaution");
const QString CautionDark = QStringLiteral("AutoTextCautionDark");

struct Colours {
    QColor feather;
    QColor faint;  // of what is switched off
    QColor strike;
    QColor caution;
    QColor lost;
};

// In colour the feather is of a middle brightness, to be seen on light and dark panels alike.
Colours coloursOf(bool isDark, IconStyle style) {
    if (style == IconStyle::Symbolic) {
        const QColor ink = isDark ? QColor(0xf2, 0xf2, 0xf2) : QColor(0x2e, 0x34, 0x36);
        QColor faint = ink;
        faint.setAlphaF(0.5F);
        return {ink, faint, ink, ink, ink};
    }
    return {QColor(0x3d, 0x8e, 0xe8), QColor(0x9a, 0x9f, 0xa6, 0xb4), QColor(0x8a, 0x8f, 0x96),
            isDark ? QColor(0xfb, 0xbf, 0x24) : QColor(0xd9, 0x7a, 0x06),
            isDark ? QColor(0xff, 0x6b, 0x5e) : QColor(0xd6, 0x3a, 0x2f)};
}

QPixmap drawn(int size, int ratio, const std::function<void(QPainter&)>& draw) {
    QPixmap pixmap(size * ratio, size * ratio);
    pixmap.fill(Qt::transparent);
    QPainter painter(&pixmap);
    painter.setRenderHint(QPainter::Antialiasing);
    painter.scale(pixmap.width() / feather::Side, pixmap.height() / feather::Side);
    draw(painter);
    painter.end();
    pixmap.setDevicePixelRatio(ratio);
    return pixmap;
}

void drawStatus(QPainter& painter, const QString& image, bool keyboardIsLost, const Colours& colours) {
    if (image == Disabled) {
        feather::drawFeather(painter, colours.faint);
        feather::drawStrike(painter, colours.strike);
        return;
    }
    feather::drawFeather(painter, colours.feather);
    if (keyboardIsLost) {
        feather::drawCross(painter, colours.lost);
    } else if (image != Enabled) {
        feather::drawPadlock(painter, colours.caution);
    }
}

QLinearGradient down(const QColor& top, const QColor& bottom) {
    QLinearGradient gradient(0, 0, 0, feather::Side);
    gradient.setColorAt(0, top);
    gradient.setColorAt(1, bottom);
    return gradient;
}

}  // namespace

QString statusImageName(const Status& status, bool isDark) {
    if (!status.isEnabled) return Disabled;
    if (!status.secureInput) return Enabled;
    return isDark ? CautionDark : Caution;
}

QIcon statusIcon(const Status& status, bool isDark, IconStyle style) {
    const QString image = statusImageName(status, isDark);
    const Colours colours = coloursOf(isDark, style);
    QIcon icon;
    for (const int size : {16, 22, 24, 32, 48, 64}) {
        for (const int ratio : {1, 2}) {
            icon.addPixmap(drawn(
                size, ratio, [&](QPainter& painter) { drawStatus(painter, image, status.keyboardIsLost, colours); }));
        }
    }
    return icon;
}

QIcon applicationIcon() {
    // The white feather is drawn by itself: its gaps let the ground through.
    const auto draw = [](QPainter& painter, int size) {
        QPainterPath ground;
        ground.addRoundedRect(QRectF(2, 2, 60, 60), 14, 14);
        painter.fillPath(ground, down(QColor(0x4f, 0x9d, 0xf0), QColor(0x2a, 0x55, 0xc4)));
        const QPixmap quill = drawn(
            size, 1, [](QPainter& inner) { feather::drawFeather(inner, down(Qt::white, QColor(0xdf, 0xea, 0xfb))); });
        painter.drawPixmap(QRectF(11, 11, 42, 42), quill, QRectF(quill.rect()));
    };
    // Only as they are: the larger ones serve denser screens, and what lasts as long as the program is kept small.
    QIcon icon;
    for (const int size : {16, 22, 24, 32, 48, 64, 128, 256}) {
        icon.addPixmap(drawn(size, 1, [&](QPainter& painter) {
            painter.setRenderHint(QPainter::SmoothPixmapTransform);
            draw(painter, size);
        }));
    }
    return icon;
}

}  // namespace plume
