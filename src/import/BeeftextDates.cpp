#include <algorithm>
#include <array>

#include "import/BeeftextVariables.h"

namespace plume {

namespace {

using Kind = DatePiece::Kind;

struct Letters {
    std::u16string_view qt;
    Kind kind;
    std::u16string_view pattern;
    std::u16string_view strftime;
};

// Of those that begin alike the longest comes first. "h" counts to 12 only where AM or PM is shown.
constexpr std::array<Letters, 26> All = {{
    {u"dddd", Kind::Day, u"EEEE", u"%A"}, {u"ddd", Kind::Day, u"EEE", u"%a"},   {u"dd", Kind::Day, u"dd", u"%d"},
    {u"d", Kind::Day, u"d", u"%-d"},      {u"MMMM", Kind::Day, u"MMMM", u"%B"}, {u"MMM", Kind::Day, u"MMM", u"%b"},
    {u"MM", Kind::Day, u"MM", u"%m"},     {u"M", Kind::Day, u"M", u"%-m"},      {u"yyyy", Kind::Day, u"yyyy", u"%Y"},
    {u"yy", Kind::Day, u"yy", u"%y"},     {u"HH", Kind::Time, u"HH", u"%H"},    {u"H", Kind::Time, u"H", u"%-H"},
    {u"hh", Kind::Time, u"hh", u"%I"},    {u"h", Kind::Time, u"h", u"%-I"},     {u"mm", Kind::Time, u"mm", u"%M"},
    {u"m", Kind::Time, u"m", u"%-M"},     {u"ss", Kind::Time, u"ss", u"%S"},    {u"s", Kind::Time, u"s", u"%-S"},
    {u"zzz", Kind::Time, u"SSS", u"%3N"}, {u"z", Kind::Time, u"S", u"%N"},      {u"AP", Kind::Time, u"a", u"%p"},
    {u"ap", Kind::Time, u"a", u"%P"},     {u"A", Kind::Time, u"a", u"%p"},      {u"a", Kind::Time, u"a", u"%P"},
    {u"tt", Kind::Time, u"xx", u"%z"},    {u"t", Kind::Time, u"zzz", u"%Z"},
}};

// The text between apostrophes at the start, which is taken; two of them are one.
std::u16string takeQuoted(std::u16string_view& rest) {
    std::u16string text;
    if (rest.starts_with(u"''")) {
        rest.remove_prefix(2);
        return u"'";
    }
    do {
        if (!text.empty()) text += u'\'';
        rest.remove_prefix(1);
        const std::size_t close = std::min(rest.find(u'\''), rest.size());
        text += rest.substr(0, close);
        rest.remove_prefix(std::min(close + 1, rest.size()));
    } while (rest.starts_with(u'\''));
    return text;
}

bool showsHalfDays(std::u16string_view format) {
    bool isQuoted = false;
    for (const char16_t unit : format) {
        if (unit == u'\'') isQuoted = !isQuoted;
        if (!isQuoted && (unit == u'a' || unit == u'A')) return true;
    }
    return false;
}

void addText(QtDateFormat& result, const std::u16string& text) {
    if (result.pieces.empty() || result.pieces.back().kind != Kind::Text) result.pieces.emplace_back();
    result.pieces.back().text += text;
    for (const char16_t unit : text) result.strftime += unit == u'%' ? u"%%" : std::u16string(1, unit);
}

}  // namespace

QtDateFormat readQtDateFormat(std::u16string_view format) {
    QtDateFormat result;
    const bool isHalf = showsHalfDays(format);
    while (!format.empty()) {
        if (format.front() == u'\'') {
            addText(result, takeQuoted(format));
            continue;
        }
        const auto found =
            std::find_if(All.begin(), All.end(), [&](const Letters& l) { return format.starts_with(l.qt); });
        if (found == All.end()) {
            addText(result, std::u16string(1, format.front()));
            format.remove_prefix(1);
            continue;
        }
        const bool isWhole = !isHalf && found->qt.starts_with(u'h');
        const bool isPadded = found->qt.size() == 2;
        result.pieces.push_back({found->kind, isWhole ? (isPadded ? u"HH" : u"H") : std::u16string(found->pattern)});
        result.strftime += isWhole ? (isPadded ? u"%H" : u"%-H") : found->strftime;
        format.remove_prefix(found->qt.size());
    }
    return result;
}

}  // namespace plume
