#include "Foundation/text/HTMLImport.h"

#include <libxml/HTMLparser.h>
#include <libxml/parserInternals.h>

#include <algorithm>
#include <array>
#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "Foundation/Base64.h"
#include "Foundation/Strings.h"
#include "Foundation/text/HTMLFormat.h"
#include "Foundation/text/HTMLTextBuilder.h"

namespace plume {

namespace {

constexpr std::size_t LongestHTML = std::size_t{64} << 20;
constexpr std::size_t MostElements = 200'000;
constexpr std::size_t DeepestElement = 1000;
constexpr std::size_t DeepestList = 16;
constexpr std::size_t LongestLink = 8192;
// Many elements within a long link would take far more memory than the page does.
constexpr std::size_t MostLinkUnits = std::size_t{16} << 20;

template <std::size_t count>
bool isOneOf(const std::array<std::string_view, count>& names, std::string_view name) {
    return std::find(names.begin(), names.end(), name) != names.end();
}

bool isBlock(std::string_view tag) {
    constexpr std::array<std::string_view, 38> Blocks = {
        "p",       "div",     "h1",      "h2",      "h3",       "h4",    "h5",         "h6",    "ul",         "ol",
        "dl",      "dt",      "dd",      "pre",     "table",    "tr",    "caption",    "thead", "blockquote", "center",
        "address", "article", "aside",   "footer",  "header",   "main",  "nav",        "tbody", "section",    "figure",
        "form",    "hr",      "details", "summary", "fieldset", "tfoot", "figcaption", "body"};
    return isOneOf(Blocks, tag);
}

// The file in "data:image/png;base64,…"; null for all other addresses.
std::shared_ptr<const TextAttachment> imageAt(std::string_view address, std::u16string name) {
    constexpr std::string_view Start = "data:image/";
    const std::size_t comma = address.find(',');
    if (!address.starts_with(Start) || comma == std::string_view::npos) return nullptr;
    const std::string_view kind = address.substr(Start.size(), comma - Start.size());
    if (!kind.ends_with(";base64")) return nullptr;
    auto bytes = bytesFromBase64(address.substr(comma + 1));
    if (!bytes || bytes->empty()) return nullptr;
    if (name.empty()) name = u"image." + fromUtf8(kind.substr(0, kind.find_first_of(";+")));
    return std::make_shared<const TextAttachment>(TextAttachment{std::move(name), std::move(*bytes), {}});
}

// libxml2 calls this for all that it reads; it never builds a tree.
class Reader {
  public:
    using Attributes = std::vector<std::pair<std::string_view, std::string_view>>;

    explicit Reader(htmlParserCtxt* parser) : parser_(parser) {}

    void start(std::string_view tag, const Attributes& attributes) {
        if (stopped_) return;
        if (++elements_ > MostElements || open_.size() >= DeepestElement) return stop();
        open_.push_back({std::string(tag), open_.empty() ? HTMLFormat() : open_.back().format, nullptr});
        HTMLFormat& format = open_.back().format;
        applyElement(tag, format);
        for (const auto& [name, value] : attributes) {
            if (name == "style") applyStyle(value, format);
            applyAttribute(tag, name, value, format);
            if (name == "hidden") format.hidden = true;
        }
        if (!format.hidden) startVisible(tag, attributes);
    }

    void end(std::string_view tag) {
        if (stopped_) return;
        const auto found = std::find_if(open_.rbegin(), open_.rend(), [&](const Open& o) { return o.tag == tag; });
        if (found == open_.rend()) return;
        const auto keep = static_cast<std::size_t>(open_.rend() - found - 1);
        while (open_.size() > keep) endLast();
    }

    void text(std::string_view utf8) {
        if (stopped_ || (!open_.empty() && open_.back().format.hidden)) return;
        builder_.addText(fromUtf8(utf8), look(), !open_.empty() && open_.back().format.preformatted);
    }

    AttributedString take() { return builder_.take(); }

  private:
    struct Open {
        std::string tag;
        HTMLFormat format;
        SharedAttributes look;  // null until it is asked for
    };
    struct List {
        bool isOrdered = false;
        std::int64_t next = 1;
    };

    static std::string_view valueOf(const Attributes& attributes, std::string_view name) {
        for (const auto& [own, value] : attributes) {
            if (own == name) return value;
        }
        return {};
    }

    void startVisible(std::string_view tag, const Attributes& attributes) {
        if (isBlock(tag)) builder_.endBlock();
        if (tag == "br") builder_.addLineBreak(look());
        if (tag == "pre") builder_.startPreformatted();
        if (tag == "hr") builder_.addText(u"\u2014\u2014\u2014", look(), false);
        if (tag == "td" || tag == "th") builder_.startCell(look());
        if (tag == "a") startLink(valueOf(attributes, "href"));
        if (tag == "img") addImage(attributes);
        if (tag == "input") addInput(attributes);
        if (tag == "ul" || tag == "ol") startList(tag == "ol", valueOf(attributes, "start"));
        if (tag == "li") startItem();
    }

    void endLast() {
        const std::string tag = std::move(open_.back().tag);
        const bool wasHidden = open_.back().format.hidden;
        open_.pop_back();
        if (wasHidden) return;
        if (tag == "li") builder_.endItem();
        if (isBlock(tag)) builder_.endBlock();
        if ((tag == "ul" || tag == "ol") && !lists_.empty()) lists_.pop_back();
    }

    void startLink(std::string_view address) {
        std::u16string link = fromUtf8(address);
        if (link.size() > LongestLink) link.clear();
        open_.back().format.link = std::move(link);
    }

    void addImage(const Attributes& attributes) {
        const std::u16string name = fromUtf8(valueOf(attributes, "alt"));
        if (auto image = imageAt(valueOf(attributes, "src"), name))
            return builder_.addAttachment(std::move(image), look());
        builder_.addText(name, look(), false);
    }

    void addInput(const Attributes& attributes) {
        if (valueOf(attributes, "type") != "checkbox") return;
        const bool isChecked = std::any_of(attributes.begin(), attributes.end(),
                                           [](const auto& attribute) { return attribute.first == "checked"; });
        builder_.addText(isChecked ? u"\u2611 " : u"\u2610 ", look(), false);
    }

    void startList(bool isOrdered, std::string_view start) {
        const std::int64_t first = start.empty() ? 1 : integerValue(fromUtf8(start));
        lists_.push_back({isOrdered, std::clamp<std::int64_t>(first, 0, 1'000'000)});
        std::vector<TextList>& levels = open_.back().format.paragraph.textLists;
        if (levels.size() >= DeepestList) return;
        levels.push_back(isOrdered ? TextList{u"{decimal}.", lists_.back().next} : TextList{u"{disc}", 1});
    }

    void startItem() {
        if (lists_.empty()) startList(false, {});
        List& list = lists_.back();
        const std::string marker = list.isOrdered ? std::to_string(list.next++) + "." : "\u2022";
        builder_.startItem(u"\t" + fromUtf8(marker) + u"\t", look());
    }

    const SharedAttributes& look() {
        if (open_.empty()) return plain_;
        Open& open = open_.back();
        if (open.look) return open.look;
        linkUnits_ += open.format.link.size();
        if (linkUnits_ > MostLinkUnits) open.format.link.clear();
        open.look = attributesOf(open.format);
        return open.look;
    }

    void stop() {
        stopped_ = true;
        xmlStopParser(parser_);
    }

    htmlParserCtxt* parser_;
    HTMLTextBuilder builder_;
    std::vector<Open> open_;
    std::vector<List> lists_;
    SharedAttributes plain_;
    std::size_t elements_ = 0;
    std::size_t linkUnits_ = 0;
    bool stopped_ = false;
};

std::string_view viewOf(const xmlChar* text) {
    return text ? std::string_view(reinterpret_cast<const char*>(text)) : std::string_view();
}

void startElement(void* reader, const xmlChar* name, const xmlChar** attributes) {
    Reader::Attributes list;
    for (; attributes && *attributes; attributes += 2) list.emplace_back(viewOf(attributes[0]), viewOf(attributes[1]));
    static_cast<Reader*>(reader)->start(viewOf(name), list);
}

void endElement(void* reader, const xmlChar* name) {
    static_cast<Reader*>(reader)->end(viewOf(name));
}

void addCharacters(void* reader, const xmlChar* text, int length) {
    static_cast<Reader*>(reader)->text({reinterpret_cast<const char*>(text), static_cast<std::size_t>(length)});
}

struct FreeParser {
    void operator()(htmlParserCtxt* parser) const { htmlFreeParserCtxt(parser); }
};

}  // namespace

AttributedString attributedStringFromHTML(std::string_view utf8) {
    // The parser stops at a NUL and guesses at bytes that are no UTF-8.
    std::string html = toUtf8(fromUtf8(utf8.substr(0, LongestHTML)));
    std::replace(html.begin(), html.end(), '\0', ' ');
    if (html.empty()) return {};
    const std::unique_ptr<htmlParserCtxt, FreeParser> parser(
        htmlCreateMemoryParserCtxt(html.data(), static_cast<int>(html.size())));
    if (!parser) return {};
    htmlCtxtUseOptions(parser.get(), HTML_PARSE_RECOVER | HTML_PARSE_NOERROR | HTML_PARSE_NOWARNING | HTML_PARSE_NONET |
                                         HTML_PARSE_NOIMPLIED | HTML_PARSE_IGNORE_ENC | HTML_PARSE_COMPACT);
    xmlSwitchEncoding(parser.get(), XML_CHAR_ENCODING_UTF8);
    Reader reader(parser.get());
    htmlSAXHandler handler = {};
    handler.startElement = startElement;
    handler.endElement = endElement;
    handler.characters = addCharacters;
    handler.ignorableWhitespace = addCharacters;
    *parser->sax = handler;
    parser->userData = &reader;
    htmlParseDocument(parser.get());
    return reader.take();
}

}  // namespace plume
