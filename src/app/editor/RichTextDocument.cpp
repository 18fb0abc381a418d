#include "app/editor/RichTextDocument.h"

#include <QTextBlock>
#include <QTextCursor>
#include <QTextDocument>
#include <optional>
#include <string>
#include <string_view>
#include <utility>

#include "app/editor/TextFormats.h"
#include "app/qt/Text.h"
#include "content/PlaceholderBody.h"
#include "content/SnippetEditContent.h"

namespace plume {

namespace {

constexpr char16_t ObjectUnit = u'\uFFFC';
constexpr std::u16string_view LineFeed = u"\n";

// What parts Qt's paragraphs: U+FDD0 and U+FDD1 are its own marks of frames.
bool isBreak(char16_t unit) {
    return unit == u'\n' || unit == u'\r' || unit == u'\u2029' || unit == 0xFDD0 || unit == 0xFDD1;
}

// Of the break that begins the text: a carriage return and a line feed are one.
std::size_t breakLength(std::u16string_view text) {
    return text.starts_with(u"\r\n") ? 2 : 1;
}

// ---- Into a document ----

class ContentInserter {
  public:
    ContentInserter(QTextCursor& cursor, const AttributedString& content, std::size_t end)
        : cursor_(cursor), content_(content), end_(end) {}

    void insertFrom(std::size_t start);

  private:
    void insertStretch(std::u16string_view text, const SharedAttributes& attributes);
    void insertBreak(std::u16string_view text, const SharedAttributes& attributes, std::size_t next);
    void insertObject(const SharedAttributes& attributes);
    // Of a paragraph's text, in its style or not.
    QTextCharFormat inParagraph(QTextCharFormat format, const SharedAttributes& attributes) const;
    void beginParagraph(std::size_t start);

    QTextCursor& cursor_;
    const AttributedString& content_;
    std::size_t end_;
    std::optional<ParagraphStyle> style_;
};

void ContentInserter::beginParagraph(std::size_t start) {
    style_ = styleIn(content_.attributesAt(start));
}

QTextCharFormat ContentInserter::inParagraph(QTextCharFormat format, const SharedAttributes& attributes) const {
    if (styleIn(attributes) != style_) format.setProperty(TextProperty::OwnStyle, true);
    return format;
}

void ContentInserter::insertStretch(std::u16string_view text, const SharedAttributes& attributes) {
    if (!text.empty()) cursor_.insertText(toQString(text), inParagraph(charFormatOf(attributes), attributes));
}

void ContentInserter::insertBreak(std::u16string_view text, const SharedAttributes& attributes, std::size_t next) {
    QTextCharFormat format = inParagraph(charFormatOf(attributes), attributes);
    if (text != LineFeed) format.setProperty(TextProperty::LineBreak, toQString(text));
    beginParagraph(next);
    cursor_.insertBlock(blockFormatOf(style_), format);
}

void ContentInserter::insertObject(const SharedAttributes& attributes) {
    const TextAttachment* const attachment = attributes ? attributes->attachment.get() : nullptr;
    if (attachment == nullptr || attachment->cellText.empty()) {
        cursor_.insertText(QString(QChar(ObjectUnit)), inParagraph(fileFormatOf(attributes), attributes));
        return;
    }
    TextAttributes around = *attributes;
    around.attachment = nullptr;
    const SharedAttributes own =
        around == TextAttributes() ? nullptr : std::make_shared<const TextAttributes>(std::move(around));
    cursor_.insertText(QString(QChar(ObjectUnit)), inParagraph(chipFormatOf(attachment->cellText, own), attributes));
}

void ContentInserter::insertFrom(std::size_t start) {
    beginParagraph(start);
    const std::u16string_view text = std::u16string_view(content_.string()).substr(0, end_);
    std::size_t runStart = 0;
    for (const AttributedString::Run& run : content_.runs()) {
        const std::size_t runEnd = std::min(runStart + run.length, end_);
        std::size_t i = std::max(runStart, start);
        runStart += run.length;
        std::size_t stretch = i;
        while (i < runEnd) {
            if (!isBreak(text[i]) && text[i] != ObjectUnit) {
                ++i;
                continue;
            }
            insertStretch(text.substr(stretch, i - stretch), run.attributes);
            if (text[i] == ObjectUnit) {
                insertObject(run.attributes);
                stretch = ++i;
                continue;
            }
            const std::size_t length = breakLength(text.substr(i, runEnd - i));
            insertBreak(text.substr(i, length), run.attributes, i + length);
            stretch = i += length;
        }
        if (stretch < runEnd) insertStretch(text.substr(stretch, runEnd - stretch), run.attributes);
    }
}

// ---- Out of a document ----

enum class ChipsAs { Placeholders, Attachments };

class ContentReader {
  public:
    ContentReader(int from, int to, ChipsAs chips) : from_(from), to_(to), chips_(chips) {}

    AttributedString read(const QTextDocument& document);

  private:
    void readBlock(const QTextBlock& block);
    void readFragment(const QTextFragment& fragment);
    void readBreak(const QTextBlock& next);
    void readChip(const QTextCharFormat& format);
    // Of a character in the present block.
    SharedAttributes attributesOf(const QTextCharFormat& format);

    int from_;
    int to_;
    ChipsAs chips_;
    AttributedString result_;
    std::optional<ParagraphStyle> style_;
    bool isStyleEdited_ = false;
    // What the paragraph's style made of attributes last.
    SharedAttributes lastFound_;
    SharedAttributes lastMade_;
};

SharedAttributes ContentReader::attributesOf(const QTextCharFormat& format) {
    SharedAttributes found = attributesIn(format);
    if (styleIn(found) == style_) return found;
    if (format.boolProperty(TextProperty::OwnStyle) && !isStyleEdited_) return found;
    if (!lastMade_ || found != lastFound_) {
        lastMade_ = withStyle(found, style_);
        lastFound_ = std::move(found);
    }
    return lastMade_;
}

void ContentReader::readChip(const QTextCharFormat& format) {
    const std::u16string body = bodyOf(format);
    const SharedAttributes around = attributesOf(format);
    if (chips_ == ChipsAs::Placeholders) {
        result_.append(OpeningMarker + body + ClosingMarker, around);
        return;
    }
    TextAttributes attributes = around ? *around : TextAttributes();
    attributes.attachment = std::make_shared<const TextAttachment>(TextAttachment{{}, {}, body});
    result_.append(std::u16string(1, ObjectUnit), std::make_shared<const TextAttributes>(std::move(attributes)));
}

void ContentReader::readFragment(const QTextFragment& fragment) {
    const int start = std::max(from_, fragment.position());
    const int end = std::min(to_, fragment.position() + fragment.length());
    if (start >= end) return;
    const QTextCharFormat format = fragment.charFormat();
    if (isChip(format)) {
        for (int i = start; i < end; ++i) readChip(format);
        return;
    }
    SharedAttributes attributes = attributesOf(format);
    // What is typed beside a file takes over the format, and not the file.
    const bool isBesideFile = format.hasProperty(TextProperty::Identity) && format.objectType() != InlineObject::File;
    if (isBesideFile && attributes && attributes->attachment) {
        TextAttributes own = *attributes;
        own.attachment = nullptr;
        attributes = std::make_shared<const TextAttributes>(std::move(own));
    }
    const QString text = fragment.text();
    result_.append(fromQString(text.mid(start - fragment.position(), end - start)), attributes);
}

void ContentReader::readBreak(const QTextBlock& next) {
    const QTextCharFormat format = next.charFormat();
    const QString written = format.stringProperty(TextProperty::LineBreak);
    SharedAttributes attributes = attributesOf(format);
    if (attributes && attributes->attachment && format.hasProperty(TextProperty::Identity)) {
        TextAttributes own = *attributes;
        own.attachment = nullptr;
        attributes = std::make_shared<const TextAttributes>(std::move(own));
    }
    result_.append(written.isEmpty() ? std::u16string(LineFeed) : fromQString(written), attributes);
}

void ContentReader::readBlock(const QTextBlock& block) {
    const SharedStyle style = styleOf(block.blockFormat());
    style_ = style ? std::optional(*style) : std::nullopt;
    isStyleEdited_ = block.blockFormat().boolProperty(TextProperty::StyleEdited);
    lastFound_ = lastMade_ = nullptr;
    for (auto each = block.begin(); !each.atEnd(); ++each) readFragment(each.fragment());
    const int end = block.position() + block.length() - 1;
    if (const QTextBlock next = block.next(); next.isValid() && end >= from_ && end < to_) readBreak(next);
}

AttributedString ContentReader::read(const QTextDocument& document) {
    QTextBlock block = document.findBlock(from_);
    for (; block.isValid() && block.position() < to_; block = block.next()) readBlock(block);
    return std::move(result_);
}

}  // namespace

void setDocument(QTextDocument& document, const AttributedString& content) {
    document.clear();
    QTextCursor cursor(&document);
    insertContent(cursor, content, 0, content.length());
}

AttributedString contentOf(const QTextDocument& document) {
    return contentBetween(document, 0, document.characterCount() - 1);
}

AttributedString contentBetween(const QTextDocument& document, int from, int to) {
    return ContentReader(from, to, ChipsAs::Placeholders).read(document);
}

AttributedString editContentBetween(const QTextDocument& document, int from, int to) {
    return ContentReader(from, to, ChipsAs::Attachments).read(document);
}

void insertContent(QTextCursor& cursor, const AttributedString& content, std::size_t from, std::size_t to) {
    cursor.beginEditBlock();
    const bool beginsParagraph = from == 0 || isBreak(content.string()[from - 1]);
    if (beginsParagraph) cursor.setBlockFormat(blockFormatOf(styleIn(content.attributesAt(from))));
    ContentInserter(cursor, content, to).insertFrom(from);
    cursor.endEditBlock();
}

void insertForeignContent(QTextCursor& cursor, const AttributedString& content) {
    cursor.beginEditBlock();
    cursor.removeSelectedText();
    const QTextBlockFormat around = cursor.blockFormat();
    const bool standsAlone = cursor.block().length() == 1;
    const bool hasTextBefore = !cursor.atBlockStart();
    const bool hasTextBehind = !cursor.atBlockEnd();
    const int start = cursor.position();
    insertContent(cursor, content, 0, content.length());
    const auto restore = [&around](QTextCursor block) { block.setBlockFormat(around); };
    const QTextBlock first = cursor.document()->findBlock(start);
    QTextCursor atStart(first);
    if (hasTextBefore || (!standsAlone && first == cursor.block())) restore(atStart);
    if (hasTextBehind) restore(cursor);
    cursor.endEditBlock();
}

int positionsFor(const AttributedString& content, std::size_t units) {
    std::size_t positions = 0;
    std::size_t runEnd = 0;
    auto run = content.runs().begin();
    for (std::size_t i = 0; i < units; ++positions) {
        while (runEnd <= i && run != content.runs().end()) runEnd += (run++)->length;
        const std::u16string_view rest = std::u16string_view(content.string()).substr(i, runEnd - i);
        i += isBreak(rest.front()) ? breakLength(rest) : 1;
    }
    return static_cast<int>(positions);
}

}  // namespace plume
