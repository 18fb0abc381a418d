#include "import/AutoHotkeyOptions.h"

#include <algorithm>

#include "Foundation/Strings.h"

namespace plume {

namespace {

using View = std::u16string_view;

// An option and what follows it: "C1", "B0", "P30", "SI".
struct Option {
    char16_t letter = 0;  // in lower case
    View value;
};

constexpr View Letters = u"*?bcekoprstxz";

std::size_t valueLength(char16_t letter, View rest) {
    if (letter == u's' && !rest.empty() && View(u"iIpPeE").find(rest.front()) != View::npos) return 1;
    const std::size_t sign = letter == u'k' && rest.starts_with(u'-') ? 1 : 0;
    return std::min(rest.find_first_not_of(u"0123456789", sign), rest.size());
}

Option takeOption(View& text) {
    Option option;
    option.letter = lowercased(text.substr(0, 1)).front();
    text.remove_prefix(1);
    option.value = text.substr(0, valueLength(option.letter, text));
    text.remove_prefix(option.value.size());
    return option;
}

CaseSensitivity caseOf(View value) {
    if (value == u"0") return CaseSensitivity::IgnoreCaseAndAdapt;
    return value == u"1" ? CaseSensitivity::IgnoreCase : CaseSensitivity::CaseSensitive;
}

void apply(const Option& option, AutoHotkeyOptions& options) {
    const bool isOff = option.value == u"0";
    switch (option.letter) {
        case u'c':
            options.caseSensitivity = caseOf(option.value);
            break;
        case u'r':
        case u't':
            options.isRaw = !isOff;
            break;
        case u'x':
            options.isCommand = true;
            break;
        case u'*':
            if (!isOff) options.lost.emplace_back("it expands at once there (*), but after a delimiter here");
            break;
        case u'?':
            if (!isOff) options.lost.emplace_back("it expands inside words there (?), but not here");
            break;
        case u'o':
            if (!isOff) options.lost.emplace_back("the delimiter goes there (O), but stays here");
            break;
        case u'b':
            if (isOff) options.lost.emplace_back("the abbreviation stays there (B0), but is replaced here");
            break;
        default:  // speeds and priorities, which Plume has in its own settings
            break;
    }
}

}  // namespace

std::optional<AutoHotkeyOptions> autoHotkeyOptions(View text) {
    constexpr std::size_t AnythingUpTo = 2;
    const bool mayBeUnknown = text.size() <= AnythingUpTo;
    AutoHotkeyOptions options;
    while (!text.empty()) {
        const Option option = takeOption(text);
        const bool isKnown = option.letter == u' ' || Letters.find(option.letter) != View::npos;
        if (!isKnown && !mayBeUnknown) return std::nullopt;
        apply(option, options);
    }
    return options;
}

}  // namespace plume
