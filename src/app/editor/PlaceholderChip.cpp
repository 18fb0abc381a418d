#include "app/editor/PlaceholderChip.h"

#include <QFontMetricsF>
#include <QGuiApplication>
#include <QPainter>
#include <QPainterPath>
#include <QPalette>
#include <QTextDocument>
#include <utility>

#include "app/editor/ChipWords.h"
#include "app/editor/TextFormats.h"
#include "app/qt/MixedColor.h"
#include "app/qt/Text.h"

namespace plume {

namespace {

QFont chipFont(const QTextDocument& document, const QTextFormat& format) {
    QFont font = format.toCharFormat().font().resolve(document.defaultFont());
    font.setUnderline(false);
    font.setStrikeOut(false);
    return font;
}

// Between the box and its words, and between two boxes.
double paddingOf(const QFontMetricsF& metrics) {
    return metrics.horizontalAdvance(u'n') / 2;
}
double gapOf(const QFontMetricsF& metrics) {
    return metrics.horizontalAdvance(u'n') / 8;
}
double widestOf(const QFontMetricsF& metrics) {
    constexpr int Letters = 48;
    return Letters * metrics.averageCharWidth();
}

struct ChipColors {
    QColor ground;
    QColor edge;
    QColor words;
};

// The layout gives what is selected another ground than its attributes have.
bool isSelected(const QTextFormat& format) {
    if (!format.hasProperty(QTextFormat::BackgroundBrush)) return false;
    return format.background() != charFormatOf(attributesIn(format)).background();
}

ChipColors colorsOf(const QTextFormat& format) {
    const QPalette palette = QGuiApplication::palette();
    if (isSelected(format)) {
        const QColor ground = format.background().color();
        const QColor words = format.foreground().style() == Qt::NoBrush ? palette.color(QPalette::HighlightedText)
                                                                        : format.foreground().color();
        return {ground, words, words};
    }
    constexpr float Tint = 0.16f;
    constexpr float Edge = 0.6f;
    const QColor base = palette.color(QPalette::Base);
    const QColor accent = palette.color(QPalette::Highlight);
    return {mixed(accent, base, Tint), mixed(accent, base, Edge), palette.color(QPalette::Text)};
}

}  // namespace

PlaceholderChip::PlaceholderChip(ContentEnvironment environment) : environment_(std::move(environment)) {
    environment_.report = nullptr;
}

QString PlaceholderChip::wordsOf(const QTextFormat& chip) {
    const QString body = chip.stringProperty(TextProperty::Body);
    const auto found = words_.constFind(body);
    if (found != words_.constEnd()) return *found;
    return *words_.insert(body, chipWords(fromQString(body), environment_));
}

// The box stands on the line's own ground, from its ascent to its descent: lines with chips are as high as others.
QSizeF PlaceholderChip::intrinsicSize(QTextDocument* document, int /*position*/, const QTextFormat& format) {
    const QFontMetricsF metrics(chipFont(*document, format));
    const double words = std::min(metrics.horizontalAdvance(wordsOf(format)), widestOf(metrics));
    return {words + 2 * paddingOf(metrics) + 2 * gapOf(metrics), metrics.ascent()};
}

void PlaceholderChip::drawObject(QPainter* painter, const QRectF& rect, QTextDocument* document, int /*position*/,
                                 const QTextFormat& format) {
    const QFont font = chipFont(*document, format);
    const QFontMetricsF metrics(font);
    const double gap = gapOf(metrics);
    const QRectF box = rect.adjusted(gap, 0.5, -gap, metrics.descent() - 0.5);
    const double radius = box.height() / 4;
    const ChipColors colors = colorsOf(format);
    painter->save();
    painter->setRenderHint(QPainter::Antialiasing);
    painter->setPen(QPen(colors.edge, 1));
    painter->setBrush(colors.ground);
    painter->drawRoundedRect(box, radius, radius);
    painter->setFont(font);
    painter->setPen(colors.words);
    const QString words = metrics.elidedText(wordsOf(format), Qt::ElideRight, widestOf(metrics));
    painter->drawText(QPointF(box.left() + paddingOf(metrics), rect.bottom()), words);
    painter->restore();
}

}  // namespace plume
