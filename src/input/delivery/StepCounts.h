// How many keystrokes step over a text. Records count UTF-16 units; programs count characters, each in its own way.
// Pure; from any thread.
#pragma once

#include <cstdint>
#include <string_view>

namespace plume {

// The most that a program deletes with one Backspace. Whatever it is, a character is never cut in two, and the end of a
// line is one.
enum class ErasedAtOnce {
    Character,  // a code point
    EmojiPart,  // and what changes the look of an emoji, but not all that are joined to one
    Emoji,      // an emoji with all that belongs to it
    Letter,     // that, and a letter with the marks on it
};

// Backspaces that erase the text. Where a program takes turns of its own, rather too few than one too many, which would
// erase what is not ours.
std::uint64_t backspacesFor(std::u16string_view text, ErasedAtOnce atOnce);

// Left arrows from its end to its start: one for each extended grapheme cluster.
std::uint64_t leftArrowsFor(std::u16string_view text);

}  // namespace plume
