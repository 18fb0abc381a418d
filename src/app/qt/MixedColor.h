// A colour between two others.
#pragma once

#include <QColor>

namespace plume {

// `share` of it, from 0 to 1, is `a`.
inline QColor mixed(const QColor& a, const QColor& b, float share) {
    const auto mix = [share](float x, float y) { return x * share + y * (1 - share); };
    return QColor::fromRgbF(mix(a.redF(), b.redF()), mix(a.greenF(), b.greenF()), mix(a.blueF(), b.blueF()));
}

}  // namespace plume
