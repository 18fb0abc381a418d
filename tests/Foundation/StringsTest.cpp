#include "Foundation/Strings.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <algorithm>
#include <limits>
#include <utility>

namespace plume {
namespace {

using testing::ElementsAre;

// Any units at all, half of them from where pairs, case and digits are.
std::u16string arbitraryText() {
    const auto unit =
        rc::gen::oneOf(rc::gen::inRange<int>(0, 0x10000), rc::gen::inRange<int>(0, 0x250),
                       rc::gen::element<int>(0xD801, 0xDC00, 0xDC28, 0xD83A, 0xDD00, 'a', 'A', '1', '0', 0x661));
    const auto units = *rc::gen::container<std::vector<int>>(unit);
    std::u16string text;
    for (const int value : units) text += static_cast<char16_t>(value);
    return text;
}

// ---- Encoding ----

TEST(StringsTest, ConvertsToUtf8AndBack) {
    const struct {
        std::u16string text;
        std::string bytes;
    } cases[] = {
        {u"", ""},
        {u"a~\u007F", "a~\x7F"},
        {u"\u0080\u00E9\u07FF", "\xC2\x80\xC3\xA9\xDF\xBF"},
        {u"\u0800\u20AC\uFFFF", "\xE0\xA0\x80\xE2\x82\xAC\xEF\xBF\xBF"},
        {u"\U00010000\U0001F600\U0010FFFF", "\xF0\x90\x80\x80\xF0\x9F\x98\x80\xF4\x8F\xBF\xBF"},
        {std::u16string(u"a\0b", 3), std::string("a\0b", 3)},
    };
    for (const auto& [text, bytes] : cases) {
        EXPECT_EQ(toUtf8(text), bytes);
        EXPECT_EQ(fromUtf8(bytes), text);
        EXPECT_EQ(fromStrictUtf8(bytes), text);
    }
    EXPECT_EQ(toUtf8(u"a\xD83Dz\xDE00\xD83D"), "a\xEF\xBF\xBDz\xEF\xBF\xBD\xEF\xBF\xBD");
}

TEST(StringsTest, ReadsMalformedBytesAsReplacementCharactersOnlyWhenLenient) {
    const struct {
        const char* bytes;
        const char16_t* text;
    } cases[] = {
        {"a\x80", u"a\uFFFD"},                              // a continuation without a start
        {"\xC3z", u"\uFFFDz"},                              // cut short by another character
        {"a\xF0\x9F\x98", u"a\uFFFD"},                      // cut short by the end
        {"\xC0\x80", u"\uFFFD\uFFFD"},                      // longer than needed
        {"\xED\xA0\xBD", u"\uFFFD\uFFFD\uFFFD"},            // a surrogate
        {"\xF4\x90\x80\x80", u"\uFFFD\uFFFD\uFFFD\uFFFD"},  // beyond the last code point
    };
    for (const auto& [bytes, text] : cases) {
        EXPECT_EQ(fromUtf8(bytes), text);
        EXPECT_EQ(fromStrictUtf8(bytes), std::nullopt);
    }
}

// ---- Case ----

TEST(StringsTest, MapsCaseInFullWithoutALocaleAndFoldsUnitForUnit) {
    const struct {
        std::u16string text;
        std::u16string lower;
        std::u16string upper;
        std::u16string folded;
    } cases[] = {
        {u"", u"", u"", u""},
        {u"Hello, 12", u"hello, 12", u"HELLO, 12", u"hello, 12"},
        {u"Stra\u00DFe\u1E9E", u"stra\u00DFe\u00DF", u"STRASSE\u1E9E", u"stra\u00DFe\u00DF"},
        {u"\u0130I\u0131", u"i\u0307i\u0131", u"\u0130II", u"\u0130i\u0131"},
        {u"\u039F\u03A3 \u03A3", u"\u03BF\u03C2 \u03C3", u"\u039F\u03A3 \u03A3", u"\u03BF\u03C3 \u03C3"},
        {u"\u01C5\u212A", u"\u01C6k", u"\u01C4\u212A", u"\u01C6k"},
        {u"\U00010400\U00010429", u"\U00010428\U00010429", u"\U00010400\U00010401", u"\U00010428\U00010429"},
        {u"\xD801z\xDC00", u"\xD801z\xDC00", u"\xD801Z\xDC00", u"\xD801z\xDC00"},
        {u"\xD801\xD801\xDC00\xDC00", u"\xD801\xD801\xDC28\xDC00", u"\xD801\xD801\xDC00\xDC00",
         u"\xD801\xD801\xDC28\xDC00"},
        {u"\u0390\u0390", u"\u0390\u0390", u"\u0399\u0308\u0301\u0399\u0308\u0301", u"\u0390\u0390"},
    };
    for (const auto& c : cases) {
        EXPECT_EQ(lowercased(c.text), c.lower);
        EXPECT_EQ(uppercased(c.text), c.upper);
        EXPECT_EQ(folded(c.text), c.folded);
    }
}

TEST(StringsTest, FoldingOneCodePointNeverChangesHowManyUnitsItTakes) {
    for (char32_t c = 0; c <= 0x10FFFF; ++c) {
        const char32_t result = foldedCodePoint(c);
        ASSERT_EQ(result > 0xFFFF, c > 0xFFFF) << std::hex << static_cast<std::uint32_t>(c);
        ASSERT_EQ(foldedCodePoint(result), result) << std::hex << static_cast<std::uint32_t>(c);
    }
}

// ---- Comparison ----

RC_GTEST_PROP(StringsProperty, IgnoringCaseIsComparingFoldedTexts, ()) {
    const std::u16string a = arbitraryText();
    const std::u16string b = *rc::gen::oneOf(rc::gen::exec(arbitraryText), rc::gen::just(a), rc::gen::just(folded(a)));
    RC_ASSERT(equalsIgnoringCase(a, b) == (folded(a) == folded(b)));
    const int order = folded(a).compare(folded(b));
    const int result = compareIgnoringCase(a, b);
    RC_ASSERT((result < 0) == (order < 0));
    RC_ASSERT((result > 0) == (order > 0));
}

TEST(StringsTest, OrdersNaturally) {
    // Each of these stands before the next one.
    const std::vector<std::u16string> ascending = split(
        u"| |-5|0|1|1.2|1.10|1a|2|10|99999999999999999999998|99999999999999999999999|100000000000000000000000"
        u"|A|a1|A2|a2b|a10|B|b\u00E9|C",
        u'|');
    for (std::size_t i = 0; i < ascending.size(); ++i) {
        for (std::size_t j = 0; j < ascending.size(); ++j) {
            const int result = compareNaturally(ascending[i], ascending[j]);
            EXPECT_EQ(result < 0, i < j) << toUtf8(ascending[i]) << " and " << toUtf8(ascending[j]);
            EXPECT_EQ(result > 0, i > j) << toUtf8(ascending[i]) << " and " << toUtf8(ascending[j]);
        }
    }
}

TEST(StringsTest, NaturalOrderReadsNumbersInAnyScript) {
    EXPECT_LT(compareNaturally(u"a2", u"a\u0661\u0660"), 0);       // Arabic-Indic 10
    EXPECT_GT(compareNaturally(u"a\U0001D7D1", u"a2"), 0);         // mathematical bold 3
    EXPECT_EQ(compareNaturally(u"x\U0001D7CF\uFF12", u"x12"), 0);  // bold 1, full-width 2
    EXPECT_EQ(compareNaturally(u"a007b", u"A7B"), 0);
    EXPECT_EQ(compareNaturally(u"000", u"0"), 0);
    EXPECT_LT(compareNaturally(u"a0", u"a00b"), 0);
}

RC_GTEST_PROP(StringsProperty, NaturalOrderIsOneThatSortingCanRelyOn, ()) {
    const std::u16string a = arbitraryText();
    const std::u16string b = arbitraryText();
    const std::u16string c = arbitraryText();
    RC_ASSERT(compareNaturally(a, a) == 0);
    RC_ASSERT(compareNaturally(a, b) == -compareNaturally(b, a));
    if (compareNaturally(a, b) <= 0 && compareNaturally(b, c) <= 0) RC_ASSERT(compareNaturally(a, c) <= 0);
}

// ---- Search ----

RC_GTEST_PROP(StringsProperty, FindingIgnoringCaseIsFindingInTheFoldedText, ()) {
    const std::u16string text = arbitraryText();
    const std::size_t start = *rc::gen::inRange<std::size_t>(0, text.size() + 1);
    const std::size_t length = *rc::gen::inRange<std::size_t>(0, text.size() - start + 1);
    const std::size_t from = *rc::gen::inRange<std::size_t>(0, text.size() + 2);
    const std::u16string piece = text.substr(start, length);
    const std::u16string pattern = *rc::gen::element(piece, folded(piece), piece + u"a");
    const std::size_t expected = pattern.empty() ? NotFound : folded(text).find(folded(pattern), from);
    RC_ASSERT(findIgnoringCase(text, pattern, from) == expected);
    RC_ASSERT(findIgnoringCase(text, pattern, NotFound) == NotFound);
}

TEST(StringsTest, ListsOccurrencesWithoutOverlap) {
    EXPECT_THAT(rangesOfString(u"aaaaa", u"aa", false), ElementsAre(Range{0, 2}, Range{2, 2}));
    EXPECT_THAT(rangesOfString(u"abAB", u"ab", false), ElementsAre(Range{0, 2}));
    EXPECT_THAT(rangesOfString(u"abAB", u"aB", true), ElementsAre(Range{0, 2}, Range{2, 2}));
    EXPECT_TRUE(rangesOfString(u"abc", u"", true).empty());
    EXPECT_TRUE(rangesOfString(u"", u"a", false).empty());
}

// ---- Pieces ----

TEST(StringsTest, Splits) {
    EXPECT_THAT(split(u"", u','), ElementsAre(u""));
    EXPECT_THAT(split(u",a,,b,", u','), ElementsAre(u"", u"a", u"", u"b", u""));
}

TEST(StringsTest, TrimsWhiteSpaceAndNewlinesAtBothEnds) {
    EXPECT_EQ(trimmed(u" \t\r\n\v\f\u0085\u00A0\u2028\u2029\u3000a b\u2003\n"), u"a b");
    EXPECT_EQ(trimmed(u"\u200Ba\x1F"), u"\u200Ba\x1F");
    EXPECT_EQ(trimmed(u" \n "), u"");
    EXPECT_EQ(trimmed(u""), u"");
}

TEST(StringsTest, ReplacesAll) {
    EXPECT_EQ(replacingAll(u"a.b.c", u".", u""), u"abc");
    EXPECT_EQ(replacingAll(u"aaa", u"aa", u"a"), u"aa");
    EXPECT_EQ(replacingAll(u"aXbx", u"x", u"xx"), u"aXbxx");
    EXPECT_EQ(replacingAll(u"abc", u"", u"!"), u"abc");
}

TEST(StringsTest, ReadsTheWholeNumberATextStartsWith) {
    constexpr std::int64_t Most = std::numeric_limits<std::int64_t>::max();
    constexpr std::int64_t Least = std::numeric_limits<std::int64_t>::min();
    const std::pair<std::u16string, std::int64_t> cases[] = {
        {u"", 0},
        {u"0012", 12},
        {u" \t\n+7x9", 7},
        {u"-3.9", -3},
        {u"--3", 0},
        {u"- 3", 0},
        {u"x1", 0},
        {u"\u0661", 0},
        {u"9223372036854775807", Most},
        {u"9223372036854775808", Most},
        {u"-9223372036854775808", Least},
        {u"-9223372036854775809", Least},
    };
    for (const auto& [text, value] : cases) EXPECT_EQ(integerValue(text), value) << toUtf8(text);
}

}  // namespace
}  // namespace plume
