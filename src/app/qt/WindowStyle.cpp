#include "app/qt/WindowStyle.h"

#include <QStyleOption>

namespace plume {

namespace {

constexpr int MiddleLightness = 128;

}  // namespace

WindowStyle::WindowStyle() : QProxyStyle(QStringLiteral("Fusion")) {}

void WindowStyle::drawPrimitive(PrimitiveElement element, const QStyleOption* option, QPainter* painter,
                                const QWidget* widget) const {
    const auto* button = qstyleoption_cast<const QStyleOptionButton*>(option);
    const bool isIndicator = element == PE_IndicatorCheckBox || element == PE_IndicatorRadioButton;
    const bool isOnDark = option->palette.color(QPalette::Window).lightness() < MiddleLightness;
    if (!button || !isIndicator || !isOnDark) return QProxyStyle::drawPrimitive(element, option, painter, widget);
    // Their outlines are a shade darker than the window, which is hardly seen on a dark one: they take the text's
    // colour for the window's.
    QStyleOptionButton outlined(*button);
    outlined.palette.setColor(QPalette::Window, option->palette.color(QPalette::WindowText));
    QProxyStyle::drawPrimitive(element, &outlined, painter, widget);
}

int WindowStyle::styleHint(StyleHint hint, const QStyleOption* option, const QWidget* widget,
                           QStyleHintReturn* data) const {
    // More rows than the screen is high would be put into columns, and these beyond its edge.
    return hint == SH_Menu_Scrollable ? 1 : QProxyStyle::styleHint(hint, option, widget, data);
}

}  // namespace plume
