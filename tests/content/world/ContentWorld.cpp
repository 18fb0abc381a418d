#include "tests/content/world/ContentWorld.h"

#include <chrono>

#include "Foundation/Strings.h"
#include "library/Snippet.h"

namespace plume {

namespace {

SharedAttributes style(bool bold, bool italic) {
    if (!bold && !italic) return nullptr;
    auto attributes = std::make_shared<TextAttributes>();
    attributes->font = FontAttribute{u"Helvetica", 12, bold, italic};
    return attributes;
}

std::string describeField(const SnippetFieldVariable& field) {
    std::string text = "field";
    if (field.isOptional) text += field.isSelected ? "?+" : "?";
    if (field.isReadonly) text += "!";
    text += "(" + toUtf8(field.name.value_or(u"")) + "=" + (field.value ? toUtf8(*field.value) : "nil");
    if (field.richTextValue) text += "|" + notation(*field.richTextValue);
    return text + ")";
}

std::string describe(const SnippetVariable& variable) {
    std::string text;
    if (const auto* field = dynamic_cast<const SnippetFieldVariable*>(&variable)) {
        text = describeField(*field);
    } else if (const auto* key = dynamic_cast<const SnippetKeyVariable*>(&variable)) {
        text =
            "key" + std::to_string(numberOf(key->keyCode)) + (key->count == 1 ? "" : "x" + std::to_string(key->count));
    } else if (dynamic_cast<const SnippetContentCaret*>(&variable) != nullptr) {
        text = "caret";
    } else if (const auto* nested = dynamic_cast<const SnippetAbbreviationVariable*>(&variable)) {
        return "script(" + toUtf8(nested->abbreviation.value_or(u"")) + ")@" + std::to_string(nested->location) + "+" +
               std::to_string(nested->scriptLength);
    } else {
        text = "unexpected";
    }
    return text + "@" + std::to_string(variable.location);
}

}  // namespace

std::vector<std::string> FixedPasteboard::types() const {
    std::vector<std::string> result;
    if (plainText) result.emplace_back(PasteboardType::String);
    if (rtf) result.emplace_back(PasteboardType::RTF);
    if (rtfd) result.emplace_back(PasteboardType::RTFD);
    return result;
}

std::optional<std::u16string> FixedPasteboard::string() const {
    ++readCount;
    return plainText ? std::optional(fromUtf8(*plainText)) : std::nullopt;
}

std::optional<std::string> FixedPasteboard::data(std::string_view type) const {
    ++readCount;
    return type == PasteboardType::RTFD ? rtfd : type == PasteboardType::RTF ? rtf : std::nullopt;
}

ContentWorld::ContentWorld() {
    using namespace std::chrono;
    const Date moment = sys_days(2026y / March / 9) + 14h + 5min + 6s;
    environment.now = [moment] { return moment; };
    environment.timeZone = "UTC";
    environment.locale = "en_US";
    environment.pasteboard = &pasteboard;
    environment.report = [this](const std::string& message) { reports.push_back(message); };
    addGroup();
}

std::shared_ptr<SnippetGroup> ContentWorld::addGroup() {
    groups.push_back(SnippetGroup::make());
    return groups.back();
}

std::shared_ptr<Snippet> ContentWorld::snippet(std::string_view content, ContentType type) {
    auto result = std::make_shared<Snippet>();
    result->setContentType(type);
    result->setRichTextContent(type == ContentType::RichText ? rich(content) : AttributedString(fromUtf8(content)));
    return result;
}

std::shared_ptr<Snippet> ContentWorld::add(std::string_view abbreviation, std::string_view content, ContentType type) {
    auto result = snippet(content, type);
    result->setAbbreviation(fromUtf8(abbreviation));
    groups.front()->addItem(result);
    return result;
}

SnippetParser::Expansion ContentWorld::expand(std::string_view content, ContentType type) {
    return SnippetParser(environment).parseSnippet(snippet(content, type), groups);
}

AttributedString rich(std::string_view notation) {
    AttributedString text;
    bool bold = false;
    bool italic = false;
    std::u16string piece;
    const auto finishPiece = [&] {
        text.append(piece, style(bold, italic));
        piece.clear();
    };
    for (const char16_t unit : fromUtf8(notation)) {
        if (unit != u'*' && unit != u'_') {
            piece.push_back(unit);
            continue;
        }
        finishPiece();
        (unit == u'*' ? bold : italic) ^= true;
    }
    finishPiece();
    return text;
}

std::string notation(const AttributedString& text) {
    std::string result;
    std::size_t position = 0;
    for (const auto& run : text.runs()) {
        const bool hasFont = run.attributes && run.attributes->font;
        const std::string marks = std::string(hasFont && run.attributes->font->bold ? "*" : "") +
                                  (hasFont && run.attributes->font->italic ? "_" : "");
        result +=
            marks + toUtf8(text.string().substr(position, run.length)) + std::string(marks.rbegin(), marks.rend());
        position += run.length;
    }
    return result;
}

std::string notation(const SnippetExpandedContent& content) {
    if (const auto* richText = std::get_if<AttributedString>(&content.content)) return notation(*richText);
    return toUtf8(content.string());
}

std::string describe(const std::vector<std::shared_ptr<SnippetVariable>>& variables) {
    std::string result;
    for (const auto& variable : variables) result += (result.empty() ? "" : " ") + describe(*variable);
    return result;
}

}  // namespace plume
