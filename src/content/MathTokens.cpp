#include "content/MathTokens.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <cstdint>
#include <string>

#include "Foundation/CharacterSet.h"
#include "content/MathExpressionParser.h"

namespace plume {
namespace {

bool isDigit(char16_t unit) {
    return unit >= u'0' && unit <= u'9';
}

// What a number beyond the range of doubles stands for: infinity when it is too large, 0 when it is too small. The
// place of its first digit other than 0, moved by the exponent, tells which.
double outOfRangeValue(std::string_view digits) {
    constexpr std::int64_t FarAway = 1'000'000'000'000;
    const std::size_t mantissaEnd = std::min(digits.find_first_of("eE"), digits.size());
    const std::string_view mantissa = digits.substr(0, mantissaEnd);
    const std::size_t point = std::min(mantissa.find('.'), mantissa.size());
    const std::size_t first = mantissa.find_first_not_of("0.");
    const auto place = static_cast<std::int64_t>(point) - static_cast<std::int64_t>(first);
    std::int64_t exponent = 0;
    if (mantissaEnd < digits.size()) {
        const bool negative = digits[mantissaEnd + 1] == '-';
        const bool hasSign = negative || digits[mantissaEnd + 1] == '+';
        const char* const start = digits.data() + mantissaEnd + (hasSign ? 2 : 1);
        const auto [end, error] = std::from_chars(start, digits.data() + digits.size(), exponent);
        if (error != std::errc() || exponent > FarAway) exponent = FarAway;
        if (negative) exponent = -exponent;
    }
    return place + exponent > 0 ? HUGE_VAL : 0;
}

}  // namespace

std::size_t nameCharacterLength(std::u16string_view text, std::size_t index) {
    const char16_t unit = text[index];
    if (unit == u'_') return 1;
    const bool isPair = unit >= 0xD800 && unit < 0xDC00 && index + 1 < text.size() && text[index + 1] >= 0xDC00 &&
                        text[index + 1] < 0xE000;
    char32_t codePoint = unit;
    if (isPair) codePoint = 0x10000 + ((char32_t{unit} - 0xD800) << 10) + (char32_t{text[index + 1]} - 0xDC00);
    const bool belongs =
        CharacterSet::letters().contains(codePoint) || CharacterSet::decimalDigits().contains(codePoint);
    if (!belongs) return 0;
    return isPair ? 2 : 1;
}

Token Tokens::next() {
    skipBlanks();
    if (at_ == text_.size()) return {};
    const char16_t unit = text_[at_];
    if (isDigit(unit) || unit == u'.') return {TokenKind::Number, number(), {}, 0};
    if (const auto found = name(); !found.empty()) return {TokenKind::Name, 0, found, 0};
    ++at_;
    if (unit == u';' || CharacterSet::newlines().contains(unit)) return {TokenKind::Separator, 0, {}, 0};
    return {TokenKind::Operator, 0, {}, unit};
}

bool Tokens::take(char16_t symbol) {
    skipBlanks();
    if (at_ == text_.size() || text_[at_] != symbol) return false;
    ++at_;
    return true;
}

void Tokens::skipBlanks() {
    while (at_ < text_.size() && (text_[at_] == u' ' || text_[at_] == u'\t')) ++at_;
}

void Tokens::skipDigits() {
    while (at_ < text_.size() && isDigit(text_[at_])) ++at_;
}

std::u16string_view Tokens::name() {
    const std::size_t start = at_;
    while (at_ < text_.size()) {
        const std::size_t length = nameCharacterLength(text_, at_);
        if (length == 0) break;
        at_ += length;
    }
    return text_.substr(start, at_ - start);
}

// An exponent counts only when it has digits: in "2e" the number ends before the letter.
void Tokens::skipExponent() {
    const std::size_t start = at_;
    if (at_ == text_.size() || (text_[at_] != u'e' && text_[at_] != u'E')) return;
    ++at_;
    if (at_ < text_.size() && (text_[at_] == u'+' || text_[at_] == u'-')) ++at_;
    const std::size_t digits = at_;
    skipDigits();
    if (at_ == digits) at_ = start;
}

double Tokens::number() {
    const std::size_t start = at_;
    skipDigits();
    if (at_ < text_.size() && text_[at_] == u'.') ++at_;
    skipDigits();
    if (at_ - start == 1 && text_[start] == u'.') throw MathExpressionError("parse error");
    skipExponent();
    std::string digits;
    digits.reserve(at_ - start);
    for (const char16_t unit : text_.substr(start, at_ - start)) digits.push_back(static_cast<char>(unit));
    double value = 0;
    const auto [end, error] = std::from_chars(digits.data(), digits.data() + digits.size(), value);
    if (error == std::errc::result_out_of_range) return outOfRangeValue(digits);
    return value;
}

}  // namespace plume
