// The text of an espanso match, taken apart: its variables, its caret, the fields of a form.
#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "Foundation/Strings.h"

namespace plume {

struct EspansoPiece {
    enum class Kind { Text, Variable, Caret, Field };
    Kind kind = Kind::Text;
    Range range;            // in the template
    std::u16string name;    // of a variable or a field
    std::u16string member;  // "name" in "{{form1.name}}"
    std::u16string text;    // what a piece of text says, without its escapes
};

// In order, without gaps. `isForm`: "[[name]]" is a field.
std::vector<EspansoPiece> piecesOfEspansoTemplate(std::u16string_view text, bool isForm);

}  // namespace plume
