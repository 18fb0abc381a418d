#include "app/editor/LookEditing.h"

#include <QHash>
#include <QTextBlock>
#include <QTextCursor>
#include <QTextDocument>
#include <algorithm>
#include <utility>
#include <vector>

#include "app/editor/TextFormats.h"
#include "app/qt/Text.h"

namespace plume {

namespace {

struct FormatRange {
    int position;
    int length;
    QTextCharFormat format;
};

void addRange(std::vector<FormatRange>& ranges, int from, int to, const QTextCharFormat& format) {
    if (from < to) ranges.push_back({from, to - from, format});
}

// The formats between two positions, those of breaks between paragraphs among them.
std::vector<FormatRange> formatsBetween(const QTextDocument& document, int from, int to) {
    std::vector<FormatRange> ranges;
    for (QTextBlock block = document.findBlock(from); block.isValid() && block.position() < to; block = block.next()) {
        for (auto each = block.begin(); !each.atEnd(); ++each) {
            const QTextFragment fragment = each.fragment();
            addRange(ranges, std::max(from, fragment.position()), std::min(to, fragment.position() + fragment.length()),
                     fragment.charFormat());
        }
        const int end = block.position() + block.length() - 1;
        if (block.next().isValid() && end >= from)
            addRange(ranges, end, std::min(end + 1, to), block.next().charFormat());
    }
    return ranges;
}

// What a format holds besides its attributes.
QTextCharFormat asBefore(QTextCharFormat format, const QTextCharFormat& before) {
    for (const int property : {static_cast<int>(QTextFormat::ObjectType), TextProperty::Identity, TextProperty::Body,
                               TextProperty::LineBreak, TextProperty::OwnStyle}) {
        if (before.hasProperty(property)) format.setProperty(property, before.property(property));
    }
    return format;
}

SharedAttributes changed(const SharedAttributes& attributes, const AttributesChange& change) {
    TextAttributes made = attributes ? *attributes : TextAttributes();
    change(made);
    return made == TextAttributes() ? nullptr : std::make_shared<const TextAttributes>(std::move(made));
}

std::vector<QTextBlock> blocksOf(const QTextCursor& cursor) {
    std::vector<QTextBlock> blocks;
    QTextBlock block = cursor.document()->findBlock(cursor.selectionStart());
    // A selection that ends before a paragraph does not touch it.
    const int end = std::max(cursor.selectionStart() + 1, cursor.selectionEnd());
    for (; block.isValid() && block.position() < end; block = block.next()) blocks.push_back(block);
    return blocks;
}

void setStyle(const QTextBlock& block, const ParagraphStyle& style) {
    QTextBlockFormat format = blockFormatOf(style == ParagraphStyle() ? std::nullopt : std::optional(style));
    format.setProperty(TextProperty::StyleEdited, true);
    QTextCursor(block).setBlockFormat(format);
}

ParagraphStyle styleOfBlock(const QTextBlock& block) {
    const SharedStyle style = styleOf(block.blockFormat());
    return style ? *style : ParagraphStyle();
}

// ---- Markers ----

constexpr qsizetype LongestMarker = 20;

// How much of the item's text is its marker with the tabs; 0 when it has none.
int markerLength(const QTextBlock& block) {
    const QString text = block.text();
    if (!text.startsWith(u'\t')) return 0;
    const qsizetype end = text.indexOf(u'\t', 1);
    return end < 0 || end > LongestMarker ? 0 : static_cast<int>(end) + 1;
}

bool isItem(const QTextBlock& block) {
    return block.isValid() && !styleOfBlock(block).textLists.empty() && markerLength(block) > 0;
}

bool isItemOf(const QTextBlock& block, const std::u16string& markerFormat) {
    return isItem(block) && styleOfBlock(block).textLists.back().markerFormat == markerFormat;
}

QString markerText(const TextList& list, std::int64_t number) {
    constexpr std::u16string_view Decimal = u"{decimal}";
    const std::size_t place = list.markerFormat.find(Decimal);
    if (place == std::u16string::npos) return QStringLiteral("\t\u2022\t");
    return u'\t' + toQString(list.markerFormat).replace(toQString(Decimal), QString::number(number)) + u'\t';
}

void replaceMarker(const QTextBlock& block, const QString& marker) {
    const int length = markerLength(block);
    if (block.text().left(length) == marker) return;
    QTextCursor cursor(block);
    const SharedAttributes look = typingAttributes(cursor.charFormat());
    cursor.setPosition(block.position() + length, QTextCursor::KeepAnchor);
    cursor.insertText(marker, charFormatOf(look));
}

bool isNumbered(const TextList& list) {
    return list.markerFormat.find(u"{decimal}") != std::u16string::npos;
}

// Numbers the items around and behind the block that are in one list with it.
void renumber(QTextBlock block) {
    if (!isItem(block)) return;
    const std::vector<TextList> lists = styleOfBlock(block).textLists;
    if (!isNumbered(lists.back())) return;
    const auto isFellow = [&lists](const QTextBlock& other) {
        return isItem(other) && styleOfBlock(other).textLists == lists;
    };
    while (isFellow(block.previous())) block = block.previous();
    for (std::int64_t number = lists.back().startingItemNumber; isFellow(block); block = block.next()) {
        replaceMarker(block, markerText(lists.back(), number++));
    }
}

void leaveList(const QTextBlock& block) {
    replaceMarker(block, {});
    setStyle(block, [&] {
        ParagraphStyle style = styleOfBlock(block);
        style.textLists.clear();
        style.tabStops.clear();
        style.headIndent = style.firstLineHeadIndent = 0;
        return style;
    }());
}

void enterList(const QTextBlock& block, const std::u16string& markerFormat) {
    constexpr double MarkerStop = 11;
    constexpr double TextStop = 36;
    ParagraphStyle style = styleOfBlock(block);
    if (!isItem(block)) {
        style.textLists.emplace_back();
        style.firstLineHeadIndent = 0;
        style.headIndent = TextStop;
        style.tabStops = {MarkerStop, TextStop};
    }
    style.textLists.back() = {markerFormat, 1};
    const bool hadMarker = isItem(block);
    setStyle(block, style);
    if (hadMarker) return replaceMarker(block, markerText(style.textLists.back(), 1));
    QTextCursor cursor(block);
    const SharedAttributes look = typingAttributes(cursor.charFormat());
    cursor.insertText(markerText(style.textLists.back(), 1), charFormatOf(look));
}

// One edit of the document.
class Edit {
  public:
    explicit Edit(const QTextCursor& cursor) : cursor_(cursor) { cursor_.beginEditBlock(); }
    ~Edit() { cursor_.endEditBlock(); }
    Edit(const Edit&) = delete;
    Edit& operator=(const Edit&) = delete;

  private:
    QTextCursor cursor_;
};

}  // namespace

SharedAttributes typingAttributes(const QTextCharFormat& format) {
    SharedAttributes attributes = attributesIn(format);
    if (!attributes || !attributes->attachment || !format.hasProperty(TextProperty::Identity)) return attributes;
    return changed(attributes, [](TextAttributes& each) { each.attachment = nullptr; });
}

void changeAttributes(const QTextCursor& cursor, const AttributesChange& change) {
    const Edit edit(cursor);
    QHash<const TextAttributes*, SharedAttributes> made;
    for (const FormatRange& range :
         formatsBetween(*cursor.document(), cursor.selectionStart(), cursor.selectionEnd())) {
        const SharedAttributes before = attributesIn(range.format);
        auto found = made.find(before.get());
        if (found == made.end()) found = made.insert(before.get(), changed(before, change));
        QTextCursor piece(cursor.document());
        piece.setPosition(range.position);
        piece.setPosition(range.position + range.length, QTextCursor::KeepAnchor);
        piece.setCharFormat(asBefore(charFormatOf(*found), range.format));
    }
}

void changeStyle(const QTextCursor& cursor, const StyleChange& change) {
    const Edit edit(cursor);
    for (const QTextBlock& block : blocksOf(cursor)) {
        ParagraphStyle style = styleOfBlock(block);
        change(style);
        setStyle(block, style);
    }
}

ParagraphStyle styleAt(const QTextCursor& cursor) {
    return styleOfBlock(cursor.block());
}

void toggleList(const QTextCursor& cursor, const std::u16string& markerFormat) {
    const Edit edit(cursor);
    const std::vector<QTextBlock> blocks = blocksOf(cursor);
    const bool isOff = std::all_of(blocks.begin(), blocks.end(),
                                   [&](const QTextBlock& block) { return isItemOf(block, markerFormat); });
    for (const QTextBlock& block : blocks) isOff ? leaveList(block) : enterList(block, markerFormat);
    if (!isOff) renumber(blocks.front());
    renumber(blocks.back().next());
}

bool continueList(QTextCursor& cursor) {
    const QTextBlock block = cursor.document()->findBlock(cursor.selectionStart());
    const int marker = isItem(block) ? markerLength(block) : 0;
    if (marker == 0 || cursor.selectionStart() < block.position() + marker) return false;
    const Edit edit(cursor);
    if (!cursor.hasSelection() && block.length() - 1 == marker) {
        leaveList(block);
        renumber(block.next());
        return true;
    }
    cursor.removeSelectedText();
    const SharedAttributes look = typingAttributes(cursor.charFormat());
    cursor.insertBlock(block.blockFormat(), charFormatOf(look));
    cursor.insertText(markerText(styleOfBlock(block).textLists.back(), 1), charFormatOf(look));
    renumber(block);
    return true;
}

bool endListAtItemStart(const QTextCursor& cursor) {
    const QTextBlock block = cursor.block();
    if (cursor.hasSelection() || !isItem(block) || cursor.positionInBlock() != markerLength(block)) return false;
    const Edit edit(cursor);
    leaveList(block);
    renumber(block.next());
    return true;
}

}  // namespace plume
