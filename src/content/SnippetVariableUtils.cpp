#include "content/SnippetVariableUtils.h"

#include <algorithm>

#include "content/AttributedStringRewriter.h"
#include "content/SnippetDateTimeVariable.h"

namespace plume {
namespace {

constexpr char16_t AttachmentCharacter = u'\uFFFC';

// Reads the parameters of a body. A dedicated reader, because CSVParser costs more than a placeholder may: what it
// accepts and where it stops is the same.
class ParameterReader {
  public:
    explicit ParameterReader(std::u16string_view body) : body_(body) {}

    VariableParams read() {
        VariableParams params;
        while (readParameter(params) && skipSpaces()) {
        }
        return params;
    }

  private:
    bool atEnd() const { return next_ == body_.size(); }
    bool at(char16_t unit) const { return !atEnd() && body_[next_] == unit; }

    bool skipSpaces() {
        const std::size_t start = next_;
        while (at(u' ')) ++next_;
        return next_ > start;
    }

    bool skipColon() {
        if (!at(u':')) return false;
        ++next_;
        return true;
    }

    // False when no parameter starts here.
    bool readParameter(VariableParams& params) {
        if (atEnd() || at(u' ')) return false;
        std::u16string name;
        std::u16string value;
        if (!readField(name)) return false;
        if (skipColon() && readField(value)) {
            std::u16string surplus;
            while (skipColon() && readField(surplus)) {
            }
        }
        params.insert_or_assign(std::move(name), std::move(value));
        return true;
    }

    // False, with an empty field, when a closing quote is missing.
    bool readField(std::u16string& field) {
        field.clear();
        if (at(u'"')) return readQuotedField(field);
        const std::size_t end = std::min(body_.find_first_of(u" \":", next_), body_.size());
        field = body_.substr(next_, end - next_);
        next_ = end;
        return true;
    }

    bool readQuotedField(std::u16string& field) {
        ++next_;
        while (true) {
            const std::size_t quote = body_.find(u'"', next_);
            if (quote == std::u16string_view::npos) {
                next_ = body_.size();
                field.clear();
                return false;
            }
            field += body_.substr(next_, quote - next_);
            next_ = quote + 1;
            if (!at(u'"')) return true;
            field += u'"';
            ++next_;
        }
    }

    std::u16string_view body_;
    std::size_t next_ = 0;
};

bool startsWithKeyword(std::u16string_view body) {
    return std::any_of(SnippetVariableUtils::Keywords.begin(), SnippetVariableUtils::Keywords.end(),
                       [&](std::u16string_view keyword) { return body.starts_with(keyword); });
}

std::u16string bracketed(std::u16string_view body) {
    std::u16string text(1, SnippetVariableUtils::OpeningMarker);
    text += body;
    text += SnippetVariableUtils::ClosingMarker;
    return text;
}

// The chip of a body, otherwise with the attributes given.
SharedAttributes chipAttributes(std::u16string_view body, const SharedAttributes& base) {
    TextAttributes attributes = base ? *base : TextAttributes();
    TextAttachment cell;
    cell.cellText = body;
    attributes.attachment = std::make_shared<const TextAttachment>(std::move(cell));
    return std::make_shared<const TextAttributes>(std::move(attributes));
}

bool isChip(const SharedAttributes& attributes) {
    return attributes && attributes->attachment && !attributes->attachment->cellText.empty();
}

SharedAttributes withoutAttachment(const SharedAttributes& attributes) {
    TextAttributes rest = *attributes;
    rest.attachment = nullptr;
    return rest == TextAttributes() ? nullptr : std::make_shared<const TextAttributes>(std::move(rest));
}

}  // namespace

VariableParams SnippetVariableUtils::parseParams(std::u16string_view body) {
    return ParameterReader(body).read();
}

std::shared_ptr<SnippetVariable> SnippetVariableUtils::parseVariable(std::u16string_view body) {
    if (body.starts_with(u"field")) return std::make_shared<SnippetFieldVariable>(parseParams(body));
    if (body.starts_with(u"snippet:")) return std::make_shared<SnippetAbbreviationVariable>(parseParams(body));
    if (body.starts_with(u"key:")) return std::make_shared<SnippetKeyVariable>(parseParams(body));
    if (body.starts_with(u"date:")) return std::make_shared<SnippetDateVariable>(parseParams(body));
    if (body.starts_with(u"time:")) return std::make_shared<SnippetTimeVariable>(parseParams(body));
    if (body.starts_with(u"clipboard")) return std::make_shared<SnippetClipboardVariable>(parseParams(body));
    return nullptr;
}

std::u16string SnippetVariableUtils::escapeParam(std::u16string_view value) {
    if (value.find_first_of(u": \"") == std::u16string_view::npos) return std::u16string(value);
    std::u16string escaped(1, u'"');
    for (const char16_t unit : value) {
        if (unit == u'"') escaped += u'"';
        escaped += unit;
    }
    escaped += u'"';
    return escaped;
}

AttributedString SnippetVariableUtils::attributedStringFromVariable(std::u16string_view body) {
    return AttributedString(std::u16string(1, AttachmentCharacter), chipAttributes(body, nullptr));
}

AttributedString SnippetVariableUtils::convertToSnippetEditContent(const AttributedString& content) {
    const std::u16string_view text = content.string();
    AttributedStringRewriter rewriter(content);
    std::size_t opening = std::u16string_view::npos;  // the last one that nothing has closed yet
    for (std::size_t i = 0; i < text.size(); ++i) {
        if (text[i] == OpeningMarker) opening = i;
        if (text[i] != ClosingMarker || opening == std::u16string_view::npos) continue;
        const std::u16string_view body = text.substr(opening + 1, i - opening - 1);
        if (startsWithKeyword(body)) {
            rewriter.copyTo(opening);
            rewriter.append(std::u16string_view(&AttachmentCharacter, 1), chipAttributes(body, rewriter.attributes()));
            rewriter.skipTo(i + 1);
        }
        opening = std::u16string_view::npos;
    }
    return rewriter.finish();
}

AttributedString SnippetVariableUtils::convertFromSnippetEditContent(const AttributedString& content) {
    const std::u16string_view text = content.string();
    AttributedStringRewriter rewriter(content);
    for (std::size_t i = text.find(AttachmentCharacter); i != std::u16string_view::npos;
         i = text.find(AttachmentCharacter, i + 1)) {
        rewriter.copyTo(i);
        const SharedAttributes attributes = rewriter.attributes();
        if (!isChip(attributes)) continue;
        rewriter.append(bracketed(attributes->attachment->cellText), withoutAttachment(attributes));
        rewriter.skipTo(i + 1);
    }
    return rewriter.finish();
}

}  // namespace plume
