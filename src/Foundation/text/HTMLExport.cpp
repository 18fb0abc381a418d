#include "Foundation/text/HTMLExport.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>
#include <string_view>
#include <utility>

#include "Foundation/Strings.h"

namespace plume {

namespace {

constexpr char16_t LineSeparator = 0x2028;
constexpr char16_t NoBreakSpace = 0xa0;
constexpr char16_t ParagraphSeparator = 0x2029;
constexpr char16_t ObjectReplacementCharacter = 0xfffc;

std::string base64(std::string_view bytes) {
    constexpr std::string_view Digits = "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789+/";
    std::string text;
    text.reserve((bytes.size() + 2) / 3 * 4);
    for (std::size_t i = 0; i < bytes.size(); i += 3) {
        std::uint32_t group = 0;
        for (std::size_t k = 0; k < 3; ++k) {
            group = group << 8 | (i + k < bytes.size() ? static_cast<std::uint8_t>(bytes[i + k]) : 0U);
        }
        for (std::size_t k = 0; k < 4; ++k) {
            text += i + k <= bytes.size() ? Digits[group >> (18 - 6 * k) & 63] : '=';
        }
    }
    return text;
}

// The media type of an image by its first bytes; empty for what browsers do not show.
std::string_view imageTypeOf(std::string_view bytes) {
    if (bytes.starts_with("\x89PNG")) return "image/png";
    if (bytes.starts_with("\xff\xd8\xff")) return "image/jpeg";
    if (bytes.starts_with("GIF8")) return "image/gif";
    if (bytes.starts_with("BM")) return "image/bmp";
    if (bytes.starts_with("RIFF") && bytes.substr(8, 4) == "WEBP") return "image/webp";
    return {};
}

std::string number(double value) {
    constexpr int Digits = 4;
    std::array<char, 32> text{};
    auto* const end =
        std::to_chars(text.data(), text.data() + text.size(), value, std::chars_format::general, Digits).ptr;
    return {text.data(), end};
}

std::string colorOf(const ColorAttribute& color) {
    constexpr std::string_view Digits = "0123456789abcdef";
    std::string text = "#";
    for (const double component : {color.red, color.green, color.blue}) {
        const auto value = static_cast<std::size_t>(std::lround(std::clamp(component, 0.0, 1.0) * 255));
        text += Digits[value / 16];
        text += Digits[value % 16];
    }
    return text;
}

// The style of a run that no element stands for.
std::string styleOf(const TextAttributes& look) {
    std::string style;
    if (look.font) {
        std::u16string family = look.font->family;
        std::erase_if(family, [](char16_t c) { return c == u'\'' || c == u'\\' || c == u';'; });
        if (!family.empty()) style += "font-family:'" + escapedForHtml(family) + "';";
        if (look.font->size > 0) style += "font-size:" + number(look.font->size) + "pt;";
    }
    if (look.foregroundColor) style += "color:" + colorOf(*look.foregroundColor) + ";";
    if (look.backgroundColor) style += "background-color:" + colorOf(*look.backgroundColor) + ";";
    return style;
}

std::string styleOf(const ParagraphStyle& paragraph) {
    constexpr std::array<const char*, 5> Alignments = {"left", "right", "center", "justify", ""};
    const auto alignment = static_cast<std::size_t>(paragraph.alignment);
    std::string style;
    if (alignment < Alignments.size() && *Alignments[alignment]) {
        style += std::string("text-align:") + Alignments[alignment] + ";";
    }
    if (!paragraph.textLists.empty()) return style;  // a list has indents of its own
    if (paragraph.headIndent > 0) style += "margin-left:" + number(paragraph.headIndent) + "pt;";
    const double first = paragraph.firstLineHeadIndent - paragraph.headIndent;
    if (first != 0) style += "text-indent:" + number(first) + "pt;";
    return style;
}

bool isLineBreak(char16_t c) {
    return c == LineSeparator || c == u'\v' || c == u'\f';
}

// HTML folds a space into one before it, whatever elements are between, and drops one at the start of a line or at the
// end of what is pasted.
std::u16string withKeptSpaces(std::u16string text, bool endsAll) {
    char16_t before = LineSeparator;
    for (char16_t& c : text) {
        if (c == u' ' && (before == u' ' || isLineBreak(before))) c = NoBreakSpace;
        before = c;
    }
    if (endsAll && text.ends_with(u' ')) text.back() = NoBreakSpace;
    return text;
}

bool isOrdered(const TextList& list) {
    return list.markerFormat.find(u"{decimal}") != std::u16string::npos ||
           list.markerFormat.find(u"alpha}") != std::u16string::npos ||
           list.markerFormat.find(u"roman}") != std::u16string::npos;
}

// Writes elements, but for the excluded ones.
class Markup {
  public:
    explicit Markup(const std::vector<std::string>& excluded) : excluded_(excluded) {}

    bool writes(std::string_view tag) const {
        return std::find(excluded_.begin(), excluded_.end(), tag) == excluded_.end();
    }
    void start(std::string_view tag, std::string_view attributes = {}) {
        if (!writes(tag)) return;
        html.append("<").append(tag);
        if (!attributes.empty()) html.append(" ").append(attributes);
        html += ">";
    }
    void end(std::string_view tag) {
        if (writes(tag)) html.append("</").append(tag).append(">");
    }

    std::string html;

  private:
    const std::vector<std::string>& excluded_;
};

class Exporter {
  public:
    Exporter(const AttributedString& text, const std::vector<std::string>& excluded) : text_(text), markup_(excluded) {}

    std::string run() {
        if (markup_.writes("xml")) markup_.html += R"(<?xml version="1.0" encoding="UTF-8"?>)";
        if (markup_.writes("doctype")) markup_.html += "<!DOCTYPE html>";
        markup_.start("html");
        markup_.start("head");
        if (markup_.writes("head")) markup_.html += "<meta charset=\"utf-8\">";
        markup_.end("head");
        markup_.start("body");
        writeParagraphs();
        markup_.end("body");
        markup_.end("html");
        return std::move(markup_.html);
    }

  private:
    void writeParagraphs() {
        const std::u16string& all = text_.string();
        std::size_t start = 0;
        bool isFirst = true;
        while (start < all.size()) {
            std::size_t end = start;
            while (end < all.size() && !endsParagraph(all[end])) ++end;
            writeParagraph({start, end - start}, isFirst);
            isFirst = false;
            const bool isPair = all.substr(end, 2) == u"\r\n";
            if (end < all.size() && end + (isPair ? 2 : 1) == all.size() && !markup_.writes("p")) {
                markup_.start("br");  // the text ends with a line break, and so does its HTML
            }
            start = end + (isPair ? 2 : 1);
        }
        closeLists(0);
    }

    static bool endsParagraph(char16_t c) { return c == u'\n' || c == u'\r' || c == ParagraphSeparator; }

    void writeParagraph(Range range, bool isFirst) {
        const SharedAttributes look = range.length > 0 ? text_.attributesAt(range.location) : nullptr;
        const ParagraphStyle style = look && look->paragraphStyle ? *look->paragraphStyle : ParagraphStyle{};
        const std::string css = styleOf(style);
        const std::string attributes = css.empty() ? "" : "style=\"" + css + "\"";
        const bool wasInList = !lists_.empty();
        openLists(style.textLists);
        if (!style.textLists.empty()) {
            markup_.start("li", attributes);
            writeRuns(withoutMarker(range));
            markup_.end("li");
            return;
        }
        if (!markup_.writes("p") && !isFirst && !wasInList) markup_.start("br");
        markup_.start("p", attributes);
        writeRuns(range);
        if (range.length == 0 && markup_.writes("p")) markup_.start("br");  // else the empty line has no height
        markup_.end("p");
    }

    // List paragraphs carry their marker between two tabs; the list element makes its own.
    Range withoutMarker(Range range) const {
        constexpr std::size_t LongestMarker = 12;
        const std::u16string& all = text_.string();
        if (range.length == 0 || all[range.location] != u'\t') return range;
        const std::size_t second = all.find(u'\t', range.location + 1);
        if (second >= range.end() || second - range.location > LongestMarker) return range;
        return {second + 1, range.end() - second - 1};
    }

    void openLists(const std::vector<TextList>& wanted) {
        std::size_t common = 0;
        while (common < lists_.size() && common < wanted.size() && lists_[common] == isOrdered(wanted[common]))
            ++common;
        closeLists(common);
        for (std::size_t i = common; i < wanted.size(); ++i) {
            lists_.push_back(isOrdered(wanted[i]));
            markup_.start(lists_.back() ? "ol" : "ul");
        }
    }

    void closeLists(std::size_t count) {
        while (lists_.size() > count) {
            markup_.end(lists_.back() ? "ol" : "ul");
            lists_.pop_back();
        }
    }

    void writeRuns(Range range) {
        const AttributedString piece = text_.substring(range);
        const std::u16string text = withKeptSpaces(piece.string(), range.end() == text_.string().size());
        std::size_t position = 0;
        for (const auto& run : piece.runs()) {
            writeRun(std::u16string_view(text).substr(position, run.length), run.attributes);
            position += run.length;
        }
    }

    void writeRun(std::u16string_view text, const SharedAttributes& shared) {
        static const TextAttributes plain;
        const TextAttributes& look = shared ? *shared : plain;
        std::vector<std::string_view> open;
        const auto start = [&](std::string_view tag, std::string_view attributes = {}) {
            markup_.start(tag, attributes);
            open.push_back(tag);
        };
        if (look.link) start("a", "href=\"" + escapedForHtml(*look.link) + "\"");
        if (const std::string style = styleOf(look); !style.empty()) start("span", "style=\"" + style + "\"");
        if (look.font && look.font->bold) start("b");
        if (look.font && look.font->italic) start("i");
        if (look.underlineStyle != 0 && !look.link) start("u");
        if (look.strikethroughStyle != 0) start("s");
        if (look.superscript > 0) start("sup");
        if (look.superscript < 0) start("sub");
        writeText(text, look);
        while (!open.empty()) {
            markup_.end(open.back());
            open.pop_back();
        }
    }

    void writeText(std::u16string_view text, const TextAttributes& look) {
        for (std::size_t i = 0; i < text.size(); ++i) {
            const char16_t c = text[i];
            if (c == ObjectReplacementCharacter && look.attachment) {
                writeImage(*look.attachment);
            } else if (isLineBreak(c)) {
                markup_.start("br");
            } else if (c == u'\t') {
                markup_.html += "<span style=\"white-space:pre\">\t</span>";
            } else if (c == NoBreakSpace) {
                markup_.html += "&nbsp;";
            } else if (c >= u' ' || c == 0) {
                const bool isPair = (c & 0xfc00) == 0xd800 && i + 1 < text.size() && (text[i + 1] & 0xfc00) == 0xdc00;
                markup_.html += escapedForHtml(text.substr(i, isPair ? 2 : 1));
                i += isPair ? 1 : 0;
            }
        }
    }

    void writeImage(const TextAttachment& attachment) {
        const std::string_view type = imageTypeOf(attachment.contents);
        if (type.empty()) {
            markup_.html += escapedForHtml(attachment.fileName.empty() ? attachment.cellText : attachment.fileName);
            return;
        }
        markup_.start("img", "src=\"data:" + std::string(type) + ";base64," + base64(attachment.contents) +
                                 "\" alt=\"" + escapedForHtml(attachment.fileName) + "\"");
    }

    const AttributedString& text_;
    Markup markup_;
    std::vector<bool> lists_;  // the open ones, outermost first: whether each is ordered
};

}  // namespace

std::string escapedForHtml(std::u16string_view text) {
    constexpr std::string_view ReplacementCharacter = "\xef\xbf\xbd";
    std::string html;
    for (const char c : toUtf8(text)) {
        switch (c) {
            case '&':
                html += "&amp;";
                break;
            case '<':
                html += "&lt;";
                break;
            case '>':
                html += "&gt;";
                break;
            case '"':
                html += "&quot;";
                break;
            case '\r':
                html += "&#13;";
                break;
            case '\0':
                html += ReplacementCharacter;
                break;
            default:
                html += c;
        }
    }
    return html;
}

std::vector<std::string> defaultExcludedTags() {
    return {"doctype", "html", "head", "body", "xml"};
}

std::string htmlFromAttributedString(const AttributedString& text, const std::vector<std::string>& excludedTags) {
    return Exporter(text, excludedTags).run();
}

}  // namespace plume
