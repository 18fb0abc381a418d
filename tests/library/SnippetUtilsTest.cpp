#include "library/SnippetUtils.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <string>

#include "Foundation/Strings.h"
#include "tests/library/LibrarySupport.h"

namespace plume {
namespace {

using test::snippet;

struct Typed {
    const char16_t* text;
    std::int64_t flags;
    std::int64_t expected;
};

TEST(SnippetUtilsCase, ClassesOfTypedAbbreviations) {
    const Typed cases[] = {
        {u"sig", 0, 3},
        {u"Sig", 0, 1},
        {u"SIG", 0, 2},
        {u"SIg", 0, 2},
        {u"sIG", 0, 4},
        {u"sIg", 0, 0},
        {u"sIg", 1, 4},
        {u"sIg", 2, 0},  // only bit 0 counts
        {u"sIg", 3, 4},
        {u"sIG", 1, 4},
        {u"S", 0, 1},
        {u"s", 0, 3},
        {u"12", 0, 0},
        {u"12", 1, 0},
        {u"", 0, 0},
        {u";sig1", 0, 3},  // only letters count
        {u"1;Sig", 0, 1},
        {u"s-I-g!", 0, 0},
        {u"éÉ", 0, 4},
        {u"ǅ", 0, 1},   // title case is not lower case
        {u"中", 0, 1},  // nor is a letter without case
        {u"中文", 0, 2},
        {u"\U00010428", 0, 3},  // letters beyond the basic plane
        {u"\U00010400\U00010428", 0, 1},
        {u"\xd801s", 0, 3},  // an unpaired surrogate is no letter
    };
    for (const Typed& c : cases) {
        EXPECT_EQ(SnippetUtils::caseOf(c.text, c.flags), static_cast<CaseClass>(c.expected))
            << toUtf8(c.text) << " with flags " << c.flags;
    }
}

struct Corrected {
    const char16_t* typed;
    const char16_t* content;
    const char16_t* expected;
};

TEST(SnippetUtilsCase, ContentsFollowTheTypedAbbreviation) {
    const Corrected cases[] = {
        {u"Sig", u"hello world", u"Hello world"},
        {u"SIG", u"hello world", u"HELLO WORLD"},
        {u"sIG", u"hello world", u"Hello World"},
        {u"sig", u"hello World", u"hello World"},
        {u"sIg", u"hello World", u"hello World"},
        {u"12", u"hello World", u"hello World"},
        {u"Sig", u"", u""},
        {u"SIG", u"", u""},
        {u"sIG", u"", u""},
        {u"Sig", u"(note)", u"(note)"},
        {u"Sig", u"ßa ß", u"SSa ß"},
        {u"Sig", u"\U00010428\U00010428", u"\U00010400\U00010428"},
        {u"Sig", u"\xdc28x", u"\xdc28x"},
        {u"SIG", u"straße", u"STRASSE"},
        {u"sIG", u"o'neil's dog", u"O'Neil'S Dog"},
        {u"sIG", u"ßa ße bc 9d eF", u"SSa SSe Bc 9D EF"},
        {u"sIG", u"\U00010428\U00010428 \U00010428", u"\U00010400\U00010428 \U00010400"},
        {u"sIG", u"e\u0301te\u0301 ǆa", u"E\u0301te\u0301 Ǆa"},
        {u"sIG", u"\u0301a", u"\u0301a"},  // a combining mark is a letter, so the word has begun
        {u"sIG",
         u"\xd801"
         u"a",
         u"\xd801"
         u"A"},
    };
    for (const Corrected& c : cases) {
        EXPECT_EQ(toUtf8(SnippetUtils::correctedCase(std::u16string_view(c.content), c.typed, 0)), toUtf8(c.expected))
            << toUtf8(c.typed);
        const AttributedString attributed(c.content, test::bold());
        EXPECT_EQ(SnippetUtils::correctedCase(attributed, c.typed, 0), AttributedString(c.expected, test::bold()))
            << toUtf8(c.typed);
    }
}

TEST(SnippetUtilsCase, FlagsDecideOnMixtures) {
    const std::u16string_view content = u"hello world";
    EXPECT_EQ(SnippetUtils::correctedCase(content, u"sIg", SnippetUtils::MixedCaseCapitalisesWords), u"Hello World");
}

AttributedString inTwoRuns(std::u16string_view plain, std::u16string_view bold) {
    AttributedString text{std::u16string(plain)};
    text.append(bold, test::bold());
    return text;
}

TEST(SnippetUtilsCase, AttributesStayWithTheirCharacters) {
    struct Case {
        const char16_t* typed;
        AttributedString content;
        AttributedString expected;
    };
    const Case cases[] = {
        {u"Sig", inTwoRuns(u"ß", u"ab"), inTwoRuns(u"SS", u"ab")},
        {u"SIG", inTwoRuns(u"ß", u"ab"), inTwoRuns(u"SS", u"AB")},
        {u"sIG", inTwoRuns(u"ß ß", u"ab ß"), inTwoRuns(u"SS SS", u"ab SS")},  // a word across the border
        {u"sIG", inTwoRuns(u"a ", u"bc"), inTwoRuns(u"A ", u"Bc")},
        {u"sIG", inTwoRuns(u"\xd801", u"\xdc28 a"), inTwoRuns(u"\xd801\xdc00", u" A")},  // a pair across the border
    };
    for (const Case& c : cases) {
        EXPECT_EQ(SnippetUtils::correctedCase(c.content, c.typed, 0), c.expected) << toUtf8(c.expected.string());
    }
}

RC_GTEST_PROP(SnippetUtilsCase, PlainAndAttributedContentsAreCorrectedAlike, ()) {
    const auto units = rc::gen::element(u'a', u'B', u' ', u'ß', u'\'', u'\xd801', u'\xdc28', u'\x0301', u'1');
    const auto content = *rc::gen::container<std::u16string>(units);
    const auto border = *rc::gen::inRange<std::size_t>(0, content.size() + 1);
    const std::u16string typed = *rc::gen::element<std::u16string>(u"Sig", u"sIG", u"sig");
    const AttributedString attributed = inTwoRuns(content.substr(0, border), content.substr(border));
    RC_ASSERT(SnippetUtils::correctedCase(attributed, typed, 0).string() ==
              SnippetUtils::correctedCase(content, typed, 0));
}

class SnippetUtilsLookup : public testing::Test {
  protected:
    SnippetUtilsLookup() {
        prefixed->setAbbreviationPrefix(u";");
        emptyPrefix->setAbbreviationPrefix(u"");
        prefixed->addItems({std::make_shared<Snippet>(), prefixedAd});
        emptyPrefix->addItems({ad, secondAd});
        plain->addItems({plainAd, literal});
    }

    std::shared_ptr<SnippetGroup> prefixed = SnippetGroup::make();
    std::shared_ptr<SnippetGroup> emptyPrefix = SnippetGroup::make();
    std::shared_ptr<SnippetGroup> plain = SnippetGroup::make();
    std::shared_ptr<Snippet> prefixedAd = snippet(u"ad");
    std::shared_ptr<Snippet> ad = snippet(u"ad");
    std::shared_ptr<Snippet> secondAd = snippet(u"ad");
    std::shared_ptr<Snippet> plainAd = snippet(u"Ad");
    std::shared_ptr<Snippet> literal = snippet(u";ad");
    SnippetUtils::Groups groups{prefixed, emptyPrefix, plain};
};

TEST_F(SnippetUtilsLookup, FindsByAbbreviationWithAndWithoutPrefix) {
    struct Case {
        const char16_t* abbreviation;
        std::shared_ptr<Snippet> withoutPrefix;
        std::shared_ptr<Snippet> withPrefix;
    };
    const Case cases[] = {
        {u"ad", prefixedAd, ad},  {u";ad", literal, prefixedAd}, {u"Ad", plainAd, plainAd},   {u"AD", nullptr, nullptr},
        {u";", nullptr, nullptr}, {u"", nullptr, nullptr},       {u";add", nullptr, nullptr},
    };
    for (const Case& c : cases) {
        EXPECT_EQ(SnippetUtils::findSnippetByAbbreviation(c.abbreviation, groups), c.withoutPrefix)
            << toUtf8(c.abbreviation);
        EXPECT_EQ(SnippetUtils::findSnippetByAbbreviation(c.abbreviation, groups, false), c.withoutPrefix)
            << toUtf8(c.abbreviation);
        EXPECT_EQ(SnippetUtils::findSnippetByAbbreviation(c.abbreviation, groups, true), c.withPrefix)
            << toUtf8(c.abbreviation);
    }
}

TEST_F(SnippetUtilsLookup, APrefixAloneFindsAnEmptyAbbreviation) {
    const auto empty = snippet(u"");
    prefixed->addItem(empty);
    EXPECT_EQ(SnippetUtils::findSnippetByAbbreviation(u";", groups, true), empty);
    EXPECT_EQ(SnippetUtils::findSnippetByAbbreviation(u"", groups, false), empty);
}

TEST_F(SnippetUtilsLookup, FindsByUuidInEitherCase) {
    const std::u16string uuid = plainAd->uuid()->toString();
    EXPECT_EQ(SnippetUtils::findSnippetByUUID(uuid, groups), plainAd);
    EXPECT_EQ(SnippetUtils::findSnippetByUUID(lowercased(uuid), groups), plainAd);
    EXPECT_EQ(SnippetUtils::findSnippetByUUID(Uuid::random().toString(), groups), nullptr);
    EXPECT_EQ(SnippetUtils::findSnippetByUUID(u"not a uuid", groups), nullptr);
    EXPECT_EQ(SnippetUtils::findSnippetByUUID(u"", groups), nullptr);
}

TEST_F(SnippetUtilsLookup, GivesTheGroupOfWhatItFoundOnly) {
    std::shared_ptr<SnippetGroup> group;
    SnippetUtils::findSnippetByAbbreviation(u"Ad", groups, &group);
    EXPECT_EQ(group, plain);
    SnippetUtils::findSnippetByAbbreviation(u";ad", groups, true, &group);
    EXPECT_EQ(group, prefixed);
    SnippetUtils::findSnippetByUUID(secondAd->uuid()->toString(), groups, &group);
    EXPECT_EQ(group, emptyPrefix);
    SnippetUtils::findSnippetByAbbreviation(u"nowhere", groups, &group);
    EXPECT_EQ(group, emptyPrefix);
}

}  // namespace
}  // namespace plume
