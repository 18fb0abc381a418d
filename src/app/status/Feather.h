// The strokes that Plume's icons are made of.
//
// Everything is drawn into a square of 64 units, to which the painter is scaled already. What lies on the feather cuts
// a gap into it first, so that shapes stay apart in one colour and on any background.
#pragma once

#include <QBrush>

class QPainter;

namespace plume::feather {

inline constexpr double Side = 64;

void drawFeather(QPainter& painter, const QBrush& brush);
// From the upper left to the lower right, across the feather.
void drawStrike(QPainter& painter, const QBrush& brush);
// Both in the lower right corner.
void drawPadlock(QPainter& painter, const QBrush& brush);
void drawCross(QPainter& painter, const QBrush& brush);

}  // namespace plume::feather
