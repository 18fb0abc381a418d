#include "import/AutomatonTyperXMLParser.h"

#include <expat.h>

#include <algorithm>
#include <type_traits>
#include <utility>

#include "Foundation/Base64.h"
#include "Foundation/Strings.h"
#include "Foundation/archive/KeyedArchive.h"

namespace plume {

namespace {

using Text = std::u16string;

constexpr const char16_t* Token = u"automaton.token";
constexpr const char16_t* TokenBeginning = u"automaton.token.beginning";
constexpr const char16_t* TokenEnd = u"automaton.token.end";

std::string_view attributeNamed(std::string_view wanted, const char* const* attributes) {
    for (; *attributes; attributes += 2) {
        if (*attributes == wanted) return attributes[1];
    }
    return {};
}

// What stands for this run of the text in the content.
Text textOf(const ArchivedRun& run, std::u16string_view text) {
    const auto token = run.others.find(Token);
    const bool ends = run.others.contains(TokenEnd) && !run.others.contains(TokenBeginning);
    const auto* value = token != run.others.end() && ends ? token->second.as<Text>() : nullptr;
    if (!value) return Text(text);
    std::u16string_view inner = *value;
    if (inner.starts_with(u"${") && inner.ends_with(u"}")) inner = inner.substr(2, inner.size() - 3);
    return AutomatonTyperXMLParser::convertAutomatonToken(inner);
}

void setContent(Snippet& snippet, const ArchivedRichText& rich) {
    const auto isBare = [](const ArchivedRun& run) { return !run.attributes && run.others.empty(); };
    if (std::all_of(rich.runs.begin(), rich.runs.end(), isBare)) {
        snippet.setPlainTextContent(convertAutomatonExpansion(rich.text));
        return;
    }
    AttributedString content;
    std::size_t at = 0;
    for (const ArchivedRun& run : rich.runs) {
        content.append(textOf(run, std::u16string_view(rich.text).substr(at, run.length)), run.attributes);
        at += run.length;
    }
    snippet.setContentType(ContentType::RichText);
    snippet.setRichTextContent(std::move(content));
}

void setContent(Snippet& snippet, const ArchivedImage& image) {
    auto attributes = std::make_shared<TextAttributes>();
    attributes->attachment = std::make_shared<const TextAttachment>(TextAttachment{u"image.tiff", image.bytes, {}});
    snippet.setContentType(ContentType::RichText);
    snippet.setRichTextContent(AttributedString(u"\uFFFC", std::move(attributes)));
}

}  // namespace

// What expat calls.
struct AutomatonEvents {
    static AutomatonTyperXMLParser& parser(void* data) { return *static_cast<AutomatonTyperXMLParser*>(data); }
    static void start(void* data, const XML_Char* name, const XML_Char** attributes) {
        parser(data).startElement(name, attributes);
    }
    static void end(void* data, const XML_Char* name) { parser(data).endElement(name); }
    static void characters(void* data, const XML_Char* text, int length) {
        parser(data).characters({text, static_cast<std::size_t>(length)});
    }
};

Result<void> AutomatonTyperXMLParser::parse(std::string_view bytes) {
    constexpr std::size_t PieceLength = std::size_t{1} << 20;
    const std::unique_ptr<std::remove_pointer_t<XML_Parser>, void (*)(XML_Parser)> parser(XML_ParserCreate(nullptr),
                                                                                          XML_ParserFree);
    XML_SetUserData(parser.get(), this);
    XML_SetElementHandler(parser.get(), AutomatonEvents::start, AutomatonEvents::end);
    XML_SetCharacterDataHandler(parser.get(), AutomatonEvents::characters);
    // Without this, entities of the file's own are replaced; with it they are left out.
    XML_SetDefaultHandler(parser.get(), [](void*, const XML_Char*, int) {});
    for (bool isLast = false; !isLast;) {
        const std::string_view piece = bytes.substr(0, PieceLength);
        bytes.remove_prefix(piece.size());
        isLast = bytes.empty();
        if (XML_Parse(parser.get(), piece.data(), static_cast<int>(piece.size()), isLast) == XML_STATUS_OK) continue;
        return Error{"line " + std::to_string(XML_GetCurrentLineNumber(parser.get())) + ": expected well-formed XML (" +
                     XML_ErrorString(XML_GetErrorCode(parser.get())) + ")"};
    }
    return {};
}

void AutomatonTyperXMLParser::startElement(std::string_view name, const char* const* attributes) {
    if (name == "object" && depth_ > 0) {
        ++depth_;
    } else if (name == "object" && attributeNamed("type", attributes) == "TYPERABBREVIATION") {
        depth_ = 1;
        if (snippets_.size() == MostImportedSnippets) {
            ++tooMany_;
        } else {
            current_ = snippets_.emplace_back(std::make_shared<Snippet>());
        }
    } else if (name == "attribute" && current_) {
        attribute_ = attributeNamed("name", attributes);
        text_.clear();
    }
}

void AutomatonTyperXMLParser::endElement(std::string_view name) {
    if (name == "attribute" && !attribute_.empty()) finishAttribute();
    if (name == "object" && depth_ > 0 && --depth_ == 0) finishObject();
}

void AutomatonTyperXMLParser::characters(std::string_view text) {
    if (!attribute_.empty()) text_ += text;
}

void AutomatonTyperXMLParser::finishAttribute() {
    const std::string attribute = std::exchange(attribute_, {});
    if (text_.empty() || !current_) return;
    if (attribute == "abbreviation") current_->setAbbreviation(fromUtf8(text_));
    if (attribute == "label") current_->setLabel(fromUtf8(text_));
    if (attribute == "expansion") setExpansion();
}

void AutomatonTyperXMLParser::setExpansion() {
    // A snippet that never gets an abbreviation has this one. An abbreviation that came before is not lost to it.
    if (!current_->abbreviation()) current_->setAbbreviation(fromUtf8(text_));
    current_->setPlainTextContent(u"");
    const auto bytes = bytesFromBase64(text_);
    if (!bytes) {
        losses_.emplace_back("its content cannot be read (expected base 64) and is empty");
        return;
    }
    const Result<ArchivedRootContent> content = contentFromKeyedArchive(*bytes);
    if (!content) {
        losses_.push_back("its content cannot be read (" + content.error().message + ") and is empty");
    } else if (const auto* rich = std::get_if<ArchivedRichText>(&content.value())) {
        setContent(*current_, *rich);
    } else if (const auto* image = std::get_if<ArchivedImage>(&content.value())) {
        setContent(*current_, *image);
    } else {
        losses_.emplace_back("its content is neither text nor a picture and is empty");
    }
}

void AutomatonTyperXMLParser::finishObject() {
    if (current_) remarks_.addAll(*current_, losses_);
    losses_.clear();
    attribute_.clear();
    current_ = nullptr;
}

}  // namespace plume
