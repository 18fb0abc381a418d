// The variables in the snippets of Beeftext, "#{dateTime:+1d:yyyy-MM-dd}", as placeholders of Plume.
#pragma once

#include <map>
#include <string>
#include <string_view>
#include <vector>

#include "Foundation/text/AttributedString.h"
#include "import/ForeignPlaceholders.h"
#include "import/ScriptShelf.h"

namespace plume {

// The pieces of a date format of Qt, "dddd d MMMM, hh:mm AP", and the same format for strftime.
struct QtDateFormat {
    std::vector<DatePiece> pieces;
    std::u16string strftime;
};
QtDateFormat readQtDateFormat(std::u16string_view format);

class BeeftextVariables {
  public:
    // What the keywords stand for, as far as that is plain text; stays with its owner.
    using Texts = std::map<std::u16string, std::u16string, std::less<>>;

    BeeftextVariables(const Texts& texts, ScriptShelf& scripts) : texts_(texts), scripts_(scripts) {}

    // `keyword` is what the scripts of the text are called after.
    std::u16string expand(std::u16string_view text, std::u16string_view keyword);
    AttributedString expand(const AttributedString& text, std::u16string_view keyword);
    // Why the last text is not carried over whole, one reason each.
    std::vector<std::string> takeProblems();

    // Whether the text has a variable that Beeftext knows.
    static bool areIn(std::u16string_view text);

  private:
    struct Variable {
        Range range;  // with "#{" and "}"
        std::u16string name;
        std::u16string argument;
    };

    static std::vector<Variable> variablesIn(std::u16string_view text);
    std::u16string valueOf(const Variable& variable, std::u16string_view written);
    static std::u16string delayOf(std::u16string_view milliseconds);
    std::u16string dateTimeOf(std::u16string_view argument);
    std::u16string keyOf(std::u16string_view argument);
    std::u16string shortcutOf(std::u16string_view argument);
    std::u16string environmentOf(const std::u16string& name);
    std::u16string changedText(const Variable& variable);
    std::u16string shelved(const std::u16string& script);
    std::u16string lost(const std::string& why);

    const Texts& texts_;
    ScriptShelf& scripts_;
    std::u16string keyword_;
    std::vector<std::string> problems_;
};

}  // namespace plume
