#include "Foundation/CharacterSet.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <optional>
#include <set>
#include <vector>

#include "Foundation/Strings.h"

namespace plume {
namespace {

template <typename Character>
std::string setsThatHold(Character character) {
    const struct {
        const CharacterSet& set;
        const char* name;
    } sets[] = {
        {CharacterSet::letters(), "letter "},         {CharacterSet::lowercaseLetters(), "lower "},
        {CharacterSet::uppercaseLetters(), "upper "}, {CharacterSet::alphanumerics(), "alphanumeric "},
        {CharacterSet::decimalDigits(), "digit "},    {CharacterSet::whitespaces(), "white "},
        {CharacterSet::newlines(), "newline "},       {CharacterSet::whitespacesAndNewlines(), "blank "},
    };
    std::string names;
    for (const auto& [set, name] : sets) names += set.contains(character) ? name : "";
    return names;
}

TEST(CharacterSetTest, StandardSetsFollowTheGeneralCategories) {
    const struct {
        std::u32string characters;
        const char* sets;
    } cases[] = {
        {U"a\u00DF\U00010428", "letter lower alphanumeric "},
        {U"A\u01C5\U00010400", "letter upper alphanumeric "},
        {U"\u02B0\u00AA\u0301\u20DD\u093E\u4E00", "letter alphanumeric "},  // modifiers, marks, letters without case
        {U"7\u0663\U0001D7CE", "alphanumeric digit "},
        {U"\u00B2\u2163", "alphanumeric "},
        {U" \t\u00A0", "white blank "},
        {U"\n\v\f\r\u0085\u2028\u2029", "newline blank "},
        {U"\u200B\u000E._\U0001F600\xD800\xDFFF", ""},
    };
    for (const auto& c : cases) {
        for (const char32_t character : c.characters) {
            EXPECT_EQ(setsThatHold(character), c.sets) << static_cast<std::uint32_t>(character);
        }
    }
}

TEST(CharacterSetTest, TakesASurrogatePairAsOneCharacter) {
    const CharacterSet set = CharacterSet::withCharacters(u"a\U0001F600\xD83Dz");
    EXPECT_TRUE(set.contains(U'\U0001F600'));
    EXPECT_TRUE(set.contains(char16_t{0xD83D}));  // the unpaired one
    EXPECT_FALSE(set.contains(char16_t{0xDE00}));
    EXPECT_FALSE(CharacterSet::withCharacters(u"\U0001F600").contains(char16_t{0xD83D}));
    EXPECT_EQ(CharacterSet::withCharacters(u"zb\U0001F600a\U00010000b").characters(), u"abz\U00010000\U0001F600");
}

TEST(CharacterSetTest, RangesIncludeBothEndsAndStopWhereCodePointsDo) {
    const CharacterSet set = CharacterSet::withRange(0xFFFE, 0x10001);
    EXPECT_EQ(set.characters(), u"\uFFFE\uFFFF\U00010000\U00010001");
    EXPECT_TRUE(CharacterSet::withRange(5, 4).isEmpty());
    EXPECT_TRUE(CharacterSet::withRange(0x110000, 0xFFFFFFFF).isEmpty());
    EXPECT_EQ(CharacterSet::withRange(0, 0xFFFFFFFF), CharacterSet().inverted());
    EXPECT_FALSE(CharacterSet().inverted().contains(char32_t{0x110000}));
    EXPECT_FALSE(CharacterSet().inverted().contains(char32_t{0xFFFFFFFF}));
}

TEST(CharacterSetTest, ASetThatWasMovedFromMayStillBeAsked) {
    std::optional<CharacterSet> first = CharacterSet::withCharacters(u"a");
    CharacterSet second = std::move(*first);
    second = CharacterSet::withCharacters(u"b");
    EXPECT_FALSE(first->contains(u'b'));
    EXPECT_TRUE(second.contains(u'b'));
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
    RC_ASSERT(holdsExactly(setOf(a).inverted().inverted(), a));
    RC_ASSERT(setOf(a).united(setOf(a).inverted()) == CharacterSet().inverted());
    for (const char32_t c : a) RC_ASSERT(!setOf(a).inverted().contains(c));
    RC_ASSERT(CharacterSet::withCharacters(setOf(a).characters()) == setOf(a));
}

}  // namespace
}  // namespace plume
