#include "app/search/SnippetRowDelegate.h"

#include <QApplication>
#include <QPainter>
#include <QTextLayout>
#include <algorithm>

#include "app/qt/MixedColor.h"

namespace plume {

namespace {

constexpr int Margin = 10;
constexpr int Spacing = 12;
constexpr int Padding = 4;        // above and below the text
constexpr int ContentShare = 45;  // percent of the row that the abbreviation may take
constexpr int GroupShare = 25;

QFont bold(QFont font) {
    font.setBold(true);
    return font;
}

QFont smaller(QFont font) {
    constexpr double Share = 0.88;
    font.setPointSizeF(font.pointSizeF() * Share);
    return font;
}

// Texts of one row, drawn from its beginning on; in right-to-left languages everything is mirrored.
class RowPainter {
  public:
    RowPainter(QPainter& painter, const QStyleOptionViewItem& option)
        : painter_(painter),
          row_(option.rect.adjusted(Margin, 0, -Margin, 0)),
          direction_(option.direction),
          isSelected_(option.state.testFlag(QStyle::State_Selected)),
          palette_(option.palette) {
        left_ = row_.left();
        right_ = row_.right() + 1;
    }

    QColor textColor() const { return palette_.color(isSelected_ ? QPalette::HighlightedText : QPalette::Text); }
    QColor dimColor() const {
        // On the colour of the selection it would be too faint soon.
        if (isSelected_) return mixed(textColor(), palette_.color(QPalette::Highlight), 0.85F);
        return mixed(textColor(), palette_.color(QPalette::Base), 0.62F);
    }
    int room() const { return right_ - left_; }

    void drawAtStart(const MarkedText& text, const QFont& font, const QColor& color, int mostWidth) {
        const int width = std::min(mostWidth, room());
        if (text.text.isEmpty() || width <= 0) return;
        const int used = draw(text, font, color, QRect(left_, row_.top(), width, row_.height()));
        left_ += used + Spacing;
    }
    void drawAtEnd(const QString& text, const QFont& font, const QColor& color, int mostWidth) {
        if (text.isEmpty()) return;
        const QFontMetrics metrics(font);
        const QString shown = metrics.elidedText(text, Qt::ElideRight, std::min(mostWidth, room()));
        // Flush with the texts above and below it, which a cut text alone is not.
        const int width = metrics.horizontalAdvance(shown) + 1;
        draw({shown, {}}, font, color, QRect(right_ - width, row_.top(), width, row_.height()));
        right_ -= width + Spacing;
    }

  private:
    // How wide it came out.
    int draw(const MarkedText& marked, const QFont& font, const QColor& color, const QRect& place) {
        // What is marked is bold, and wider.
        const QFontMetrics metrics(marked.marks.isEmpty() ? font : bold(font));
        const QString shown = metrics.elidedText(marked.text, Qt::ElideRight, place.width());
        QTextLayout layout(shown, font);
        layout.setFormats(formats(marked, shown, color));
        QTextOption leftAligned;
        leftAligned.setAlignment(Qt::AlignLeft | Qt::AlignAbsolute);
        leftAligned.setWrapMode(QTextOption::NoWrap);
        layout.setTextOption(leftAligned);
        layout.beginLayout();
        QTextLine line = layout.createLine();
        line.setLineWidth(place.width());
        layout.endLayout();
        const int width = std::min(place.width(), static_cast<int>(line.naturalTextWidth()) + 1);
        const QRect box(place.left(), place.top(), width, place.height());
        const QRect seen = QStyle::visualRect(direction_, row_, box);
        const double top = seen.top() + (seen.height() - line.height()) / 2;
        painter_.setPen(color);
        layout.draw(&painter_, QPointF(seen.left(), top));
        return width;
    }

    // Bold and underlined: colour alone says nothing to many.
    QList<QTextLayout::FormatRange> formats(const MarkedText& marked, const QString& shown, const QColor& color) const {
        QList<QTextLayout::FormatRange> ranges;
        for (const Range& mark : marked.marks) {
            if (static_cast<qsizetype>(mark.location) >= shown.size()) break;
            QTextLayout::FormatRange range;
            range.start = static_cast<int>(mark.location);
            range.length = static_cast<int>(mark.length);
            range.format.setFontUnderline(true);
            range.format.setFontWeight(QFont::Bold);
            range.format.setForeground(isSelected_ ? color : palette_.color(QPalette::Link));
            ranges.append(range);
        }
        return ranges;
    }

    QPainter& painter_;
    const QRect row_;
    const Qt::LayoutDirection direction_;
    const bool isSelected_;
    const QPalette palette_;
    int left_ = 0;
    int right_ = 0;
};

void paintDivider(QPainter& painter, const QStyleOptionViewItem& option, const QString& text) {
    QStyleOptionViewItem plain = option;
    plain.state.setFlag(QStyle::State_Selected, false);
    RowPainter row(painter, plain);
    const QFont font = smaller(option.font);
    const int width = QFontMetrics(font).horizontalAdvance(text) + Margin + Spacing;
    row.drawAtStart({text, {}}, font, row.dimColor(), option.rect.width());
    const QRect line = QStyle::visualRect(option.direction, option.rect,
                                          option.rect.adjusted(width, option.rect.height() / 2, -Margin, 0));
    painter.setPen(option.palette.color(QPalette::Mid));
    painter.drawLine(line.topLeft(), line.topRight());
}

}  // namespace

void SnippetRowDelegate::paint(QPainter* painter, const QStyleOptionViewItem& option, const QModelIndex& index) const {
    const auto shown = index.data(SnippetRow::Role).value<SnippetRow>();
    painter->save();
    painter->setClipRect(option.rect);
    if (shown.isDivider) {
        paintDivider(*painter, option, shown.label.text);
        painter->restore();
        return;
    }
    if (option.state.testFlag(QStyle::State_Selected)) {
        painter->fillRect(option.rect, option.palette.color(QPalette::Highlight));
    }
    RowPainter row(*painter, option);
    const int width = option.rect.width();
    // Where all of it fits, no text is cut for another.
    const bool fits = fullWidth(option.font, shown) <= width;
    const int mostOfContent = fits ? width : width * ContentShare / 100;
    row.drawAtEnd(shown.shortcut, smaller(option.font), row.dimColor(), width);
    row.drawAtEnd(shown.group, smaller(option.font), row.dimColor(), fits ? width : width * GroupShare / 100);
    row.drawAtStart(shown.abbreviation, bold(option.font), row.textColor(), mostOfContent);
    row.drawAtStart(shown.label, option.font, row.textColor(), mostOfContent);
    row.drawAtStart(shown.content, option.font, row.dimColor(), width);
    painter->restore();
}

QSize SnippetRowDelegate::sizeHint(const QStyleOptionViewItem& option, const QModelIndex& /*index*/) const {
    return {0, QFontMetrics(bold(option.font)).height() + 2 * Padding};
}

int SnippetRowDelegate::fullWidth(const QFont& font, const SnippetRow& row) {
    int width = 2 * Margin;
    const auto add = [&width](const QFont& used, const QString& text) {
        if (!text.isEmpty()) width += QFontMetrics(used).horizontalAdvance(text) + Spacing;
    };
    add(bold(font), row.abbreviation.text);
    add(font, row.label.text);
    add(font, row.content.text);
    add(smaller(font), row.group);
    add(smaller(font), row.shortcut);
    return width;
}

}  // namespace plume
