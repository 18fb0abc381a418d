#include "Foundation/CharacterSet.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <atomic>
#include <optional>
#include <set>
#include <thread>
#include <vector>

#include "Foundation/Strings.h"

namespace plume {
namespace {

struct Classes {
    const char* name;
    char32_t character;
    bool letter;
    bool lower;
    bool upper;
    bool alphanumeric;
    bool digit;
    bool whitespace;
    bool newline;
};

TEST(CharacterSetTest, StandardSetsFollowTheGeneralCategories) {
    const Classes cases[] = {
        {"small a", U'a', true, true, false, true, false, false, false},
        {"capital a", U'A', true, false, true, true, false, false, false},
        {"sharp s", U'\u00DF', true, true, false, true, false, false, false},
        {"title-case digraph", U'\u01C5', true, false, true, true, false, false, false},
        {"modifier letter small h", U'\u02B0', true, false, false, true, false, false, false},
        {"feminine ordinal", U'\u00AA', true, false, false, true, false, false, false},
        {"combining acute", U'\u0301', true, false, false, true, false, false, false},
        {"enclosing circle", U'\u20DD', true, false, false, true, false, false, false},
        {"Devanagari vowel sign", U'\u093E', true, false, false, true, false, false, false},
        {"Han one", U'\u4E00', true, false, false, true, false, false, false},
        {"deseret capital", U'\U00010400', true, false, true, true, false, false, false},
        {"deseret small", U'\U00010428', true, true, false, true, false, false, false},
        {"digit", U'7', false, false, false, true, true, false, false},
        {"Arabic-Indic digit", U'\u0663', false, false, false, true, true, false, false},
        {"mathematical bold digit", U'\U0001D7CE', false, false, false, true, true, false, false},
        {"superscript two", U'\u00B2', false, false, false, true, false, false, false},
        {"Roman numeral four", U'\u2163', false, false, false, true, false, false, false},
        {"space", U' ', false, false, false, false, false, true, false},
        {"tab", U'\t', false, false, false, false, false, true, false},
        {"no-break space", U'\u00A0', false, false, false, false, false, true, false},
        {"zero-width space", U'\u200B', false, false, false, false, false, false, false},
        {"line feed", U'\n', false, false, false, false, false, false, true},
        {"vertical tab", U'\v', false, false, false, false, false, false, true},
        {"carriage return", U'\r', false, false, false, false, false, false, true},
        {"next line", U'\u0085', false, false, false, false, false, false, true},
        {"line separator", U'\u2028', false, false, false, false, false, false, true},
        {"paragraph separator", U'\u2029', false, false, false, false, false, false, true},
        {"shift out", U'\u000E', false, false, false, false, false, false, false},
        {"full stop", U'.', false, false, false, false, false, false, false},
        {"low line", U'_', false, false, false, false, false, false, false},
        {"emoji", U'\U0001F600', false, false, false, false, false, false, false},
    };
    for (const Classes& c : cases) {
        EXPECT_EQ(CharacterSet::letters().contains(c.character), c.letter) << c.name;
        EXPECT_EQ(CharacterSet::lowercaseLetters().contains(c.character), c.lower) << c.name;
        EXPECT_EQ(CharacterSet::uppercaseLetters().contains(c.character), c.upper) << c.name;
        EXPECT_EQ(CharacterSet::alphanumerics().contains(c.character), c.alphanumeric) << c.name;
        EXPECT_EQ(CharacterSet::decimalDigits().contains(c.character), c.digit) << c.name;
        EXPECT_EQ(CharacterSet::whitespaces().contains(c.character), c.whitespace) << c.name;
        EXPECT_EQ(CharacterSet::newlines().contains(c.character), c.newline) << c.name;
        EXPECT_EQ(CharacterSet::whitespacesAndNewlines().contains(c.character), c.whitespace || c.newline) << c.name;
    }
}

TEST(CharacterSetTest, StandardSetsHoldNoSurrogates) {
    for (char32_t c = 0xD800; c < 0xE000; ++c) {
        ASSERT_FALSE(CharacterSet::alphanumerics().contains(static_cast<char16_t>(c)));
        ASSERT_FALSE(CharacterSet::whitespacesAndNewlines().contains(static_cast<char16_t>(c)));
    }
}

TEST(CharacterSetTest, TakesASurrogatePairAsOneCharacter) {
    const CharacterSet set = CharacterSet::withCharacters(u"a\U0001F600\xD83Dz");
    EXPECT_TRUE(set.contains(U'\U0001F600'));
    EXPECT_TRUE(set.contains(char16_t{0xD83D}));  // the unpaired one
    EXPECT_FALSE(set.contains(char16_t{0xDE00}));
    EXPECT_FALSE(set.contains(U'\U0001F601'));
    EXPECT_EQ(CharacterSet::withCharacters(u"\U0001F600").contains(char16_t{0xD83D}), false);
}

TEST(CharacterSetTest, RangesIncludeBothEndsAndCrossThePlanes) {
    const CharacterSet set = CharacterSet::withRange(0xFFFE, 0x10001);
    EXPECT_FALSE(set.contains(char16_t{0xFFFD}));
    EXPECT_TRUE(set.contains(char16_t{0xFFFE}));
    EXPECT_TRUE(set.contains(char16_t{0xFFFF}));
    EXPECT_TRUE(set.contains(char32_t{0x10001}));
    EXPECT_FALSE(set.contains(char32_t{0x10002}));
}

TEST(CharacterSetTest, OddRangesAndCodePointsAreHarmless) {
    EXPECT_TRUE(CharacterSet::withRange(5, 4).isEmpty());
    EXPECT_TRUE(CharacterSet::withRange(0x110000, 0xFFFFFFFF).isEmpty());
    EXPECT_EQ(CharacterSet::withRange(0, 0xFFFFFFFF), CharacterSet().inverted());
    EXPECT_FALSE(CharacterSet().inverted().contains(char32_t{0x110000}));
    EXPECT_FALSE(CharacterSet().inverted().contains(char32_t{0xFFFFFFFF}));
}

TEST(CharacterSetTest, ListsItsCharactersInOrder) {
    EXPECT_EQ(CharacterSet::withCharacters(u"zb\U0001F600a\U00010000b").characters(), u"abz\U00010000\U0001F600");
    EXPECT_EQ(CharacterSet().characters(), u"");
    EXPECT_EQ(CharacterSet::newlines().characters(), u"\n\v\f\r\u0085\u2028\u2029");
}

TEST(CharacterSetTest, ASetThatWasMovedFromMayStillBeAsked) {
    std::optional<CharacterSet> first = CharacterSet::withCharacters(u"a");
    CharacterSet second = std::move(*first);
    second = CharacterSet::withCharacters(u"b");
    EXPECT_FALSE(first->contains(u'b'));
    EXPECT_TRUE(second.contains(u'b'));
}

TEST(CharacterSetTest, StandardSetsMayBeBuiltFromSeveralThreadsAtOnce) {
    std::vector<std::thread> threads;
    std::atomic<int> right = 0;
    for (int i = 0; i < 4; ++i) {
        threads.emplace_back([&right] {
            if (CharacterSet::whitespacesAndNewlines().contains(u'\n') && CharacterSet::letters().contains(u'x'))
                ++right;
        });
    }
    for (std::thread& thread : threads) thread.join();
    EXPECT_EQ(right, 4);
}

// ---- Set algebra, against std::set ----

using Model = std::set<char32_t>;

// A few code points around the edges of the planes and of the bitmap's words, so that operands overlap.
Model arbitraryModel() {
    const auto codePoint = rc::gen::element<char32_t>(0, 1, 'a', 'b', 63, 64, 65, 0xD7FF, 0xE000, 0xFFFE, 0xFFFF,
                                                      0x10000, 0x10001, 0x1F600, 0x10FFFF);
    const auto codePoints = *rc::gen::container<std::vector<char32_t>>(codePoint);
    return Model(codePoints.begin(), codePoints.end());
}

CharacterSet setOf(const Model& model) {
    CharacterSet set;
    for (const char32_t c : model) set = set.united(CharacterSet::withRange(c, c));
    return set;
}

bool holdsExactly(const CharacterSet& set, const Model& model) {
    for (char32_t c = 0; c <= 0x10FFFF; c += c < 0x200 ? 1 : 0xFF) {
        if (set.contains(c) != model.contains(c)) return false;
    }
    for (const char32_t c : model) {
        if (!set.contains(c)) return false;
    }
    return set == setOf(model) && set.isEmpty() == model.empty();
}

RC_GTEST_PROP(CharacterSetProperty, AlgebraIsThatOfSets, ()) {
    const Model a = arbitraryModel();
    const Model b = arbitraryModel();
    Model either = a;
    either.insert(b.begin(), b.end());
    Model both;
    Model onlyFirst;
    for (const char32_t c : a) (b.contains(c) ? both : onlyFirst).insert(c);
    RC_ASSERT(holdsExactly(setOf(a).united(setOf(b)), either));
    RC_ASSERT(holdsExactly(setOf(a).intersected(setOf(b)), both));
    RC_ASSERT(holdsExactly(setOf(a).subtracting(setOf(b)), onlyFirst));
}

RC_GTEST_PROP(CharacterSetProperty, InvertingTwiceChangesNothing, ()) {
    const Model model = arbitraryModel();
    const CharacterSet set = setOf(model);
    const CharacterSet inverse = set.inverted();
    RC_ASSERT(inverse.inverted() == set);
    RC_ASSERT(set.intersected(inverse).isEmpty());
    for (const char32_t c : model) RC_ASSERT(!inverse.contains(c));
    RC_ASSERT(CharacterSet::withCharacters(set.characters()) == set);
}

}  // namespace
}  // namespace plume
