#include "Foundation/Strings.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <algorithm>
#include <limits>

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

struct EncodingCase {
    std::u16string text;
    std::string bytes;
};

TEST(StringsTest, ConvertsBothWays) {
    const EncodingCase cases[] = {
        {u"", ""},
        {u"a~\u007F", "a~\x7F"},
        {u"\u0080\u00E9\u07FF", "\xC2\x80\xC3\xA9\xDF\xBF"},
        {u"\u0800\u20AC\uFFFF", "\xE0\xA0\x80\xE2\x82\xAC\xEF\xBF\xBF"},
        {u"\U00010000\U0001F600\U0010FFFF", "\xF0\x90\x80\x80\xF0\x9F\x98\x80\xF4\x8F\xBF\xBF"},
        {std::u16string(u"a\0b", 3), std::string("a\0b", 3)},
    };
    for (const EncodingCase& c : cases) {
        EXPECT_EQ(toUtf8(c.text), c.bytes);
        EXPECT_EQ(fromUtf8(c.bytes), c.text);
        EXPECT_EQ(fromStrictUtf8(c.bytes), c.text);
    }
}

TEST(StringsTest, WritesUnpairedSurrogatesAsReplacementCharacters) {
    EXPECT_EQ(toUtf8(u"a\xD83Dz"), "a\xEF\xBF\xBDz");
    EXPECT_EQ(toUtf8(u"\xDE00\xD83D"), "\xEF\xBF\xBD\xEF\xBF\xBD");
}

TEST(StringsTest, ReadsMalformedBytesAsReplacementCharactersOnlyWhenLenient) {
    const EncodingCase cases[] = {
        {u"a\uFFFD", "a\x80"},  // a continuation without a start
        {u"\uFFFDa",
         "\xC3"
         "a"},                                              // cut short by another character
        {u"a\uFFFD", "a\xF0\x9F\x98"},                      // cut short by the end
        {u"\uFFFD\uFFFD", "\xC0\x80"},                      // longer than needed
        {u"\uFFFD\uFFFD\uFFFD", "\xED\xA0\xBD"},            // a surrogate
        {u"\uFFFD\uFFFD\uFFFD\uFFFD", "\xF4\x90\x80\x80"},  // beyond the last code point
        {u"\uFFFD\uFFFD", "\xFF\xFE"},
    };
    for (const EncodingCase& c : cases) {
        EXPECT_EQ(fromUtf8(c.bytes), c.text);
        EXPECT_EQ(fromStrictUtf8(c.bytes), std::nullopt);
    }
}

// ---- Case ----

struct CaseMappingCase {
    std::u16string text;
    std::u16string lower;
    std::u16string upper;
};

TEST(StringsTest, MapsCaseInFullWithoutALocale) {
    const CaseMappingCase cases[] = {
        {u"", u"", u""},
        {u"Hello, World 12", u"hello, world 12", u"HELLO, WORLD 12"},
        {u"Stra\u00DFe", u"stra\u00DFe", u"STRASSE"},
        {u"\uFB03x", u"\uFB03x", u"FFIX"},
        {u"\u0130I\u0131", u"i\u0307i\u0131", u"\u0130II"},
        {u"\u039F\u0394\u039F\u03A3 \u03A3", u"\u03BF\u03B4\u03BF\u03C2 \u03C3", u"\u039F\u0394\u039F\u03A3 \u03A3"},
        {u"\u01C5", u"\u01C6", u"\u01C4"},
        {u"\U00010400\U00010429", u"\U00010428\U00010429", u"\U00010400\U00010401"},
        {u"\xD801z\xDC00", u"\xD801z\xDC00", u"\xD801Z\xDC00"},
        {u"\u0390\u0390\u0390", u"\u0390\u0390\u0390", u"\u0399\u0308\u0301\u0399\u0308\u0301\u0399\u0308\u0301"},
    };
    for (const CaseMappingCase& c : cases) {
        EXPECT_EQ(lowercased(c.text), c.lower);
        EXPECT_EQ(uppercased(c.text), c.upper);
    }
}

TEST(StringsTest, FoldsUnitForUnit) {
    EXPECT_EQ(folded(u"AbC\u00C9\u00DF"), u"abc\u00E9\u00DF");
    EXPECT_EQ(folded(u"\u1E9E"), u"\u00DF");
    EXPECT_EQ(folded(u"\u03A3\u03C2\u03C3"), u"\u03C3\u03C3\u03C3");
    EXPECT_EQ(folded(u"\u0130\u0131"), u"\u0130\u0131");
    EXPECT_EQ(folded(u"\u212A\u00B5"), u"k\u03BC");
    EXPECT_EQ(folded(u"\U00010400\U0001E900"), u"\U00010428\U0001E922");
    EXPECT_EQ(folded(u"\xD801\xD801\xDC00\xDC00"), u"\xD801\xD801\xDC28\xDC00");
}

TEST(StringsTest, FoldingOneCodePointNeverChangesHowManyUnitsItTakes) {
    for (char32_t c = 0; c <= 0x10FFFF; ++c) {
        const char32_t result = foldedCodePoint(c);
        ASSERT_EQ(result > 0xFFFF, c > 0xFFFF) << std::hex << static_cast<std::uint32_t>(c);
        ASSERT_EQ(foldedCodePoint(result), result) << std::hex << static_cast<std::uint32_t>(c);
    }
}

RC_GTEST_PROP(StringsProperty, FoldingKeepsLengthAndIsDoneOnce, ()) {
    const std::u16string text = arbitraryText();
    const std::u16string once = folded(text);
    RC_ASSERT(once.size() == text.size());
    RC_ASSERT(folded(once) == once);
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
    const std::u16string ascending[] = {
        u"",
        u" ",
        u"-5",
        u"0",
        u"1",
        u"1.2",
        u"1.10",
        u"1a",
        u"2",
        u"10",
        u"99999999999999999999998",
        u"99999999999999999999999",
        u"100000000000000000000000",
        u"A",
        u"a1",
        u"A2",
        u"a2b",
        u"a10",
        u"B",
        u"b\u00E9",
        u"C",
    };
    for (std::size_t i = 0; i < std::size(ascending); ++i) {
        for (std::size_t j = 0; j < std::size(ascending); ++j) {
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

struct SearchCase {
    std::u16string text;
    std::u16string pattern;
    std::size_t from;
    std::size_t position;
};

TEST(StringsTest, FindsIgnoringCase) {
    const SearchCase cases[] = {
        {u"Hello hello", u"HELLO", 0, 0},
        {u"Hello hello", u"HELLO", 1, 6},
        {u"Hello hello", u"hello", 6, 6},
        {u"Hello hello", u"hello", 7, NotFound},
        {u"Hello", u"", 0, NotFound},
        {u"", u"a", 0, NotFound},
        {u"abc", u"abcd", 0, NotFound},
        {u"abc", u"c", 3, NotFound},
        {u"abc", u"c", 99, NotFound},
        {u"abc", u"c", NotFound, NotFound},
        {u"aaab", u"AAB", 0, 1},
        {u"STRASSE", u"stra\u00DFe", 0, NotFound},
        {u"\u0130x", u"X", 0, 1},
        {u"x\U00010400y\U00010428", u"\U00010428", 0, 1},
        {u"x\U00010400y\U00010428", u"\U00010400", 2, 4},
        {u"\xDC00\xD801", u"\U00010428", 0, NotFound},
    };
    for (const SearchCase& c : cases) {
        EXPECT_EQ(findIgnoringCase(c.text, c.pattern, c.from), c.position)
            << toUtf8(c.pattern) << " in " << toUtf8(c.text) << " from " << c.from;
    }
}

RC_GTEST_PROP(StringsProperty, FindingIgnoringCaseIsFindingInTheFoldedText, ()) {
    const std::u16string text = arbitraryText();
    const std::size_t start = *rc::gen::inRange<std::size_t>(0, text.size() + 1);
    const std::size_t length = *rc::gen::inRange<std::size_t>(0, text.size() - start + 1);
    const std::size_t from = *rc::gen::inRange<std::size_t>(0, text.size() + 2);
    const std::u16string pattern = folded(text.substr(start, length));
    const std::size_t expected = pattern.empty() ? NotFound : folded(text).find(folded(pattern), from);
    RC_ASSERT(findIgnoringCase(text, pattern, from) == expected);
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
    EXPECT_THAT(split(u"abc", u','), ElementsAre(u"abc"));
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

struct IntegerCase {
    std::u16string text;
    std::int64_t value;
};

TEST(StringsTest, ReadsTheWholeNumberATextStartsWith) {
    constexpr std::int64_t Most = std::numeric_limits<std::int64_t>::max();
    constexpr std::int64_t Least = std::numeric_limits<std::int64_t>::min();
    const IntegerCase cases[] = {
        {u"", 0},
        {u"12", 12},
        {u" \t\n+7x9", 7},
        {u"-3.9", -3},
        {u"--3", 0},
        {u"- 3", 0},
        {u"x1", 0},
        {u"0012", 12},
        {u"\u0661", 0},
        {u"9223372036854775807", Most},
        {u"9223372036854775808", Most},
        {u"-9223372036854775808", Least},
        {u"-9223372036854775809", Least},
        {u"123456789012345678901234567890", Most},
    };
    for (const IntegerCase& c : cases) EXPECT_EQ(integerValue(c.text), c.value) << toUtf8(c.text);
}

}  // namespace
}  // namespace plume
