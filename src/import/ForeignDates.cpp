#include <algorithm>
#include <array>
#include <cstdlib>
#include <utility>

#include "Foundation/Strings.h"
#include "content/PlaceholderBody.h"
#include "import/ForeignPlaceholders.h"

namespace plume {

namespace {

using Kind = DatePiece::Kind;

constexpr std::int64_t SecondsPerDay = 86'400;
constexpr std::int64_t SecondsPerHour = 3600;
constexpr std::int64_t SecondsPerMinute = 60;
constexpr std::int64_t LargestShift = 1'000'000'000;

bool isLetter(char16_t unit) {
    return (unit >= u'a' && unit <= u'z') || (unit >= u'A' && unit <= u'Z');
}

// Text as it is written within a date pattern.
std::u16string quoted(std::u16string_view text) {
    std::u16string result;
    bool isQuoting = false;
    for (const char16_t unit : text) {
        if (unit != u'\'' && isLetter(unit) != isQuoting) {
            result += u'\'';
            isQuoting = !isQuoting;
        }
        if (unit == u'\'') result += u'\'';
        result += unit;
    }
    return isQuoting ? result + u'\'' : result;
}

bool canStandInPattern(std::u16string_view text) {
    return text.find_first_of(u"\n\r\t\u3010\u3011") == std::u16string_view::npos;
}

// Writes neighbours that one placeholder can show as one.
class DateWriter {
  public:
    DateWriter(DateShift shift, std::u16string_view locale) : shift_(shift), locale_(locale) {
        if (shift_.seconds % SecondsPerDay != 0) return;
        shift_.days += shift_.seconds / SecondsPerDay;
        shift_.seconds = 0;
    }

    std::optional<std::u16string> write(const std::vector<DatePiece>& pieces) {
        const auto shows = [&](Kind kind) {
            return std::any_of(pieces.begin(), pieces.end(), [&](const DatePiece& p) { return p.kind == kind; });
        };
        if (shift_.seconds != 0 && shows(Kind::Day)) return std::nullopt;
        for (const std::int64_t part : {shift_.years, shift_.months, shift_.days, shift_.seconds}) {
            if (std::abs(part) > LargestShift) return std::nullopt;
        }
        const bool showsDay = shows(Kind::Day);
        const bool isShifted = shift_.years != 0 || shift_.months != 0 || shift_.days != 0;
        for (const DatePiece& piece : pieces) {
            if (piece.kind == Kind::Text) {
                text_ += piece.text;
            } else {
                add(piece.text, isShifted ? piece.kind : showsDay ? Kind::Day : Kind::Time);
            }
        }
        flush();
        return result_ + text_;
    }

  private:
    void add(std::u16string_view letters, Kind kind) {
        if (!pattern_.empty() && (kind != kind_ || !canStandInPattern(text_))) flush();
        if (pattern_.empty()) {
            result_ += std::exchange(text_, {});
            kind_ = kind;
        }
        pattern_ += quoted(std::exchange(text_, {}));
        pattern_ += letters;
    }

    void flush() {
        if (pattern_.empty()) return;
        BodyWriter body;
        body.param(kind_ == Kind::Day ? u"date" : u"time", std::exchange(pattern_, {}));
        if (kind_ == Kind::Day) {
            body.paramUnlessZero(u"year", shift_.years);
            body.paramUnlessZero(u"month", shift_.months);
            body.paramUnlessZero(u"day", shift_.days);
        } else {
            body.paramUnlessZero(u"hour", shift_.seconds / SecondsPerHour);
            body.paramUnlessZero(u"minute", shift_.seconds % SecondsPerHour / SecondsPerMinute);
            body.paramUnlessZero(u"second", shift_.seconds % SecondsPerMinute);
        }
        if (!locale_.empty()) body.param(u"locale", locale_);
        result_ += OpeningMarker + body.take() + ClosingMarker;
    }

    DateShift shift_;
    std::u16string_view locale_;
    std::u16string result_;
    std::u16string text_;     // behind the pattern
    std::u16string pattern_;  // of a placeholder that is not yet in the result
    Kind kind_ = Kind::Day;
};

struct Conversion {
    std::u16string_view letters;  // behind "%"
    Kind kind;
    std::u16string_view pattern;
};

constexpr std::array<Conversion, 32> Conversions = {{
    {u"Y", Kind::Day, u"yyyy"},      {u"y", Kind::Day, u"yy"},         {u"m", Kind::Day, u"MM"},
    {u"-m", Kind::Day, u"M"},        {u"B", Kind::Day, u"MMMM"},       {u"b", Kind::Day, u"MMM"},
    {u"h", Kind::Day, u"MMM"},       {u"d", Kind::Day, u"dd"},         {u"-d", Kind::Day, u"d"},
    {u"A", Kind::Day, u"EEEE"},      {u"a", Kind::Day, u"EEE"},        {u"j", Kind::Day, u"DDD"},
    {u"-j", Kind::Day, u"D"},        {u"F", Kind::Day, u"yyyy-MM-dd"}, {u"D", Kind::Day, u"MM/dd/yy"},
    {u"H", Kind::Time, u"HH"},       {u"-H", Kind::Time, u"H"},        {u"I", Kind::Time, u"hh"},
    {u"-I", Kind::Time, u"h"},       {u"M", Kind::Time, u"mm"},        {u"-M", Kind::Time, u"m"},
    {u"S", Kind::Time, u"ss"},       {u"-S", Kind::Time, u"s"},        {u"p", Kind::Time, u"a"},
    {u"Z", Kind::Time, u"zzz"},      {u"z", Kind::Time, u"xx"},        {u":z", Kind::Time, u"xxx"},
    {u"T", Kind::Time, u"HH:mm:ss"}, {u"R", Kind::Time, u"HH:mm"},     {u"r", Kind::Time, u"hh:mm:ss a"},
    {u"X", Kind::Time, u"HH:mm:ss"}, {u"-y", Kind::Day, u"yy"},
}};

}  // namespace

std::optional<std::u16string> datePlaceholders(const std::vector<DatePiece>& pieces, const DateShift& shift,
                                               std::u16string_view locale) {
    return DateWriter(shift, locale).write(pieces);
}

std::optional<std::vector<DatePiece>> piecesOfStrftime(std::u16string_view format) {
    std::vector<DatePiece> pieces;
    while (!format.empty()) {
        const std::size_t percent = std::min(format.find(u'%'), format.size());
        if (percent > 0) pieces.push_back({Kind::Text, std::u16string(format.substr(0, percent))});
        format.remove_prefix(percent);
        if (format.empty()) break;
        format.remove_prefix(1);
        if (format.starts_with(u'%') || format.starts_with(u'n') || format.starts_with(u't')) {
            pieces.push_back({Kind::Text, format[0] == u'n' ? u"\n" : format[0] == u't' ? u"\t" : u"%"});
            format.remove_prefix(1);
            continue;
        }
        const auto found = std::find_if(Conversions.begin(), Conversions.end(),
                                        [&](const Conversion& c) { return format.starts_with(c.letters); });
        if (found == Conversions.end()) return std::nullopt;
        pieces.push_back({found->kind, std::u16string(found->pattern)});
        format.remove_prefix(found->letters.size());
    }
    return pieces;
}

}  // namespace plume
