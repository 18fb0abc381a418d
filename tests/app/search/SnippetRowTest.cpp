#include "app/search/SnippetRow.h"

#include <gtest/gtest.h>

#include "app/FirstLine.h"
#include "app/qt/Text.h"

namespace plume {
namespace {

TEST(SnippetRow, TextsStandInOneLineUnitForUnit) {
    const struct {
        std::u16string text;
        std::u16string line;
    } cases[] = {
        {u"", u""},
        {u"a\nb\r\nc", u"a b  c"},
        {u"a\tb\u2028c\u2029d\u0085e\u007Ff", u"a b c d e f"},
        {std::u16string(u"a\0b", 3), u"a b"},
        {u"\U0001F600\u00A0x", u"\U0001F600\u00A0x"},
        {{u'\xD83D', u'a'}, {u'\xD83D', u'a'}},
    };
    for (const auto& each : cases) EXPECT_EQ(fromQString(inOneLine(each.text)), each.line);
    EXPECT_EQ(inOneLine(firstLine(u"\n a\tb \n c")), QStringLiteral("a b\u2009…"));
}

TEST(SnippetRow, ShortcutsAreNamedAsTheyArePressed) {
    EXPECT_EQ(digitShortcut(u'1', 0), QStringLiteral("1"));
    EXPECT_EQ(digitShortcut(u'2', 1), QStringLiteral("Shift+2"));
    EXPECT_EQ(digitShortcut(u'3', 2), QStringLiteral("Ctrl+3"));
    EXPECT_EQ(digitShortcut(u'4', 3), QStringLiteral("Alt+4"));
    EXPECT_EQ(digitShortcut(u'0', 4), QStringLiteral("Super+0"));
    for (const std::int64_t unknown : {-1, 5, 99}) EXPECT_EQ(digitShortcut(u'1', unknown), QString());
    EXPECT_EQ(digitShortcut(u'\0', 2), QString());
}

TEST(SnippetRow, IsSpokenWithoutEmptyParts) {
    SnippetRow row;
    EXPECT_EQ(row.spoken(), QString());
    row.abbreviation = {QStringLiteral(";sig"), {}};
    row.content = {QStringLiteral("Kind regards"), {}};
    row.shortcut = QStringLiteral("Alt+1");
    EXPECT_EQ(row.spoken(), QStringLiteral(";sig, Kind regards, Alt+1"));
}

}  // namespace
}  // namespace plume
