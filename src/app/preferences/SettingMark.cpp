#include "app/preferences/SettingMark.h"

#include <QPainter>

namespace plume {

namespace {

constexpr int Moment = 1800;  // milliseconds
constexpr int Distance = 4;
constexpr qreal PenWidth = 2;
constexpr qreal Corner = 4;

}  // namespace

void SettingMark::show(QWidget& control, QWidget& page) {
    for (auto* former : page.findChildren<SettingMark*>(Qt::FindDirectChildrenOnly)) delete former;
    auto* mark = new SettingMark(page);
    const QRect place(control.mapTo(&page, QPoint()), control.size());
    mark->setGeometry(place.adjusted(-Distance, -Distance, Distance, Distance));
    mark->QWidget::show();
    mark->raise();
}

SettingMark::SettingMark(QWidget& page) : QWidget(&page) {
    setAttribute(Qt::WA_TransparentForMouseEvents);
    setFocusPolicy(Qt::NoFocus);
    connect(&end_, &QTimer::timeout, this, &QObject::deleteLater);
    end_.setSingleShot(true);
    end_.start(Moment);
}

void SettingMark::paintEvent(QPaintEvent* /*event*/) {
    QPainter painter(this);
    painter.setRenderHint(QPainter::Antialiasing);
    painter.setPen(QPen(palette().color(QPalette::Highlight), PenWidth));
    painter.drawRoundedRect(QRectF(rect()).adjusted(PenWidth, PenWidth, -PenWidth, -PenWidth), Corner, Corner);
}

}  // namespace plume
