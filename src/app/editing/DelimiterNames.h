// Delimiters as a text that a person can read and write: those that cannot be seen have names.
//
// Pure; for any thread. The names are English.
#pragma once

#include <array>
#include <optional>
#include <string>
#include <string_view>

#include "Foundation/CharacterSet.h"

namespace plume {

struct NamedDelimiter {
    char16_t character;
    std::u16string_view name;
};

// In the order in which they are listed. Enter is the key of the keypad.
inline constexpr std::array<NamedDelimiter, 4> NamedDelimiters{
    {{u' ', u"Space"}, {u'\t', u"Tab"}, {u'\r', u"Return"}, {u'\u0003', u"Enter"}}};

const CharacterSet& namedDelimiters();

// Characters without a name stand for themselves; those of them that cannot be seen are told by their number, as
// "U+00A0". A line feed is a Return: that is how it arrives when it is typed.
std::u16string delimiterName(char32_t character);
// Back from what delimiterName() gave, letter case ignored; nothing when it is neither a name nor one character.
std::optional<char32_t> delimiterCalled(std::u16string_view name);

// All of them, the named ones first, with spaces between. For the small sets that people write.
std::u16string textFromDelimiters(const CharacterSet& delimiters);
// A word that is no name stands for each of its characters.
CharacterSet delimitersFromText(std::u16string_view text);

}  // namespace plume
