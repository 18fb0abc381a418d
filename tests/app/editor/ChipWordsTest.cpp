// What chips say, at a fixed moment.
#include "app/editor/ChipWords.h"

#include <gtest/gtest.h>

#include <QLocale>
#include <string>

#include "app/qt/Text.h"
#include "content/DateFormatters.h"

namespace plume {
namespace {

TEST(ChipWords, EveryKindIsToldWithItsParameters) {
    struct Row {
        std::u16string body;
        const char* words;
    };
    const Row rows[] = {
        {u"date:yyyy-MM-dd", "Date: today, 2026-11-21"},
        {u"date:yyyy-MM-dd day:7", "Date: today + 1 week, 2026-11-28"},
        {u"date:yyyy-MM-dd year:1 month:-2 day:3", "Date: today + 1 year − 2 months + 3 days, 2027-09-24"},
        {u"date:yyyy-MM-dd valueType:1 weekday:1", "Date: next Monday, 2026-11-23"},
        {u"date:yyyy-MM-dd valueType:2 weekday:0", "Date: previous Sunday, 2026-11-15"},
        {u"date:yyyy day:-9223372036854775807 optional:1", nullptr},
        {u"time:\"HH:mm\"", "Time: 10:00"},
        {u"time:\"HH:mm\" hour:-1 minute:90", "Time: now − 1 hour + 90 minutes, 10:30"},
        {u"clipboard", "Clipboard"},
        {u"clipboard find:a replacement:b flags:0", "Clipboard: a → b"},
        {u"clipboard find:a flags:0", "Clipboard: without a"},
        {u"snippet:;sig", "Snippet: ;sig"},
        {u"snippet:;sig optional:0", "Snippet: ;sig (optional)"},
        {u"field", "Field"},
        {u"field:Name", "Field: Name"},
        {u"field:\"a\nb\" type:1 optional:1", "Text area: a b (optional, ticked)"},
        {u"field:Size type:2", "Menu: Size"},
        {u"field:Count type:3", "Number: Count"},
        {u"key:\u21E5 code:48", "Key: \u21E5"},
        {u"key:k code:40 modifiers:1179648 count:3 delay:0.5", "Key: Shift+Super+k × 3, after 0.5 s"},
        {u"key:\u25C0 code:123", "\u25C0"},
        {u"\u25B6", "\u25B6"},
        {u"|", "Caret"},
        {u"|more", "|more"},
        {u"nothing", ""},
    };
    QLocale::setDefault(QLocale::c());
    ContentEnvironment environment;
    environment.timeZone = "UTC";
    environment.locale = "en_US";
    environment.now = [] { return dateFromMilliseconds(1795255200000.0); };  // 21 November 2026, 10:00
    for (const Row& row : rows) {
        const std::string words = chipWords(row.body, environment).toStdString();
        if (row.words != nullptr) {
            EXPECT_EQ(words, row.words) << toQString(row.body).toStdString();
        }
        EXPECT_EQ(words.find('\n'), std::string::npos);
    }
    EXPECT_LE(chipWords(u"field:" + std::u16string(5000, u'x'), environment).size(), 80);
}

}  // namespace
}  // namespace plume
