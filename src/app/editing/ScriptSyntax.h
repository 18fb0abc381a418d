// What the parts of a script's text are, line by line, for showing them in colours.
//
// This follows the languages as far as a line and what the one before it left open can tell; a script that is taken
// wrongly has odd colours and nothing else. The time is linear in the line, whatever stands in it. Pure functions, for
// any thread; positions are UTF-16 units.
#pragma once

#include <compare>
#include <string>
#include <string_view>
#include <vector>

#include "Foundation/Strings.h"

namespace plume {

enum class ScriptLanguage : unsigned char { Shell, Python, Perl, Ruby, JavaScript, AppleScript, Other };
enum class ScriptToken : unsigned char { Keyword, String, Comment, Variable, Placeholder };

struct ScriptStretch {
    ScriptToken token = ScriptToken::Keyword;
    Range range;

    bool operator==(const ScriptStretch&) const = default;
};

// What a line leaves open for the next one.
struct ScriptState {
    enum class Open : unsigned char { Nothing, Quotes, TripleQuotes, BlockComment, HereDocument };

    ScriptLanguage language = ScriptLanguage::Shell;
    Open open = Open::Nothing;
    char16_t quote = 0;              // of a text in quotes
    std::u16string terminator = {};  // of a here-document
    bool mayBeIndented = false;      // its terminator

    auto operator<=>(const ScriptState&) const = default;
};

// As its "#!" line says; a shell script without one.
ScriptLanguage languageOfScript(std::u16string_view firstLine);

// Adds the stretches of the line to `found`, where later ones lie over earlier ones; returns the state behind it.
ScriptState scanScriptLine(std::u16string_view line, const ScriptState& before, std::vector<ScriptStretch>& found);

// White space that a line begins with when it is written below `line`: the same, and one level more where something
// was opened.
std::u16string indentBelow(std::u16string_view line, ScriptLanguage language);

}  // namespace plume
