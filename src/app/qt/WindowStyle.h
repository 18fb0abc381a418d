// The style of all windows and menus: Fusion, which is the same everywhere and takes every palette, without what does
// not suit Plume in it.
//
// On the main thread; the application owns it.
#pragma once

#include <QProxyStyle>

namespace plume {

class WindowStyle final : public QProxyStyle {
    Q_OBJECT
  public:
    WindowStyle();

    void drawPrimitive(PrimitiveElement element, const QStyleOption* option, QPainter* painter,
                       const QWidget* widget) const override;
    int styleHint(StyleHint hint, const QStyleOption* option, const QWidget* widget,
                  QStyleHintReturn* data) const override;
};

}  // namespace plume
