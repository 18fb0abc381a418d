#include <algorithm>
#include <cmath>
#include <map>
#include <string>
#include <string_view>
#include <utility>

#include "Foundation/Strings.h"
#include "Foundation/text/RTFDocument.h"
#include "Foundation/text/RTFFormats.h"
#include "Foundation/text/RTFOutput.h"
#include "Foundation/text/RTFTables.h"

namespace plume {

namespace {

constexpr char16_t AttachmentCharacter = u'\uFFFC';
// What readers without files show in its place.
constexpr unsigned char AttachmentFallback = 0xAC;
constexpr std::size_t LongestListMarker = 32;
constexpr std::int64_t ThickUnderline = 2;
constexpr std::int64_t DoubleLine = 9;

int rounded(double value, int unitsPerPoint, int limit) {
    const double units = std::round(value * unitsPerPoint);
    if (std::isnan(units)) return 0;
    return static_cast<int>(std::clamp(units, -static_cast<double>(limit), static_cast<double>(limit)));
}

int twips(double points) {
    return rounded(points, RTFTwipsPerPoint, RTFMaximumTwips);
}

int lineStyle(std::int64_t style) {
    if (style == 0 || style == ThickUnderline || style == DoubleLine) return static_cast<int>(style);
    return 1;
}

std::size_t endOfParagraph(std::u16string_view text, std::size_t start) {
    const std::size_t newline = text.find(u'\n', start);
    return newline == std::u16string_view::npos ? text.size() : newline + 1;
}

// Where the marker that a list puts before a paragraph ends: "\t", the marker, "\t". `start` when there is none.
std::size_t endOfListMarker(std::u16string_view text, std::size_t start) {
    if (text[start] != u'\t') return start;
    const std::size_t end = text.substr(0, start + LongestListMarker).find_first_of(u"\t\n\uFFFC", start + 1);
    return end != std::u16string_view::npos && text[end] == u'\t' ? end + 1 : start;
}

// Quotes and backslashes as an instruction of a field holds them, in quotes.
std::u16string quotedForField(const std::u16string& text) {
    std::u16string quoted = u"\"";
    for (const char16_t unit : text) {
        if (unit == u'"' || unit == u'\\') quoted.push_back(u'\\');
        quoted.push_back(unit);
    }
    return quoted + u"\"";
}

class RTFWriter {
  public:
    RTFWriter(const AttributedString& text, RTFAttachments attachments) : source_(text), attachments_(attachments) {}

    RTFDocument write() {
        writeBody();
        RTFOutput document;
        document.openGroup();
        document.control("rtf", 1);
        document.control("ansi");
        document.control("ansicpg", 1252);
        document.control("uc", 0);
        tables_.write(document);
        document.newline();
        document.append(body_);
        document.closeGroup();
        return {document.bytes(), std::move(files_)};
    }

  private:
    void writeBody();
    void beginParagraph(const TextAttributes* attributes);
    void writeRun(std::u16string_view text, const TextAttributes* attributes);
    void writeText(std::u16string_view text, const TextAttributes* attributes);
    void writeLink(std::u16string_view text, const TextAttributes& attributes);
    void writeAttachment(const TextAttachment& attachment);
    std::u16string fileNameFor(const TextAttachment& attachment);

    RTFCharacterFormat formatOf(const TextAttributes* attributes);
    void changeFormat(const RTFCharacterFormat& format);
    void changeFont(const RTFCharacterFormat& format);
    void changeLines(const RTFCharacterFormat& format);
    void changeColors(const RTFCharacterFormat& format);
    RTFParagraphFormat formatOf(const ParagraphStyle& style);
    void writeParagraphFormat(const RTFParagraphFormat& format);
    void writeAlignment(TextAlignment alignment);

    const AttributedString& source_;
    RTFAttachments attachments_;
    RTFTableWriter tables_;
    RTFOutput body_;
    RTFCharacterFormat character_;  // what holds at the end of the body so far
    RTFParagraphFormat paragraph_;
    RTFFiles files_;
    std::map<const TextAttachment*, std::u16string> fileNames_;
    std::map<std::u16string, int> lastNumbers_;  // by name
};

// ---- Text ----

void RTFWriter::writeBody() {
    const std::u16string_view text = source_.string();
    std::size_t location = 0;
    std::size_t paragraphEnd = 0;
    std::size_t markerEnd = 0;
    RTFCharacterFormat formatBeforeMarker;
    for (const AttributedString::Run& run : source_.runs()) {
        const std::size_t runEnd = location + run.length;
        while (location < runEnd) {
            if (location == paragraphEnd) {
                paragraphEnd = endOfParagraph(text, location);
                beginParagraph(run.attributes.get());
                markerEnd = paragraph_.list != 0 ? endOfListMarker(text, location) : location;
                if (markerEnd > location) {
                    formatBeforeMarker = character_;
                    body_.openGroup();
                    body_.control("listtext");
                }
            }
            const bool inMarker = location < markerEnd;
            const std::size_t end = std::min(runEnd, inMarker ? markerEnd : paragraphEnd);
            writeRun(text.substr(location, end - location), run.attributes.get());
            location = end;
            if (inMarker && location == markerEnd) {
                body_.closeGroup();
                character_ = formatBeforeMarker;
            }
        }
    }
    // LibreOffice puts raised text that the document ends in into a paragraph of its own.
    if (character_.superscript != 0) body_.control("nosupersub");
}

void RTFWriter::beginParagraph(const TextAttributes* attributes) {
    const RTFParagraphFormat format =
        attributes && attributes->paragraphStyle ? formatOf(*attributes->paragraphStyle) : RTFParagraphFormat{};
    if (format == paragraph_) return;
    writeParagraphFormat(format);
    paragraph_ = format;
}

void RTFWriter::writeRun(std::u16string_view text, const TextAttributes* attributes) {
    if (attributes && attributes->link && !attributes->link->empty()) {
        writeLink(text, *attributes);
    } else {
        changeFormat(formatOf(attributes));
        writeText(text, attributes);
    }
}

void RTFWriter::writeText(std::u16string_view text, const TextAttributes* attributes) {
    if (!attributes || !attributes->attachment) return body_.text(text);
    for (const char16_t& unit : text) {
        if (unit == AttachmentCharacter) {
            writeAttachment(*attributes->attachment);
        } else {
            body_.text({&unit, 1});
        }
    }
}

void RTFWriter::writeLink(std::u16string_view text, const TextAttributes& attributes) {
    const RTFCharacterFormat formatBefore = character_;
    std::u16string instruction = u"HYPERLINK " + quotedForField(*attributes.link);
    if (attributes.toolTip && !attributes.toolTip->empty()) {
        instruction += u" \\o " + quotedForField(*attributes.toolTip);
    }
    body_.openGroup();
    body_.control("field");
    body_.openGroup();
    body_.ignorableControl("fldinst");
    body_.openGroup();
    body_.text(instruction);
    body_.closeGroup();
    body_.closeGroup();
    body_.openGroup();
    body_.control("fldrslt");
    changeFormat(formatOf(&attributes));
    writeText(text, &attributes);
    body_.closeGroup();
    body_.closeGroup();
    character_ = formatBefore;
}

void RTFWriter::writeAttachment(const TextAttachment& attachment) {
    const bool isFile = !attachment.fileName.empty() || !attachment.contents.empty();
    if (attachments_ == RTFAttachments::Leave || !isFile) return;
    const std::u16string name = fileNameFor(attachment);
    body_.openGroup();
    body_.openGroup();
    body_.control("NeXTGraphic");
    body_.text(name);
    body_.text(u" ");
    body_.closeGroup();
    body_.byte(AttachmentFallback);
    body_.closeGroup();
}

std::u16string RTFWriter::fileNameFor(const TextAttachment& attachment) {
    const auto known = fileNames_.find(&attachment);
    if (known != fileNames_.end()) return known->second;
    // Names are kept as UTF-8, so they must survive the way through it.
    std::u16string plain = fromUtf8(toUtf8(attachment.fileName));
    std::erase_if(plain, [](char16_t unit) { return unit < u' ' || unit == u'/'; });
    plain = trimmed(plain);
    if (plain.empty()) plain = u"Attachment";
    const bool isReserved = plain == u"TXT.rtf" || plain == u"." || plain == u"..";
    std::u16string name = plain;
    while ((isReserved && name == plain) || files_.contains(name)) {
        name = fromUtf8(std::to_string(++lastNumbers_[plain])) + std::u16string(RTFFileNumberMark) + plain;
    }
    files_.emplace(name, attachment.contents);
    fileNames_.emplace(&attachment, name);
    return name;
}

// ---- Character formats ----

RTFCharacterFormat RTFWriter::formatOf(const TextAttributes* attributes) {
    RTFCharacterFormat format;
    if (!attributes) return format;
    if (const auto& font = attributes->font) {
        format.hasFont = true;
        format.font = tables_.fontNumber(font->family);
        if (font->size != 0) {
            format.halfPoints = std::max(rounded(font->size, RTFHalfPointsPerPoint, RTFMaximumHalfPoints), 1);
        }
        format.bold = font->bold;
        format.italic = font->italic;
    }
    if (attributes->foregroundColor) format.foreground = tables_.colorIndex(*attributes->foregroundColor);
    if (attributes->backgroundColor) format.background = tables_.colorIndex(*attributes->backgroundColor);
    format.underline = lineStyle(attributes->underlineStyle);
    format.strikethrough = lineStyle(attributes->strikethroughStyle) == DoubleLine
                               ? static_cast<int>(DoubleLine)
                               : attributes->strikethroughStyle != 0;
    format.superscript = attributes->superscript > 0 ? 1 : attributes->superscript < 0 ? -1 : 0;
    format.raisedHalfPoints =
        rounded(attributes->baselineOffset.value_or(0), RTFHalfPointsPerPoint, RTFMaximumHalfPoints);
    return format;
}

void RTFWriter::changeFormat(const RTFCharacterFormat& format) {
    if (format == character_) return;
    // There is no word that takes a font away.
    if (character_.hasFont && (!format.hasFont || (format.font < 0 && character_.font >= 0))) {
        body_.control("plain");
        character_ = {};
    }
    changeFont(format);
    changeLines(format);
    changeColors(format);
    character_ = format;
}

void RTFWriter::changeFont(const RTFCharacterFormat& format) {
    if (format.font != character_.font && format.font >= 0) body_.control("f", format.font);
    if (format.halfPoints != character_.halfPoints || (format.hasFont && !character_.hasFont)) {
        body_.control("fs", format.halfPoints);
    }
    if (format.bold != character_.bold) body_.control(format.bold ? "b" : "b0");
    if (format.italic != character_.italic) body_.control(format.italic ? "i" : "i0");
    if (format.superscript != character_.superscript) {
        body_.control(format.superscript > 0 ? "super" : format.superscript < 0 ? "sub" : "nosupersub");
    }
    if (format.raisedHalfPoints != character_.raisedHalfPoints) {
        const bool lowered = format.raisedHalfPoints < 0;
        body_.control(lowered ? "dn" : "up", std::abs(format.raisedHalfPoints));
    }
}

void RTFWriter::changeLines(const RTFCharacterFormat& format) {
    if (format.underline != character_.underline) {
        body_.control(format.underline == DoubleLine       ? "uldb"
                      : format.underline == ThickUnderline ? "ulth"
                      : format.underline != 0              ? "ul"
                                                           : "ulnone");
    }
    if (format.strikethrough == character_.strikethrough) return;
    if (character_.strikethrough == 1) body_.control("strike", 0);
    if (character_.strikethrough == DoubleLine) body_.control("striked", 0);
    if (format.strikethrough == 1) body_.control("strike");
    if (format.strikethrough == DoubleLine) body_.control("striked", 1);
}

void RTFWriter::changeColors(const RTFCharacterFormat& format) {
    if (format.foreground != character_.foreground) body_.control("cf", format.foreground);
    if (format.background == character_.background) return;
    // Readers differ in which of these they know.
    body_.control("chshdng", 0);
    body_.control("chcbpat", format.background);
    body_.control("cb", format.background);
}

// ---- Paragraph formats ----

RTFParagraphFormat RTFWriter::formatOf(const ParagraphStyle& style) {
    RTFParagraphFormat format;
    format.alignment = style.alignment;
    format.leftIndent = twips(style.headIndent);
    format.firstLineIndent =
        std::clamp(twips(style.firstLineHeadIndent) - format.leftIndent, -RTFMaximumTwips, RTFMaximumTwips);
    // A distance from the leading margin would need to know how wide the page is.
    format.rightIndent = std::max(twips(-style.tailIndent), 0);
    format.spaceBefore = twips(style.paragraphSpacingBefore);
    format.spaceAfter = twips(style.paragraphSpacing);
    format.leading = twips(style.lineSpacing);
    format.lineHeight = rounded(style.lineHeightMultiple, RTFUnitsPerLine, RTFMaximumTwips);
    format.isLineMultiple = format.lineHeight != 0;
    format.list = tables_.listNumber(style.textLists);
    if (format.list != 0) {
        format.listLevel = std::min(static_cast<int>(style.textLists.size()) - 1, RTFDeepestListLevel);
    }
    if (!style.tabStops.empty()) {
        std::vector<int> tabStops;
        for (const double location : style.tabStops) {
            if (tabStops.size() < RTFMaximumTabStops) tabStops.push_back(twips(location));
        }
        format.tabStops = std::make_shared<const std::vector<int>>(std::move(tabStops));
    }
    return format;
}

void RTFWriter::writeParagraphFormat(const RTFParagraphFormat& format) {
    const auto distance = [&](std::string_view word, int value) {
        if (value != 0) body_.control(word, value);
    };
    body_.control("pard");
    if (format.tabStops) {
        for (const int location : *format.tabStops) body_.control("tx", location);
    }
    distance("li", format.leftIndent);
    distance("fi", format.firstLineIndent);
    distance("ri", format.rightIndent);
    distance("sb", format.spaceBefore);
    distance("sa", format.spaceAfter);
    distance("slleading", format.leading);
    if (format.isLineMultiple) {
        body_.control("sl", format.lineHeight);
        body_.control("slmult", 1);
    }
    if (format.list != 0) {
        body_.control("ls", format.list);
        body_.control("ilvl", format.listLevel);
    }
    writeAlignment(format.alignment);
}

void RTFWriter::writeAlignment(TextAlignment alignment) {
    switch (alignment) {
        case TextAlignment::Left:
            body_.control("ql");
            break;
        case TextAlignment::Right:
            body_.control("qr");
            break;
        case TextAlignment::Center:
            body_.control("qc");
            break;
        case TextAlignment::Justified:
            body_.control("qj");
            break;
        case TextAlignment::Natural:
            break;
    }
}

}  // namespace

RTFDocument rtfDocumentFromAttributedString(const AttributedString& text, RTFAttachments attachments) {
    return RTFWriter(text, attachments).write();
}

}  // namespace plume
