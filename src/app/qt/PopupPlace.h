// Between the screen's own pixels, in which the rest of Plume tells of places, and those of Qt's windows; and where a
// popup stands beside the place where the user types.
//
// On the main thread.
#pragma once

#include <QRect>
#include <QSize>

#include "app/CaretPlace.h"

class QWidget;

namespace plume {

// Where a popup of this size goes: below the caret or the field, above it where there is no room below, beside the
// pointer when the place is not known. On the screen of that place, and inside its work area.
QRect popupGeometry(const CaretPlace& place, QSize size);
// In the upper corner of the pointer's screen, at the right, or at the left in languages that run from there.
QRect cornerGeometry(QSize size);
// Where the window stands, in the screen's own pixels.
Rectangle screenFrame(const QWidget& window);

}  // namespace plume
