#include "content/SnippetDateTimeVariable.h"

#include <gtest/gtest.h>

#include <limits>
#include <thread>

#include "Foundation/Strings.h"
#include "content/SnippetVariableUtils.h"

namespace plume {
namespace {

using namespace std::chrono_literals;
using std::chrono::sys_days;

constexpr std::int64_t Most = std::numeric_limits<std::int64_t>::max();
constexpr std::int64_t Least = std::numeric_limits<std::int64_t>::min();

ContentEnvironment environmentAt(Date now, const std::string& timeZone = "UTC", const std::string& locale = "en_US") {
    ContentEnvironment environment;
    environment.now = [now] { return now; };
    environment.timeZone = timeZone;
    environment.locale = locale;
    return environment;
}

std::shared_ptr<SnippetDateTimeVariable> read(std::u16string_view body) {
    return std::dynamic_pointer_cast<SnippetDateTimeVariable>(SnippetVariableUtils::parseVariable(body));
}

std::string value(std::u16string_view body, const ContentEnvironment& environment) {
    return toUtf8(read(body)->value(environment));
}

// Saturday.
constexpr Date Now = sys_days(2026y / 1 / 31) + 10h + 5min + 9s;

struct TextCase {
    std::u16string body;
    const char* text;
};

TEST(SnippetDateVariable, WritesStylesAndPatternsOfItsLocale) {
    const TextCase cases[] = {{u"date:short locale:en_US", "1/31/26"},
                              {u"date:medium locale:en_US", "Jan 31, 2026"},
                              {u"date:long locale:en_US", "January 31, 2026"},
                              {u"date:full locale:en_US", "Saturday, January 31, 2026"},
                              {u"date:short locale:de_DE", "31.01.26"},
                              {u"date:full locale:de_DE", "Samstag, 31. Januar 2026"},
                              {u"date:full locale:de-DE", "Samstag, 31. Januar 2026"},
                              {u"date:full locale:fr_FR", "samedi 31 janvier 2026"},
                              {u"date:short locale:ja_JP", "2026/01/31"},
                              {u"date:full locale:ja_JP", "2026年1月31日土曜日"},
                              {u"date:long locale:ar_EG", "٣١ يناير ٢٠٢٦"},
                              {u"date:yyyy-MM-dd locale:ar_EG", "٢٠٢٦-٠١-٣١"},
                              {u"date:\"EEEE, d. MMMM\" locale:de_DE", "Samstag, 31. Januar"},
                              {u"date:\"'Day' D 'of' yyyy\"", "Day 31 of 2026"},
                              {u"date:\"HH:mm:ss\"", "10:05:09"},
                              {u"date:full", "Saturday, January 31, 2026"},
                              {u"date:full locale:", "Saturday, January 31, 2026"},
                              {u"date:", ""}};
    for (const TextCase& c : cases) EXPECT_EQ(value(c.body, environmentAt(Now)), c.text) << toUtf8(c.body);
}

TEST(SnippetTimeVariable, WritesStylesAndPatternsOfItsLocale) {
    const TextCase cases[] = {{u"time:short locale:de_DE", "10:05"},
                              {u"time:medium locale:de_DE", "10:05:09"},
                              {u"time:medium locale:fr_FR", "10:05:09"},
                              {u"time:short locale:ja_JP", "10:05"},
                              {u"time:\"HH:mm\" locale:ar_EG", "١٠:٠٥"},
                              {u"time:\"h 'o''clock'\" locale:en_US", "10 o'clock"},
                              {u"time:HH:mm", "10"},
                              {u"time:yyyy-MM-dd", "2026-01-31"}};
    for (const TextCase& c : cases) EXPECT_EQ(value(c.body, environmentAt(Now)), c.text) << toUtf8(c.body);
}

TEST(SnippetDateTimeVariable, WritesNothingWithoutAFormat) {
    EXPECT_EQ(SnippetDateVariable().value(environmentAt(Now)), u"");
    EXPECT_EQ(SnippetTimeVariable().value(environmentAt(Now)), u"");
}

TEST(SnippetDateTimeVariable, TakesLocaleAndTimeZoneFromTheEnvironment) {
    EXPECT_EQ(value(u"date:MMMM", environmentAt(Now, "UTC", "fr_FR")), "janvier");
    EXPECT_EQ(value(u"date:MMMM locale:de_DE", environmentAt(Now, "UTC", "fr_FR")), "Januar");
    EXPECT_EQ(value(u"time:HH", environmentAt(Now, "America/New_York")), "05");
    EXPECT_EQ(value(u"time:HH", environmentAt(Now, "Asia/Tokyo")), "19");
}

TEST(SnippetDateTimeVariable, ReportsAPatternWithoutMeaningOnce) {
    ContentEnvironment environment = environmentAt(Now);
    int reports = 0;
    environment.report = [&](const std::string&) { ++reports; };
    for (int i = 0; i < 3; ++i) EXPECT_EQ(value(u"date:Ein_j", environment), "");
    EXPECT_EQ(reports, 1);
}

TEST(SnippetDateTimeVariable, StaysRightWithMoreFormatsThanAreKept) {
    for (int round = 0; round < 2; ++round) {
        for (int i = 0; i < 50; ++i) {
            const std::string literal = std::to_string(i);
            EXPECT_EQ(value(fromUtf8("date:'" + literal + "'dd"), environmentAt(Now)), literal + "31");
        }
    }
}

TEST(SnippetDateTimeVariable, MayBeUsedFromSeveralThreads) {
    const auto variable = read(u"date:full day:1 locale:de_DE");
    std::u16string first;
    std::u16string second;
    std::thread other([&] { first = variable->value(environmentAt(Now)); });
    second = variable->value(environmentAt(Now));
    other.join();
    EXPECT_EQ(first, u"Sonntag, 1. Februar 2026");
    EXPECT_EQ(second, first);
}

struct OffsetCase {
    std::u16string offsets;
    Date today;
    std::chrono::year_month_day result;
};

TEST(SnippetDateVariable, NormalisesOffsetsAsTheCalendarDoes) {
    const Date leapDay = sys_days(2024y / 2 / 29) + 23h;
    const OffsetCase cases[] = {
        {u"day:1", Now, 2026y / 2 / 1},           {u"day:-31", Now, 2025y / 12 / 31},
        {u"month:1", Now, 2026y / 3 / 3},         {u"month:14", Now, 2027y / 3 / 31},
        {u"month:-1", Now, 2025y / 12 / 31},      {u"month:-2", Now, 2025y / 12 / 1},
        {u"month:1 day:-3", Now, 2026y / 2 / 28}, {u"year:1", leapDay, 2025y / 3 / 1},
        {u"year:4", leapDay, 2028y / 2 / 29},     {u"year:-1 month:12", leapDay, 2024y / 2 / 29},
        {u"day:366", leapDay, 2025y / 3 / 1},     {u"year:-326", Now, 1700y / 1 / 31},
        {u"day:1 weekday:4", Now, 2026y / 2 / 1}};
    for (const OffsetCase& c : cases) {
        const auto variable = read(u"date:yyyy-MM-dd " + c.offsets);
        EXPECT_EQ(variable->date(environmentAt(c.today)), sys_days(c.result)) << toUtf8(c.offsets);
    }
}

TEST(SnippetDateVariable, KeepsTheTimeOfDayWithoutOffsets) {
    EXPECT_EQ(read(u"date:short")->date(environmentAt(Now)), Now);
    EXPECT_EQ(read(u"date:short day:0")->date(environmentAt(Now)), Now);
}

// Walks from day to day until the weekday is there.
sys_days nearest(sys_days today, std::chrono::weekday weekday, std::chrono::days step) {
    sys_days day = today + step;
    while (std::chrono::weekday(day) != weekday) day += step;
    return day;
}

TEST(SnippetDateVariable, FindsTheNextAndThePreviousWeekday) {
    for (unsigned today = 0; today < 7; ++today) {
        const sys_days date = sys_days(2026y / 2 / 24) + std::chrono::days(today);
        const ContentEnvironment environment = environmentAt(date + 13h);
        for (unsigned weekday = 0; weekday < 7; ++weekday) {
            const std::chrono::weekday wanted(weekday);
            SnippetDateVariable variable;
            variable.weekday = weekday;
            variable.valueType = SnippetDateVariable::ValueType::NextWeekday;
            EXPECT_EQ(variable.date(environment), nearest(date, wanted, std::chrono::days(1)));
            variable.valueType = SnippetDateVariable::ValueType::PreviousWeekday;
            EXPECT_EQ(variable.date(environment), nearest(date, wanted, std::chrono::days(-1)));
            variable.valueType = static_cast<SnippetDateVariable::ValueType>(-5);
            EXPECT_EQ(variable.date(environment), nearest(date, wanted, std::chrono::days(-1)));
        }
    }
}

TEST(SnippetDateVariable, CountsWeekdaysPastSaturdayFromSundayAgain) {
    const ContentEnvironment environment = environmentAt(Now);
    EXPECT_EQ(read(u"date:short valueType:1 weekday:7")->date(environment), sys_days(2026y / 2 / 1));
    EXPECT_EQ(read(u"date:short valueType:2 weekday:-1")->date(environment), sys_days(2026y / 1 / 24));
    for (const std::int64_t weekday : {Most, Least}) {
        SnippetDateVariable variable;
        variable.valueType = SnippetDateVariable::ValueType::NextWeekday;
        variable.weekday = weekday;
        const Date date = variable.date(environment);
        EXPECT_TRUE(date > Now && date <= Now + std::chrono::days(7));
    }
}

struct ZoneCase {
    const char* what;
    const char* timeZone;
    std::u16string body;
    Date now;
    Date result;
};

TEST(SnippetDateVariable, StartsDaysWhereTheClocksOfThePlaceDo) {
    const ZoneCase cases[] = {{"before the change", "Europe/Berlin", u"date:short day:1",
                               sys_days(2026y / 3 / 28) + 11h, sys_days(2026y / 3 / 28) + 23h},
                              {"over the change", "Europe/Berlin", u"date:short day:2", sys_days(2026y / 3 / 28) + 11h,
                               sys_days(2026y / 3 / 29) + 22h},
                              {"back over the change", "Europe/Berlin", u"date:short day:-1",
                               sys_days(2026y / 10 / 26) + 11h, sys_days(2026y / 10 / 24) + 22h},
                              {"next Monday over the change", "America/New_York", u"date:short valueType:1 weekday:1",
                               sys_days(2026y / 10 / 31) + 16h, sys_days(2026y / 11 / 2) + 5h},
                              {"months into summer", "America/New_York", u"date:short month:6",
                               sys_days(2026y / 1 / 15) + 16h, sys_days(2026y / 7 / 15) + 4h},
                              {"today is not yet today in UTC", "America/New_York", u"date:short day:1",
                               sys_days(2026y / 6 / 2) + 2h, sys_days(2026y / 6 / 2) + 4h},
                              {"midnight that does not exist", "America/Sao_Paulo", u"date:short day:1",
                               sys_days(2017y / 10 / 14) + 15h, sys_days(2017y / 10 / 15) + 3h},
                              {"midnight that comes twice", "America/Havana", u"date:short day:1",
                               sys_days(2017y / 11 / 4) + 15h, sys_days(2017y / 11 / 5) + 4h}};
    for (const ZoneCase& c : cases) {
        EXPECT_EQ(read(c.body)->date(environmentAt(c.now, c.timeZone)), c.result) << c.what;
    }
}

TEST(SnippetTimeVariable, ShiftsTheWallClockAlone) {
    const TextCase cases[] = {{u"minute:90", "11:35:09"},   {u"hour:14", "00:05:09"},
                              {u"hour:-11", "23:05:09"},    {u"second:51", "10:06:00"},
                              {u"second:-10", "10:04:59"},  {u"hour:1 minute:-60", "10:05:09"},
                              {u"minute:-1500", "09:05:09"}};
    for (const TextCase& c : cases) {
        EXPECT_EQ(value(u"time:\"HH:mm:ss\" " + c.body, environmentAt(Now)), c.text) << toUtf8(c.body);
    }
    // 01:30 on the morning when the clocks go from 2 to 3: another day's clock is shown, which has a half past two.
    const ContentEnvironment spring = environmentAt(sys_days(2026y / 3 / 29) + 30min, "Europe/Berlin");
    EXPECT_EQ(value(u"time:\"HH:mm\" hour:1", spring), "02:30");
    EXPECT_EQ(value(u"time:\"HH:mm\"", spring), "01:30");
    EXPECT_NE(value(u"time:yyyy-MM-dd hour:1", spring), "2026-03-29");
}

TEST(SnippetTimeVariable, TakesOffsetsOfAnySize) {
    SnippetTimeVariable variable;
    variable.format = u"HH:mm:ss";
    variable.hour = Most;  // 7 more than whole days
    EXPECT_EQ(variable.value(environmentAt(Now)), u"17:05:09");
    variable.minute = Most;
    variable.second = Most;
    EXPECT_EQ(variable.value(environmentAt(Now)).size(), 8U);
    variable.hour = variable.minute = variable.second = Least;
    EXPECT_EQ(variable.value(environmentAt(Now)).size(), 8U);
}

TEST(SnippetDateVariable, StopsAtTheEndsOfTheCalendar) {
    for (const std::int64_t offset : {Most, Least}) {
        for (std::int64_t SnippetDateVariable::*component :
             {&SnippetDateVariable::year, &SnippetDateVariable::month, &SnippetDateVariable::day}) {
            SnippetDateVariable variable;
            variable.format = u"full";
            variable.*component = offset;
            const Date date = variable.date(environmentAt(Now));
            EXPECT_TRUE(offset > 0 ? date > Now + std::chrono::years(40'000) : date < Now - std::chrono::years(40'000));
            EXPECT_NE(variable.value(environmentAt(Now)), u"");
        }
        SnippetDateVariable all;
        all.format = u"full";
        all.year = all.month = all.day = offset;
        for (const char16_t* locale : {u"en_US", u"ar_SA", u"fa_IR", u"th_TH", u"zh@calendar=chinese"}) {
            all.locale = locale;
            EXPECT_NE(all.value(environmentAt(Now)), u"") << toUtf8(locale);
        }
    }
}

TEST(SnippetDateTimeVariable, FallsBackFromLocalesAndZonesThatDoNotExist) {
    EXPECT_EQ(value(u"date:yyyy locale:\"no such: thing\"", environmentAt(Now)), "2026");
    EXPECT_EQ(value(u"date:yyyy locale:" + std::u16string(10'000, u'x'), environmentAt(Now)), "2026");
    EXPECT_EQ(value(u"date:yyyy", environmentAt(Now, "Middle/Earth")), "2026");
}

}  // namespace
}  // namespace plume
