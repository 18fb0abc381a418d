// Character sets in the forms in which keyed archives hold them. Pure; from any thread.
#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

#include "Foundation/CharacterSet.h"

namespace plume {

// Eight thousand bytes for the basic plane, one bit a character; then for each further plane with members its number
// and as many bytes.
std::string bitmapOfCharacterSet(const CharacterSet& set);
// A bitmap that ends early holds no more.
CharacterSet characterSetFromBitmap(std::string_view bitmap);

// A standard set by its number in archives; nothing for numbers that none has.
std::optional<CharacterSet> builtinCharacterSet(std::int64_t number);

// The members as text, when they are few and a text can hold them.
std::optional<std::u16string> shortTextOfCharacterSet(const CharacterSet& set);

}  // namespace plume
