#include "app/ranking/FuzzyScore.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <algorithm>

#include "Foundation/Strings.h"
#include "app/ranking/NormalisedText.h"
#include "app/ranking/TermFit.h"
#include "tests/app/ranking/RankingSupport.h"

namespace plume {

namespace {

int scoreIn(std::u16string_view text, std::u16string_view term) {
    const NormalisedField field = normalisedField(text);
    return fuzzyScore({field.units, field.starts}, term);
}

// Slips by trying all of them, from both ends of what is left.
std::size_t naiveSlips(std::u16string_view one, std::u16string_view other) {
    if (one.empty() || other.empty()) return one.size() + other.size();
    std::size_t fewest = std::min(naiveSlips(one.substr(1), other), naiveSlips(one, other.substr(1))) + 1;
    fewest = std::min(fewest, naiveSlips(one.substr(1), other.substr(1)) + (one[0] == other[0] ? 0 : 1));
    if (one.size() < 2 || other.size() < 2 || one[0] != other[1] || one[1] != other[0]) return fewest;
    return std::min(fewest, naiveSlips(one.substr(2), other.substr(2)) + 1);
}

}  // namespace

TEST(FuzzyScoreTest, CountsLettersStartsOfWordsAndGaps) {
    const struct {
        std::u16string_view text;
        std::u16string_view term;
        int score;
    } cases[] = {
        {u"f", u"f", 16 + 2 * 8},
        {u"of", u"f", 16},
        {u"foo", u"foo", 16 + 2 * 8 + 2 * (16 + 8)},
        {u"afoo", u"foo", 16 + 2 * (16 + 4)},
        {u"foo bar", u"fb", 16 + 2 * 8 - 3 - 1 - 1 + 16 + 8},
        {u"fooBar", u"fb", 16 + 2 * 8 - 3 - 1 + 16 + 7},
        {u"foo bar", u"oba", 16 - 3 + 2 * (16 + 8)},
        {u"v12", u"12", 16 + 2 * 7 + 16 + 7},
        {u"xaxb ab", u"ab", 16 + 2 * 8 + 16 + 8},
        {u"foo", u"of", 0},
        {u"", u"f", 0},
        {u"foo", u"", 0},
    };
    for (const auto& [text, term, score] : cases) {
        EXPECT_EQ(scoreIn(text, term), score) << toUtf8(text) << ", " << toUtf8(term);
    }
}

TEST(FuzzyScoreTest, TellsWhereTheLettersAre) {
    const NormalisedField field = normalisedField(u"xaxb a-b");
    std::vector<std::size_t> places;
    EXPECT_GT(fuzzyScore({field.units, field.starts}, u"ab", &places), 0);
    EXPECT_EQ(places, (std::vector<std::size_t>{5, 7}));
}

RC_GTEST_PROP(SlipsTest, AreTheFewestThereAre, ()) {
    const auto word = [] {
        std::u16string units;
        const int length = *rc::gen::inRange(0, 7);
        for (int i = 0; i < length; ++i) units += *rc::gen::element(u'a', u'b', u'c');
        return units;
    };
    const std::u16string one = word();
    const std::u16string other = word();
    for (const std::size_t most : {1U, 2U}) {
        RC_ASSERT(slipsBetween(one, other, most) == std::min<std::size_t>(naiveSlips(one, other), most + 1));
    }
}

}  // namespace plume
