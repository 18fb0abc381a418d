#include "app/editing/DelimiterNames.h"

#include <unicode/uchar.h>
#include <unicode/utf16.h>

#include <algorithm>
#include <charconv>

#include "Foundation/Strings.h"

namespace plume {

namespace {

constexpr std::u16string_view NumberMark = u"U+";
constexpr std::size_t FewestDigits = 4;
constexpr int Hexadecimal = 16;
constexpr char32_t LastCodePoint = 0x10FFFF;

char32_t asTyped(char32_t character) {
    return character == U'\n' ? U'\r' : character;
}

bool canBeSeen(char32_t character) {
    constexpr std::uint32_t Marks = U_GC_M_MASK;
    const auto c = static_cast<UChar32>(character);
    return u_isgraph(c) && (U_GET_GC_MASK(c) & Marks) == 0;
}

std::u16string asText(char32_t character) {
    if (!U_IS_SUPPLEMENTARY(character)) return {static_cast<char16_t>(character)};
    return {static_cast<char16_t>(U16_LEAD(character)), static_cast<char16_t>(U16_TRAIL(character))};
}

std::u16string numberOf(char32_t character) {
    std::array<char, sizeof(char32_t) * 2> digits{};
    const auto end =
        std::to_chars(digits.data(), digits.data() + digits.size(), static_cast<std::uint32_t>(character), Hexadecimal)
            .ptr;
    const std::u16string written = fromUtf8({digits.data(), end});
    const std::size_t missing = FewestDigits - std::min(written.size(), FewestDigits);
    return std::u16string(NumberMark) + uppercased(std::u16string(missing, u'0') + written);
}

std::optional<char32_t> characterOfNumber(std::u16string_view name) {
    if (!equalsIgnoringCase(name.substr(0, NumberMark.size()), NumberMark)) return std::nullopt;
    const std::string digits = toUtf8(name.substr(NumberMark.size()));
    std::uint32_t number = 0;
    const auto [end, error] = std::from_chars(digits.data(), digits.data() + digits.size(), number, Hexadecimal);
    if (digits.size() < FewestDigits || error != std::errc() || end != digits.data() + digits.size()) {
        return std::nullopt;
    }
    return number <= LastCodePoint ? std::optional<char32_t>(number) : std::nullopt;
}

// Unpaired surrogates stand for themselves.
std::u32string codePointsOf(std::u16string_view text) {
    std::u32string all;
    for (const char16_t unit : text) {
        if (U16_IS_TRAIL(unit) && !all.empty() && U_IS_LEAD(all.back())) {
            all.back() = static_cast<char32_t>(U16_GET_SUPPLEMENTARY(static_cast<char16_t>(all.back()), unit));
        } else {
            all.push_back(unit);
        }
    }
    return all;
}

}  // namespace

const CharacterSet& namedDelimiters() {
    static const CharacterSet set = [] {
        std::u16string all;
        for (const NamedDelimiter& each : NamedDelimiters) all += each.character;
        return CharacterSet::withCharacters(all);
    }();
    return set;
}

std::u16string delimiterName(char32_t character) {
    const char32_t typed = asTyped(character);
    const auto* named = std::find_if(NamedDelimiters.begin(), NamedDelimiters.end(),
                                     [&](const NamedDelimiter& each) { return each.character == typed; });
    if (named != NamedDelimiters.end()) return std::u16string(named->name);
    return canBeSeen(typed) ? asText(typed) : numberOf(typed);
}

std::optional<char32_t> delimiterCalled(std::u16string_view name) {
    for (const NamedDelimiter& each : NamedDelimiters) {
        if (equalsIgnoringCase(each.name, name)) return each.character;
    }
    if (const auto numbered = characterOfNumber(name)) return asTyped(*numbered);
    const std::u32string characters = codePointsOf(name);
    return characters.size() == 1 ? std::optional(asTyped(characters.front())) : std::nullopt;
}

std::u16string textFromDelimiters(const CharacterSet& delimiters) {
    std::u16string text;
    const auto append = [&](const std::u16string& name) {
        if (!text.empty()) text += u' ';
        text += name;
    };
    for (const NamedDelimiter& each : NamedDelimiters) {
        if (delimiters.contains(each.character)) append(std::u16string(each.name));
    }
    for (const auto& [first, last] : delimiters.subtracting(namedDelimiters()).ranges()) {
        for (char32_t each = first; each <= last; ++each) append(delimiterName(each));
    }
    return text;
}

CharacterSet delimitersFromText(std::u16string_view text) {
    CharacterSet::Ranges members;
    for (const std::u16string& word : split(text, u' ')) {
        if (const auto called = delimiterCalled(word)) {
            members.emplace_back(*called, *called);
        } else {
            for (const char32_t each : codePointsOf(word)) members.emplace_back(asTyped(each), asTyped(each));
        }
    }
    return CharacterSet::withRanges(members);
}

}  // namespace plume
