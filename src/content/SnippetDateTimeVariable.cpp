#include "content/SnippetDateTimeVariable.h"

#include <algorithm>

#include "content/DateFormatters.h"

namespace plume {
namespace {

// Offsets beyond these lead out of every calendar: the date stays at the last year that they reach.
constexpr std::int64_t FurthestYears = 50'000;
constexpr std::int64_t FurthestMonths = FurthestYears * 12;
constexpr std::int64_t FurthestDays = FurthestYears * 365;

constexpr std::int64_t DaysPerWeek = 7;
constexpr std::int64_t HoursPerDay = 24;
constexpr std::int64_t SecondsPerMinute = 60;
constexpr std::int64_t MinutesPerDay = HoursPerDay * 60;
constexpr std::int64_t SecondsPerDay = MinutesPerDay * SecondsPerMinute;

std::int64_t nonNegativeRemainder(std::int64_t value, std::int64_t divisor) {
    const std::int64_t rest = value % divisor;
    return rest < 0 ? rest + divisor : rest;
}

std::int32_t field(const icu::Calendar& calendar, UCalendarDateFields which) {
    UErrorCode status = U_ZERO_ERROR;
    return calendar.get(which, status);
}

std::int32_t clampedOffset(std::int64_t offset, std::int64_t furthest) {
    return static_cast<std::int32_t>(std::clamp(offset, -furthest, furthest));
}

// From today to the weekday asked for: 1 to 7, or -1 to -7. Weekdays count from Sunday as 0.
std::int32_t daysToWeekday(SnippetDateVariable::ValueType type, std::int64_t weekday, std::int32_t today) {
    const auto ahead = static_cast<std::int32_t>(
        nonNegativeRemainder(nonNegativeRemainder(weekday, DaysPerWeek) - today, DaysPerWeek));
    if (type == SnippetDateVariable::ValueType::NextWeekday) return ahead == 0 ? 7 : ahead;
    return ahead - 7;
}

Date dateOf(const icu::Calendar& calendar) {
    UErrorCode status = U_ZERO_ERROR;
    return dateFromMilliseconds(calendar.getTime(status));
}

std::u16string text(const SnippetDateTimeVariable& variable, DateTextKind kind, const ContentEnvironment& environment) {
    if (!variable.format) return {};
    const auto formatted =
        formattedDate(variable.date(environment), kind, *variable.format, variable.locale, environment);
    if (formatted) return *formatted;
    environment.reportOnce("A date or time is left out: the pattern " + quotedForReport(*variable.format) +
                           " of its placeholder has letters without a meaning (text belongs between apostrophes).");
    return {};
}

void addLocaleAndOptions(BodyWriter& writer, const SnippetDateTimeVariable& variable) {
    writer.paramIfSet(u"locale", variable.locale);
    if (variable.isOptional) writer.part(variable.SnippetVariable::toString());
}

}  // namespace

SnippetDateVariable::SnippetDateVariable(const VariableParams& params)
    : SnippetDateTimeVariable(params),
      valueType(static_cast<ValueType>(shortIntegerParam(params, u"valueType"))),
      year(integerParam(params, u"year")),
      month(integerParam(params, u"month")),
      day(integerParam(params, u"day")),
      weekday(integerParam(params, u"weekday")) {
    format = textParam(params, u"date");
    locale = textParam(params, u"locale");
}

std::u16string SnippetDateVariable::toString() const {
    BodyWriter writer;
    writer.param(u"date", format.value_or(std::u16string()));
    if (valueIsToday()) {
        writer.paramUnlessZero(u"year", year);
        writer.paramUnlessZero(u"month", month);
        writer.paramUnlessZero(u"day", day);
    } else {
        writer.param(u"valueType", static_cast<std::int64_t>(valueType));
        writer.param(u"weekday", weekday);
    }
    addLocaleAndOptions(writer, *this);
    return writer.take();
}

std::u16string SnippetDateVariable::value(const ContentEnvironment& environment) const {
    return text(*this, DateTextKind::DayOnly, environment);
}

Date SnippetDateVariable::date(const ContentEnvironment& environment) const {
    if (valueIsToday() && year == 0 && month == 0 && day == 0) return environment.now();
    icu::GregorianCalendar& calendar = calendarOfNow(environment);
    std::int32_t newYear = field(calendar, UCAL_EXTENDED_YEAR);
    std::int32_t newMonth = field(calendar, UCAL_MONTH);
    std::int32_t newDay = field(calendar, UCAL_DATE);
    if (valueIsToday()) {
        newYear += clampedOffset(year, FurthestYears);
        newMonth += clampedOffset(month, FurthestMonths);
        newDay += clampedOffset(day, FurthestDays);
    } else {
        newDay += daysToWeekday(valueType, weekday, field(calendar, UCAL_DAY_OF_WEEK) - UCAL_SUNDAY);
    }
    calendar.clear();
    calendar.set(UCAL_EXTENDED_YEAR, newYear);
    calendar.set(UCAL_MONTH, newMonth);
    calendar.set(UCAL_DATE, newDay);
    return dateOf(calendar);
}

SnippetTimeVariable::SnippetTimeVariable(const VariableParams& params)
    : SnippetDateTimeVariable(params),
      hour(integerParam(params, u"hour")),
      minute(integerParam(params, u"minute")),
      second(integerParam(params, u"second")) {
    format = textParam(params, u"time");
    locale = textParam(params, u"locale");
}

std::u16string SnippetTimeVariable::toString() const {
    BodyWriter writer;
    writer.param(u"time", format.value_or(std::u16string()));
    writer.paramUnlessZero(u"hour", hour);
    writer.paramUnlessZero(u"minute", minute);
    writer.paramUnlessZero(u"second", second);
    addLocaleAndOptions(writer, *this);
    return writer.take();
}

std::u16string SnippetTimeVariable::value(const ContentEnvironment& environment) const {
    return text(*this, DateTextKind::TimeOnly, environment);
}

// The day of the result means nothing, so whole days are dropped from the offsets: none is too large, and no change of
// clocks is ever in the way.
Date SnippetTimeVariable::date(const ContentEnvironment& environment) const {
    if (hour == 0 && minute == 0 && second == 0) return environment.now();
    icu::GregorianCalendar& calendar = calendarOfNow(environment);
    const std::int64_t hours = field(calendar, UCAL_HOUR_OF_DAY) + hour % HoursPerDay;
    const std::int64_t minutes = field(calendar, UCAL_MINUTE) + minute % MinutesPerDay;
    const std::int64_t seconds = field(calendar, UCAL_SECOND) + second % SecondsPerDay;
    const std::int64_t ofDay = nonNegativeRemainder((hours * 60 + minutes) * SecondsPerMinute + seconds, SecondsPerDay);
    calendar.clear();
    calendar.set(2000, UCAL_JANUARY, 1);
    calendar.set(UCAL_HOUR_OF_DAY, static_cast<std::int32_t>(ofDay / 3600));
    calendar.set(UCAL_MINUTE, static_cast<std::int32_t>(ofDay / 60 % 60));
    calendar.set(UCAL_SECOND, static_cast<std::int32_t>(ofDay % 60));
    return dateOf(calendar);
}

}  // namespace plume
