#include "app/editor/TextFormats.h"

#include <QBrush>
#include <QColor>
#include <QGuiApplication>
#include <QPalette>
#include <QScreen>
#include <QTextOption>
#include <algorithm>
#include <cmath>

#include "app/qt/Text.h"

namespace plume {

namespace {

// Beyond these nothing can be read; stored numbers may be any.
constexpr double LargestFont = 400;
constexpr double LargestDistance = 4000;
constexpr double LargestLine = 10;

double within(double value, double least, double most) {
    return std::isfinite(value) ? std::clamp(value, least, most) : least;
}

QColor colorOf(const ColorAttribute& color) {
    const auto part = [](double value) { return static_cast<float>(within(value, 0, 1)); };
    return QColor::fromRgbF(part(color.red), part(color.green), part(color.blue), part(color.alpha));
}

// Black on nothing is how programs write what has no colour; it is to be read on a dark ground, too.
bool isOrdinaryText(const TextAttributes& attributes) {
    return !attributes.backgroundColor && attributes.foregroundColor == ColorAttribute{};
}

void showFont(const FontAttribute& font, QTextCharFormat& format) {
    if (!font.family.empty()) format.setFontFamilies({toQString(font.family)});
    if (font.size > 0) format.setFontPointSize(within(font.size, 1, LargestFont));
    if (font.bold) format.setFontWeight(QFont::Bold);
    if (font.italic) format.setFontItalic(true);
}

void showLink(const TextAttributes& attributes, QTextCharFormat& format) {
    if (!attributes.link) return;
    format.setAnchor(true);
    format.setAnchorHref(toQString(*attributes.link));
    format.setFontUnderline(true);
    format.setForeground(QGuiApplication::palette().link());
}

void showLines(const TextAttributes& attributes, QTextCharFormat& format) {
    if (attributes.underlineStyle != 0) format.setFontUnderline(true);
    if (attributes.strikethroughStyle != 0) format.setFontStrikeOut(true);
    const double raised = attributes.superscript != 0 ? static_cast<double>(attributes.superscript)
                                                      : attributes.baselineOffset.value_or(0);
    if (raised > 0) format.setVerticalAlignment(QTextCharFormat::AlignSuperScript);
    if (raised < 0) format.setVerticalAlignment(QTextCharFormat::AlignSubScript);
}

void showAttributes(const TextAttributes& attributes, QTextCharFormat& format) {
    if (attributes.font) showFont(*attributes.font, format);
    showLink(attributes, format);
    showLines(attributes, format);
    if (attributes.foregroundColor && !isOrdinaryText(attributes)) {
        format.setForeground(colorOf(*attributes.foregroundColor));
    }
    if (attributes.backgroundColor) format.setBackground(colorOf(*attributes.backgroundColor));
    if (attributes.toolTip) format.setToolTip(toQString(*attributes.toolTip));
}

int nextIdentity() {
    static int last = 0;
    return ++last;
}

double dotsOf(double points) {
    constexpr double PointsPerInch = 72;
    const QScreen* const screen = QGuiApplication::primaryScreen();
    return screen != nullptr ? points * screen->logicalDotsPerInchX() / PointsPerInch : points;
}

Qt::Alignment alignmentOf(TextAlignment alignment) {
    switch (alignment) {
        case TextAlignment::Left:
            return Qt::AlignLeft | Qt::AlignAbsolute;
        case TextAlignment::Right:
            return Qt::AlignRight | Qt::AlignAbsolute;
        case TextAlignment::Center:
            return Qt::AlignHCenter;
        case TextAlignment::Justified:
            return Qt::AlignJustify;
        case TextAlignment::Natural:
            break;
    }
    return {};
}

void showIndents(const ParagraphStyle& style, QTextBlockFormat& format) {
    const double head = within(style.headIndent, 0, LargestDistance);
    const double first = within(style.firstLineHeadIndent, 0, LargestDistance);
    if (head > 0) format.setLeftMargin(dotsOf(head));
    if (first != head) format.setTextIndent(dotsOf(first - head));
    if (style.tailIndent < 0) format.setRightMargin(dotsOf(within(-style.tailIndent, 0, LargestDistance)));
    QList<QTextOption::Tab> tabs;
    for (const double stop : style.tabStops) {
        tabs.append({dotsOf(within(stop, 0, LargestDistance) - head), QTextOption::LeftTab});
    }
    if (!tabs.isEmpty()) format.setTabPositions(tabs);
}

// Lists of programs that leave the indents to who shows them.
void showItem(const ParagraphStyle& style, QTextBlockFormat& format) {
    if (style.textLists.empty() || style.headIndent != 0 || !style.tabStops.empty()) return;
    constexpr double Marker = 11;
    constexpr double Text = 36;
    constexpr std::size_t DeepestLevel = 9;
    format.setLeftMargin(dotsOf(Text * static_cast<double>(std::min(style.textLists.size(), DeepestLevel))));
    format.setTextIndent(-dotsOf(Text));
    format.setTabPositions({{dotsOf(Marker - Text), QTextOption::LeftTab}, {0, QTextOption::LeftTab}});
}

void showSpacing(const ParagraphStyle& style, QTextBlockFormat& format) {
    constexpr double Percent = 100;
    const double above = within(style.paragraphSpacingBefore, 0, LargestDistance);
    const double below = within(style.paragraphSpacing, 0, LargestDistance);
    if (above > 0) format.setTopMargin(dotsOf(above));
    if (below > 0) format.setBottomMargin(dotsOf(below));
    if (style.lineHeightMultiple > 0) {
        format.setLineHeight(Percent * within(style.lineHeightMultiple, 0, LargestLine),
                             QTextBlockFormat::ProportionalHeight);
    } else if (style.lineSpacing > 0) {
        format.setLineHeight(dotsOf(within(style.lineSpacing, 0, LargestDistance)),
                             QTextBlockFormat::LineDistanceHeight);
    }
}

}  // namespace

QTextCharFormat charFormatOf(const SharedAttributes& attributes) {
    QTextCharFormat format;
    if (!attributes) return format;
    showAttributes(*attributes, format);
    format.setProperty(TextProperty::Attributes, QVariant::fromValue(attributes));
    format.setProperty(TextProperty::AttributesKey,
                       static_cast<int>(std::hash<SharedAttributes>()(attributes) & 0x7fffffff));
    return format;
}

SharedAttributes attributesIn(const QTextFormat& format) {
    return format.property(TextProperty::Attributes).value<SharedAttributes>();
}

SharedAttributes withStyle(const SharedAttributes& attributes, const std::optional<ParagraphStyle>& style) {
    TextAttributes changed = attributes ? *attributes : TextAttributes();
    changed.paragraphStyle = style;
    return changed == TextAttributes() ? nullptr : std::make_shared<const TextAttributes>(std::move(changed));
}

std::optional<ParagraphStyle> styleIn(const SharedAttributes& attributes) {
    return attributes ? attributes->paragraphStyle : std::nullopt;
}

QTextBlockFormat blockFormatOf(const std::optional<ParagraphStyle>& style) {
    QTextBlockFormat format;
    if (!style) return format;
    if (const Qt::Alignment alignment = alignmentOf(style->alignment)) format.setAlignment(alignment);
    showIndents(*style, format);
    showItem(*style, format);
    showSpacing(*style, format);
    format.setProperty(TextProperty::Style, QVariant::fromValue(std::make_shared<const ParagraphStyle>(*style)));
    return format;
}

SharedStyle styleOf(const QTextBlockFormat& format) {
    return format.property(TextProperty::Style).value<SharedStyle>();
}

QTextCharFormat chipFormatOf(const std::u16string& body, const SharedAttributes& attributes) {
    QTextCharFormat format = charFormatOf(attributes);
    format.setObjectType(InlineObject::Chip);
    format.setProperty(TextProperty::Identity, nextIdentity());
    format.setProperty(TextProperty::Body, toQString(body));
    return format;
}

QTextCharFormat fileFormatOf(const SharedAttributes& attributes) {
    QTextCharFormat format = charFormatOf(attributes);
    format.setObjectType(InlineObject::File);
    format.setProperty(TextProperty::Identity, nextIdentity());
    return format;
}

bool isChip(const QTextFormat& format) {
    return format.objectType() == InlineObject::Chip;
}

std::u16string bodyOf(const QTextFormat& chip) {
    return fromQString(chip.stringProperty(TextProperty::Body));
}

}  // namespace plume
