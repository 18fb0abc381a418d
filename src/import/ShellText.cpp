#include "import/ShellText.h"

#include "Foundation/Strings.h"

namespace plume {

std::u16string quotedForShell(std::u16string_view text) {
    return u"'" + replacingAll(text, u"'", u"'\\''") + u"'";
}

std::u16string shellAssignment(std::u16string_view variable, std::u16string_view text) {
    const std::u16string name(variable);
    return name + u"=$(cat <<'PLUME_TEXT_ENDS'\n" + std::u16string(text) + u"\nPLUME_TEXT_ENDS\n)\nexport " + name +
           u"\n";
}

std::u16string randomChoiceScript(const std::vector<std::u16string>& choices) {
    std::u16string script = u"#!/bin/bash\nchoices=(";
    for (const std::u16string& choice : choices) script += u"\n  " + quotedForShell(choice);
    return script + u"\n)\nprintf '%s' \"${choices[RANDOM % ${#choices[@]}]}\"\n";
}

}  // namespace plume
