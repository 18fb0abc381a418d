#include "app/qt/WheelGuard.h"

#include <QEvent>
#include <QWidget>

namespace plume {

namespace {

class WheelGuard final : public QObject {
  public:
    explicit WheelGuard(QWidget& control) : QObject(&control) { control.installEventFilter(this); }

    bool eventFilter(QObject* object, QEvent* event) override {
        if (event->type() != QEvent::Wheel || static_cast<QWidget*>(object)->hasFocus()) return false;
        event->ignore();
        return true;
    }
};

}  // namespace

void ignoreWheelWithoutFocus(QWidget& control) {
    control.setFocusPolicy(Qt::StrongFocus);
    new WheelGuard(control);
}

}  // namespace plume
