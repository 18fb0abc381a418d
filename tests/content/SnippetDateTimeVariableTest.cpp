// What the examples of docs/content-language.md do not show: other locales and zones, and the ends of the calendar.
#include "content/SnippetDateTimeVariable.h"

#include <gtest/gtest.h>

#include <limits>
#include <thread>

#include "Foundation/Strings.h"
#include "content/PlaceholderKinds.h"

namespace plume {
namespace {

using namespace std::chrono_literals;
using std::chrono::sys_days;

constexpr std::int64_t Most = std::numeric_limits<std::int64_t>::max();
constexpr std::int64_t Least = std::numeric_limits<std::int64_t>::min();

// Saturday.
constexpr Date Now = sys_days(2026y / 1 / 31) + 10h + 5min + 9s;

ContentEnvironment environmentAt(Date now, const std::string& timeZone = "UTC", const std::string& locale = "en_US") {
    ContentEnvironment environment;
    environment.now = [now] { return now; };
    environment.timeZone = timeZone;
    environment.locale = locale;
    return environment;
}

std::shared_ptr<SnippetDateTimeVariable> read(std::u16string_view body) {
    return std::dynamic_pointer_cast<SnippetDateTimeVariable>(parseVariable(body));
}

std::string value(std::u16string_view body, const ContentEnvironment& environment = environmentAt(Now)) {
    return toUtf8(read(body)->value(environment));
}

TEST(SnippetDateTimeVariable, WritesStylesAndPatternsOfItsLocale) {
    const struct {
        std::u16string body;
        const char* text;
    } cases[] = {
        {u"date:short locale:de_DE", "31.01.26"},
        {u"date:full locale:de-DE", "Samstag, 31. Januar 2026"},
        {u"date:full locale:ja_JP", "2026年1月31日土曜日"},
        {u"date:long locale:ar_EG", "٣١ يناير ٢٠٢٦"},
        {u"date:yyyy-MM-dd locale:ar_EG", "٢٠٢٦-٠١-٣١"},
        {u"date:full locale:", "Saturday, January 31, 2026"},
        {u"date:", ""},
        {u"date:yyyy locale:\"no such: thing\"", "2026"},
        {u"date:yyyy locale:" + std::u16string(10'000, u'x'), "2026"},
        {u"time:\"h 'o''clock'\" locale:en_US", "10 o'clock"},
        {u"time:yyyy-MM-dd", "2026-01-31"},
    };
    for (const auto& [body, text] : cases) EXPECT_EQ(value(body), text) << toUtf8(body);
    EXPECT_EQ(SnippetDateVariable().value(environmentAt(Now)), u"");
    EXPECT_EQ(SnippetTimeVariable().value(environmentAt(Now)), u"");
}

TEST(SnippetDateTimeVariable, TakesLocaleAndTimeZoneFromTheEnvironment) {
    EXPECT_EQ(value(u"date:MMMM", environmentAt(Now, "UTC", "fr_FR")), "janvier");
    EXPECT_EQ(value(u"date:MMMM locale:de_DE", environmentAt(Now, "UTC", "fr_FR")), "Januar");
    EXPECT_EQ(value(u"time:HH", environmentAt(Now, "America/New_York")), "05");
    EXPECT_EQ(value(u"time:HH", environmentAt(Now, "Asia/Tokyo")), "19");
    EXPECT_EQ(value(u"date:yyyy", environmentAt(Now, "Middle/Earth")), "2026");
}

TEST(SnippetDateTimeVariable, ReportsAPatternWithoutMeaningOnce) {
    ContentEnvironment environment = environmentAt(Now);
    int reports = 0;
    environment.report = [&](const std::string&) { ++reports; };
    for (int i = 0; i < 3; ++i) EXPECT_EQ(value(u"date:Ein_j", environment), "");
    EXPECT_EQ(reports, 1);
}

TEST(SnippetDateTimeVariable, StaysRightWithMoreFormatsThanAreKept) {
    for (int i = 0; i < 100; ++i) {
        const std::string literal = std::to_string(i % 50);
        EXPECT_EQ(value(fromUtf8("date:'" + literal + "'dd")), literal + "31");
    }
}

TEST(SnippetDateTimeVariable, MayBeUsedFromSeveralThreads) {
    const auto variable = read(u"date:full day:1 locale:de_DE");
    std::u16string first;
    std::thread other([&] { first = variable->value(environmentAt(Now)); });
    const std::u16string second = variable->value(environmentAt(Now));
    other.join();
    EXPECT_EQ(first, u"Sonntag, 1. Februar 2026");
    EXPECT_EQ(second, first);
}

TEST(SnippetDateVariable, CountsAsTheCalendarAndTheClocksOfThePlaceDo) {
    const Date leapDay = sys_days(2024y / 2 / 29) + 23h;
    const struct {
        const char* timeZone;
        std::u16string offsets;
        Date now;
        Date result;
    } cases[] = {
        {"UTC", u"", Now, Now},
        {"UTC", u"day:-31", Now, sys_days(2025y / 12 / 31)},
        {"UTC", u"month:1", Now, sys_days(2026y / 3 / 3)},
        {"UTC", u"month:1 day:-3", Now, sys_days(2026y / 2 / 28)},
        {"UTC", u"day:1 weekday:4", Now, sys_days(2026y / 2 / 1)},
        {"UTC", u"year:-326", Now, sys_days(1700y / 1 / 31)},
        {"UTC", u"year:1", leapDay, sys_days(2025y / 3 / 1)},
        {"UTC", u"year:-1 month:12", leapDay, sys_days(2024y / 2 / 29)},
        // Weekdays past Saturday count from Sunday again.
        {"UTC", u"valueType:1 weekday:7", Now, sys_days(2026y / 2 / 1)},
        {"UTC", u"valueType:2 weekday:-1", Now, sys_days(2026y / 1 / 24)},
        // Over a change of clocks and back over one.
        {"Europe/Berlin", u"day:2", sys_days(2026y / 3 / 28) + 11h, sys_days(2026y / 3 / 29) + 22h},
        {"Europe/Berlin", u"day:-1", sys_days(2026y / 10 / 26) + 11h, sys_days(2026y / 10 / 24) + 22h},
        {"America/New_York", u"valueType:1 weekday:1", sys_days(2026y / 10 / 31) + 16h, sys_days(2026y / 11 / 2) + 5h},
        {"America/New_York", u"month:6", sys_days(2026y / 1 / 15) + 16h, sys_days(2026y / 7 / 15) + 4h},
        // Today is not yet today in UTC.
        {"America/New_York", u"day:1", sys_days(2026y / 6 / 2) + 2h, sys_days(2026y / 6 / 2) + 4h},
        // A midnight that does not exist, and one that comes twice.
        {"America/Sao_Paulo", u"day:1", sys_days(2017y / 10 / 14) + 15h, sys_days(2017y / 10 / 15) + 3h},
        {"America/Havana", u"day:1", sys_days(2017y / 11 / 4) + 15h, sys_days(2017y / 11 / 5) + 4h},
    };
    for (const auto& c : cases) {
        const auto variable = read(u"date:short " + c.offsets);
        EXPECT_EQ(variable->date(environmentAt(c.now, c.timeZone)), c.result) << c.timeZone << " " << toUtf8(c.offsets);
    }
}

// Walks from day to day until the weekday is there.
sys_days nearest(sys_days today, std::chrono::weekday weekday, std::chrono::days step) {
    sys_days day = today + step;
    while (std::chrono::weekday(day) != weekday) day += step;
    return day;
}

TEST(SnippetDateVariable, FindsTheNextAndThePreviousWeekday) {
    for (int pair = 0; pair < 49; ++pair) {
        const sys_days today = sys_days(2026y / 2 / 24) + std::chrono::days(pair / 7);
        const std::chrono::weekday wanted(static_cast<unsigned>(pair % 7));
        SnippetDateVariable variable;
        variable.weekday = pair % 7;
        for (const int type : {1, 2, -5}) {
            variable.valueType = static_cast<SnippetDateVariable::ValueType>(type);
            const std::chrono::days step(type == 1 ? 1 : -1);
            EXPECT_EQ(variable.date(environmentAt(today + 13h)), nearest(today, wanted, step)) << pair << " " << type;
        }
    }
}

TEST(SnippetTimeVariable, ShiftsTheWallClockAlone) {
    const struct {
        std::u16string offsets;
        const char* text;
    } cases[] = {
        {u"hour:14", "00:05:09"},           {u"hour:-11", "23:05:09"},
        {u"second:51", "10:06:00"},         {u"minute:-1500", "09:05:09"},
        {u"hour:1 minute:-60", "10:05:09"}, {u"hour:9223372036854775807", "17:05:09"},  // 7 more than whole days
    };
    for (const auto& [offsets, text] : cases) {
        EXPECT_EQ(value(u"time:\"HH:mm:ss\" " + offsets), text) << toUtf8(offsets);
    }
    // 01:30 on the morning when the clocks go from 2 to 3: another day's clock is shown, which has a half past two.
    const ContentEnvironment spring = environmentAt(sys_days(2026y / 3 / 29) + 30min, "Europe/Berlin");
    EXPECT_EQ(value(u"time:\"HH:mm\" hour:1", spring), "02:30");
    EXPECT_EQ(value(u"time:\"HH:mm\"", spring), "01:30");
    EXPECT_NE(value(u"time:yyyy-MM-dd hour:1", spring), "2026-03-29");
}

TEST(SnippetDateTimeVariable, TakesOffsetsOfAnySize) {
    for (const std::int64_t offset : {Most, Least}) {
        SnippetTimeVariable time;
        time.format = u"HH:mm:ss";
        time.hour = time.minute = time.second = offset;
        EXPECT_EQ(time.value(environmentAt(Now)).size(), 8U);

        SnippetDateVariable weekday;
        weekday.valueType = SnippetDateVariable::ValueType::NextWeekday;
        weekday.weekday = offset;
        const Date next = weekday.date(environmentAt(Now));
        EXPECT_TRUE(next > Now && next <= Now + std::chrono::days(7));

        for (auto component : {&SnippetDateVariable::year, &SnippetDateVariable::month, &SnippetDateVariable::day}) {
            SnippetDateVariable variable;
            variable.*component = offset;
            const Date date = variable.date(environmentAt(Now));
            EXPECT_TRUE(offset > 0 ? date > Now + std::chrono::years(40'000) : date < Now - std::chrono::years(40'000));
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

}  // namespace
}  // namespace plume
