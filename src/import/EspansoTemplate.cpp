#include "import/EspansoTemplate.h"

#include <optional>
#include <utility>

namespace plume {

namespace {

constexpr std::size_t LongestName = 200;
constexpr std::u16string_view Caret = u"$|$";

bool isNameUnit(char16_t unit) {
    return (unit >= u'a' && unit <= u'z') || (unit >= u'A' && unit <= u'Z') || (unit >= u'0' && unit <= u'9') ||
           unit == u'_' || unit == u'-' || unit == u' ';
}

std::u16string_view takeName(std::u16string_view& rest) {
    std::size_t length = 0;
    while (length < rest.size() && length < LongestName && isNameUnit(rest[length])) ++length;
    const std::u16string_view name = trimmed(rest.substr(0, length));
    rest.remove_prefix(length);
    return name;
}

// The variable or field that the text begins with.
std::optional<EspansoPiece> enclosedPiece(std::u16string_view text, std::u16string_view open, std::u16string_view close,
                                          EspansoPiece::Kind kind) {
    if (!text.starts_with(open)) return std::nullopt;
    std::u16string_view rest = text.substr(open.size());
    EspansoPiece piece;
    piece.kind = kind;
    piece.name = takeName(rest);
    if (kind == EspansoPiece::Kind::Variable && rest.starts_with(u'.')) {
        rest.remove_prefix(1);
        piece.member = takeName(rest);
    }
    if (piece.name.empty() || !rest.starts_with(close)) return std::nullopt;
    piece.range.length = text.size() - rest.size() + close.size();
    return piece;
}

std::optional<EspansoPiece> specialPiece(std::u16string_view text, bool isForm) {
    using Kind = EspansoPiece::Kind;
    if (auto variable = enclosedPiece(text, u"{{", u"}}", Kind::Variable)) return variable;
    if (isForm) {
        if (auto field = enclosedPiece(text, u"[[", u"]]", Kind::Field)) return field;
    }
    if (!text.starts_with(Caret)) return std::nullopt;
    EspansoPiece caret;
    caret.kind = Kind::Caret;
    caret.range.length = Caret.size();
    return caret;
}

bool isEscape(std::u16string_view text) {
    for (const std::u16string_view escape : {u"\\{", u"\\}", u"\\[", u"\\]"}) {
        if (text.starts_with(escape)) return true;
    }
    return false;
}

}  // namespace

std::vector<EspansoPiece> piecesOfEspansoTemplate(std::u16string_view text, bool isForm) {
    std::vector<EspansoPiece> pieces;
    EspansoPiece plain;
    const auto endText = [&](std::size_t next) {
        plain.range.length = next - plain.range.location;
        if (plain.range.length > 0) pieces.push_back(std::exchange(plain, EspansoPiece()));
    };
    for (std::size_t i = 0; i < text.size();) {
        const bool canBegin = text[i] == u'{' || text[i] == u'[' || text[i] == u'$';
        if (auto special = canBegin ? specialPiece(text.substr(i), isForm) : std::nullopt) {
            endText(i);
            special->range.location = i;
            i = special->range.end();
            pieces.push_back(std::move(*special));
            plain.range.location = i;
            continue;
        }
        if (isEscape(text.substr(i))) ++i;
        plain.text += text[i++];
    }
    endText(text.size());
    return pieces;
}

}  // namespace plume
