#include "app/status/MenuTexts.h"

#include <gtest/gtest.h>

#include "app/qt/Text.h"
#include "library/SnippetGroup.h"

namespace plume {
namespace {

std::string line(std::u16string_view text, qsizetype limit = 50) {
    return harmlessLine(text, limit).toStdString();
}

TEST(MenuTexts, ALineIsTheFirstThatHoldsSomething) {
    EXPECT_EQ(line(u""), "");
    EXPECT_EQ(line(u" \n\t\r\n  Dear   Sir,\tgood day  \nsecond"), "Dear Sir, good day");
    EXPECT_EQ(line(u"one\u2028two"), "one");
    EXPECT_EQ(line(u"\uFFFC\n\uFFFC"), "");
    EXPECT_EQ(line(u"\uFFFCa\uFFFCb"), "a b");
}

TEST(MenuTexts, NothingInALineChangesTheMenu) {
    EXPECT_EQ(line(std::u16string_view(u"a\0b\u0007c\u001B[0m", 9)), "a b c [0m");
    EXPECT_EQ(line(u"\u202Eevil\u2066x\u200E\uFEFF"), "evilx");
    EXPECT_EQ(line(std::u16string{u'a', u'\xD800', u'b', u'\xDC00'}), "a\uFFFDb\uFFFD");
    EXPECT_EQ(line(u"\uFFFE\uFFFF"), "\uFFFD\uFFFD");
    // Joiners and tags belong to what they join.
    EXPECT_EQ(line(u"\U0001F469\u200D\U0001F4BB"), "\U0001F469\u200D\U0001F4BB");
}

TEST(MenuTexts, ALongLineIsElidedBetweenCharacters) {
    EXPECT_EQ(line(std::u16string(50, u'x')), std::string(50, 'x'));
    EXPECT_EQ(line(std::u16string(51, u'x')), std::string(50, 'x') + "…");
    EXPECT_EQ(line(u"ab cd", 3), "ab…");
    EXPECT_EQ(line(u"\U0001F469\u200D\U0001F4BB\U0001F469\u200D\U0001F4BBx", 2),
              "\U0001F469\u200D\U0001F4BB\U0001F469\u200D\U0001F4BB…");
    // One character without an end.
    EXPECT_LT(harmlessLine(u"a" + std::u16string(100'000, u'\u0301'), 50).size(), 500);
    EXPECT_LT(harmlessLine(std::u16string(1'000'000, u'y'), 50).size(), 60);
}

std::string lineOf(const Snippet::Text& abbreviation, const Snippet::Text& label, const Snippet::Text& content) {
    Snippet snippet(abbreviation, content);
    snippet.setLabel(label);
    return snippetLine(snippet).toStdString();
}

TEST(MenuTexts, ASnippetIsShownByWhatItHas) {
    EXPECT_EQ(lineOf(u"br", u"Best regards", u"content"), "br — Best regards");
    EXPECT_EQ(lineOf(u"br", {}, u"\n%1 %2\nmore"), "br — %1 %2");
    EXPECT_EQ(lineOf(u"%2", {}, u"%1"), "%2 — %1");
    EXPECT_EQ(lineOf(u"br", u"\n", {}), "br");
    EXPECT_EQ(lineOf({}, {}, u"content"), "content");
    EXPECT_EQ(lineOf({}, {}, {}), "Empty snippet");
    const auto group = SnippetGroup::make();
    group->setAbbreviationPrefix(u";");
    group->addItem(std::make_shared<Snippet>(u"br", u"text"));
    EXPECT_EQ(snippetLine(*group->items().front()).toStdString(), ";br — text");
    EXPECT_EQ(snippetName(*group->items().front()).toStdString(), ";br");
}

TEST(MenuTexts, MarksOfMenusAreWrittenSoThatTheyAreRead) {
    const auto widget = [](const char* text) {
        return asMenuText(QLatin1String(text), MenuHome::Widget).toStdString();
    };
    const auto bus = [](const char* text) { return asMenuText(QLatin1String(text), MenuHome::Bus).toStdString(); };
    EXPECT_EQ(widget("R&D_x & Co"), "R&&D_x && Co");
    // The first "&" of each is "_" when it is sent.
    EXPECT_EQ(bus("R&D & Co"), "R&&D & Co");
    EXPECT_EQ(bus("_a_"), "&_a__");
    EXPECT_EQ(bus("a_b & c"), "a&_b & c");
    EXPECT_EQ(bus("R&D_x"), "R&&D x");
}

}  // namespace
}  // namespace plume
