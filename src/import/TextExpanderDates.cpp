#include "import/TextExpanderDates.h"

#include <algorithm>
#include <array>

#include "Foundation/Strings.h"
#include "content/SnippetDateTimeVariable.h"

namespace plume {

namespace {

using View = std::u16string_view;

struct Code {
    View code;  // behind the percent sign
    View pattern;
    bool isTime;
};

constexpr std::array Codes = {
    Code{u"Y", u"yyyy", false}, Code{u"y", u"yy", false}, Code{u"B", u"MMMM", false}, Code{u"b", u"MMM", false},
    Code{u"m", u"MM", false},   Code{u"1m", u"M", false}, Code{u"A", u"EEEE", false}, Code{u"a", u"EEE", false},
    Code{u"d", u"dd", false},   Code{u"1d", u"d", false}, Code{u"e", u"d", false},    Code{u"j", u"DDD", false},
    Code{u"1j", u"D", false},   Code{u"H", u"HH", true},  Code{u"1H", u"H", true},    Code{u"I", u"hh", true},
    Code{u"1I", u"h", true},    Code{u"M", u"mm", true},  Code{u"1M", u"m", true},    Code{u"S", u"ss", true},
    Code{u"1S", u"s", true},    Code{u"p", u"a", true},   Code{u"Z", u"zzz", true},
};

// The code that the text, which starts with the percent sign, starts with; else null.
const Code* codeAt(View text) {
    if (!text.starts_with(u'%')) return nullptr;
    const View behind = text.substr(1);
    const auto found =
        std::find_if(Codes.begin(), Codes.end(), [&](const Code& c) { return behind.starts_with(c.code); });
    return found == Codes.end() ? nullptr : &*found;
}

}  // namespace

std::size_t TextExpanderDates::takeShift(View text) {
    constexpr std::size_t MostDigits = 6;
    constexpr std::size_t Start = 3;
    if (!text.starts_with(u"%@+") && !text.starts_with(u"%@-")) return 0;
    const View digits = text.substr(Start, text.substr(Start, MostDigits).find_first_not_of(u"0123456789"));
    const std::size_t unit = Start + std::min(digits.size(), MostDigits);
    if (unit >= text.size()) return 0;
    const std::int64_t amount =
        (text[2] == u'-' ? -1 : 1) * (digits.empty() ? 1 : integerValue(digits.substr(0, MostDigits)));
    switch (text[unit]) {
        case u'Y':
            year_ += amount;
            break;
        case u'M':
            month_ += amount;
            break;
        case u'W':
            day_ += 7 * amount;
            break;
        case u'D':
            day_ += amount;
            break;
        case u'h':
            hour_ += amount;
            break;
        case u'm':
            minute_ += amount;
            break;
        case u's':
            second_ += amount;
            break;
        default:
            return 0;
    }
    return unit + 1;
}

TextExpanderDates::Codes TextExpanderDates::codesIn(View text, bool joined) const {
    constexpr View Between = u" ,./-:";
    constexpr std::size_t LongestBetween = 3;
    const Code* code = codeAt(text);
    if (!code) return {};
    const bool isTime = code->isTime;
    std::u16string pattern;
    std::size_t end = 0;
    std::size_t gap = 0;
    while (code && code->isTime == isTime) {
        pattern += text.substr(end, gap);
        pattern += code->pattern;
        end += gap + 1 + code->code.size();
        if (!joined) break;
        const View rest = text.substr(end);
        gap =
            std::min(rest.substr(0, LongestBetween).find_first_not_of(Between), std::min(rest.size(), LongestBetween));
        code = codeAt(rest.substr(gap));
    }
    return {end, isTime ? timeBody(pattern) : dateBody(pattern)};
}

std::u16string TextExpanderDates::dateBody(View format) const {
    SnippetDateVariable date;
    date.format = std::u16string(format);
    date.year = year_;
    date.month = month_;
    date.day = day_;
    return date.toString();
}

std::u16string TextExpanderDates::timeBody(View format) const {
    SnippetTimeVariable time;
    time.format = std::u16string(format);
    time.hour = hour_;
    time.minute = minute_;
    time.second = second_;
    return time.toString();
}

}  // namespace plume
