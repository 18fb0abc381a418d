// The options between the first two colons of a hotstring of AutoHotkey.
#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "library/Snippet.h"

namespace plume {

struct AutoHotkeyOptions {
    CaseSensitivity caseSensitivity = CaseSensitivity::IgnoreCaseAndAdapt;
    bool isRaw = false;             // keys in braces are text
    bool isCommand = false;         // the replacement is code
    std::vector<std::string> lost;  // what one group of snippets cannot say
};

// Nothing when these are no options, so that the line is no hotstring.
std::optional<AutoHotkeyOptions> autoHotkeyOptions(std::u16string_view text);

}  // namespace plume
