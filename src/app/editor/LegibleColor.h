// Colours for texts that can be read on whatever ground the desktop has chosen.
//
// Pure functions.
#pragma once

#include <QColor>
#include <QPalette>

namespace plume {

enum class TextHue : unsigned char { Blue, Green, Violet, Red };

// Of this hue, and at least 4.5 times as light or as dark as fields are, where that is possible.
QColor legibleColor(TextHue hue, const QPalette& palette);
// How many times lighter the lighter of the two is, to the eye: 1 to 21.
double contrastOf(const QColor& one, const QColor& other);

}  // namespace plume
