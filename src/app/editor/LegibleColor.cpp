#include "app/editor/LegibleColor.h"

#include <algorithm>
#include <cmath>

namespace plume {

namespace {

constexpr double WantedContrast = 4.5;
constexpr float ColourSaturation = 0.65F;
constexpr int LightnessSteps = 20;

float hueOf(TextHue hue) {
    constexpr float Circle = 360;  // degrees
    switch (hue) {
        case TextHue::Blue:
            return 212 / Circle;
        case TextHue::Green:
            return 130 / Circle;
        case TextHue::Violet:
            return 285 / Circle;
        case TextHue::Red:
            return 4 / Circle;
    }
    return 0;
}

// The light that a screen gives for a value of a colour, as sRGB has it.
double lightOf(float value) {
    return value <= 0.04045F ? value / 12.92 : std::pow((value + 0.055) / 1.055, 2.4);
}

double luminanceOf(const QColor& color) {
    return 0.2126 * lightOf(color.redF()) + 0.7152 * lightOf(color.greenF()) + 0.0722 * lightOf(color.blueF());
}

}  // namespace

double contrastOf(const QColor& one, const QColor& other) {
    constexpr double StrayLight = 0.05;
    const auto [darker, lighter] = std::minmax({luminanceOf(one), luminanceOf(other)});
    return (lighter + StrayLight) / (darker + StrayLight);
}

QColor legibleColor(TextHue hue, const QPalette& palette) {
    const QColor ground = palette.color(QPalette::Base);
    const bool isDark = contrastOf(ground, Qt::white) > contrastOf(ground, Qt::black);
    QColor color;
    for (int step = LightnessSteps / 2; step <= LightnessSteps; ++step) {
        const float towardsText = static_cast<float>(step) / LightnessSteps;
        color = QColor::fromHslF(hueOf(hue), ColourSaturation, isDark ? towardsText : 1 - towardsText);
        if (contrastOf(color, ground) >= WantedContrast) break;
    }
    return color;
}

}  // namespace plume
