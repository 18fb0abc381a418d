#include "app/ranking/NormalisedText.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include "Foundation/Strings.h"
#include "app/ranking/SnippetRanking.h"
#include "tests/app/ranking/RankingSupport.h"

namespace plume {

TEST(NormalisedTextTest, MakesAlikeWhatPeopleTypeAlike) {
    const struct {
        std::u16string_view text;
        std::u16string_view form;
    } cases[] = {
        {u"", u""},
        {u"Plain TEXT 12", u"plain text 12"},
        {u"Grüße", u"grusse"},
        {u"Gru\u0308\u1E9Ee", u"grusse"},
        {u"\uFB01nd o\uFB03ce", u"find office"},
        {u"\u00C5ngstr\u00F6m \u212Bngstr\u00F6m", u"angstrom angstrom"},
        {u"\uFF21\uFF22 \u2460 x\u00B2", u"ab 1 x2"},
        {u"\u03A3\u03AF\u03C3\u03C5\u03C6\u03BF\u03C2", u"\u03C3\u03B9\u03C3\u03C5\u03C6\u03BF\u03C3"},
        {u"\u2764\uFE0F \U0001F600", u"\u2764 \U0001F600"},
        {u"\U0001D400\U0001D401", u"ab"},
        {u"\u0130stanbul", u"istanbul"},
        {u"\u0439\u043E\u0434", u"\u0438\u043E\u0434"},
        {u"a\u00A0b", u"a b"},
        {u"\u0301", u""},
    };
    for (const auto& [text, form] : cases) {
        EXPECT_EQ(toUtf8(normalised(text)), toUtf8(form)) << toUtf8(text);
        EXPECT_EQ(toUtf8(tracedText(text).field.units), toUtf8(form)) << toUtf8(text);
    }
    const std::u16string unpaired{u'a', 0xD83D, u'B', 0xDE00};
    EXPECT_EQ(normalised(unpaired), (std::u16string{u'a', 0xD83D, u'b', 0xDE00}));
}

TEST(NormalisedTextTest, KnowsWhereWordsAndTheirPartsStart) {
    EXPECT_EQ(normalisedField(u";getFileName v12 a_b").starts,
              std::string("\x8\x8\0\0\x7\0\0\0\x7\0\0\0\0\x8\x7\0\0\x8\0\x8", 20));
    EXPECT_EQ(normalisedField(u"\u00DFa \u00C4b").starts, std::string("\x8\0\0\0\x8\0", 6));
}

RC_GTEST_PROP(NormalisedTextTest, FindsWhatANaiveSearchFinds, ()) {
    const std::u16string text = *randomText(60);
    const std::u16string pattern =
        *randomText(2) + *rc::gen::elementOf(std::vector<std::u16string>{u"a", u"b ", u"ss"});
    const auto from = *rc::gen::inRange<std::size_t>(0, 70);
    const std::size_t found = std::u16string_view(text).find(pattern, from);
    RC_ASSERT(findUnits(text, pattern, from) == (found == std::u16string::npos ? NotFound : found));
}

RC_GTEST_PROP(NormalisedTextTest, TakesCharactersOneByOne, ()) {
    const std::u16string one = *randomText(20);
    const std::u16string other = *randomText(20);
    RC_ASSERT(normalised(one + other) == normalised(one) + normalised(other));
}

TEST(NormalisedTextTest, MakesAlikeAllThatIsAlikeIgnoringCase) {
    for (char32_t c = 0x80; c <= 0x10FFFF; ++c) {
        if (foldedCodePoint(c) == c) continue;
        const auto textOf = [](char32_t each) {
            if (each < 0x10000) return std::u16string(1, static_cast<char16_t>(each));
            const char32_t above = each - 0x10000;
            return std::u16string{static_cast<char16_t>(0xD800 + (above >> 10)),
                                  static_cast<char16_t>(0xDC00 + (above & 0x3FF))};
        };
        EXPECT_EQ(normalised(textOf(c)), normalised(textOf(foldedCodePoint(c)))) << static_cast<std::uint32_t>(c);
    }
}

TEST(HighlightsTest, MarkWhatIsFoundAsItIsShown) {
    const struct {
        std::u16string_view text;
        std::u16string_view query;
        bool isLoose;
        std::vector<Range> marked;
    } cases[] = {
        {u"Kind regards", u"reg", false, {{5, 3}}},
        {u"Kind regards", u"D", false, {{3, 1}, {10, 1}}},
        {u"Kind regards", u"regards kind", false, {{0, 4}, {5, 7}}},
        {u"abcd", u"bc ab", false, {{0, 3}}},
        {u"aaaa", u"aa", false, {{0, 4}}},
        {u"o\uFB03ce", u"fi", false, {{1, 1}}},
        {u"Stra\u00DFe", u"s", false, {{0, 1}, {4, 1}}},
        {u"cafe\u0301s", u"cafe", false, {{0, 5}}},
        {u"caf\u00E9s", u"cafe", false, {{0, 4}}},
        {u"x \U0001F600 y", u"\U0001F600", false, {{2, 2}}},
        {u"\U0001D400\U0001D401", u"b", false, {{2, 2}}},
        {u"Kind regards", u"krg", false, {}},
        {u"Kind regards", u"krg", true, {{0, 1}, {5, 1}, {7, 1}}},
        {u"My signature", u"signatrue", true, {{3, 9}}},
        {u"Kind regards", u"", false, {}},
        {u"Kind regards", u" \u0301 ", false, {}},
        {u"", u"a", true, {}},
    };
    for (const auto& [text, query, isLoose, marked] : cases) {
        EXPECT_EQ(highlights(text, query, {}, isLoose), marked) << toUtf8(text) << ", " << toUtf8(query);
    }
}

TEST(HighlightsTest, OfWildcardsMarkWhatIsWrittenOut) {
    const SearchRule wild{.isWildcard = true};
    EXPECT_EQ(highlights(u"Kind regards", u"k*reg?rds", wild, false), (std::vector<Range>{{0, 1}, {5, 3}, {9, 3}}));
    EXPECT_EQ(highlights(u"abcabc", u"*bc", wild, false), (std::vector<Range>{{4, 2}}));
    EXPECT_EQ(highlights(u"other", u"k*", wild, false), std::vector<Range>{});
    EXPECT_EQ(highlights(u"a*c", u"a*c", {}, false), (std::vector<Range>{{0, 3}}));
}

RC_GTEST_PROP(HighlightsTest, StandInOrderWithinTheText, ()) {
    const std::u16string text = *randomText(30);
    const std::u16string query = *randomText(4);
    const SearchRule rule{.isWildcard = *rc::gen::arbitrary<bool>()};
    std::size_t end = 0;
    bool isFirst = true;
    for (const Range& range : highlights(text, query, rule, *rc::gen::arbitrary<bool>())) {
        RC_ASSERT(range.length > 0U);
        RC_ASSERT(isFirst || range.location > end);
        end = range.end();
        isFirst = false;
    }
    RC_ASSERT(end <= text.size());
}

}  // namespace plume
