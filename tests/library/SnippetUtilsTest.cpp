#include "library/SnippetUtils.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <map>
#include <string>
#include <tuple>
#include <vector>

#include "Foundation/Strings.h"
#include "tests/library/LibrarySupport.h"

namespace plume {
namespace {

using test::snippet;

TEST(SnippetUtilsCase, ClassifiesTypedAbbreviations) {
    const std::map<CaseClass, std::vector<std::u16string>> cases = {
        {CaseClass::Unspecific, {u"", u"12", u"sIg", u"s-I-g!"}},
        // Title case is not lower case, nor is a letter without case; there are letters beyond the basic plane.
        {CaseClass::Capitalised, {u"S", u"Sig", u"1;Sig", u"ǅ", u"中", u"\U00010400\U00010428"}},
        {CaseClass::UpperCase, {u"SIG", u"SIg", u"中文"}},
        // An unpaired surrogate is no letter.
        {CaseClass::LowerCase, {u"s", u"sig", u";sig1", u"\U00010428", u"\xd801s"}},
        {CaseClass::CapitaliseWords, {u"sIG", u"éÉ"}},
    };
    for (const auto& [expected, texts] : cases) {
        for (const auto& text : texts) EXPECT_EQ(SnippetUtils::caseOf(text, 0), expected) << toUtf8(text);
    }
    // Only bit 0 of the flags counts, and only for mixtures.
    EXPECT_EQ(SnippetUtils::caseOf(u"sIg", 2), CaseClass::Unspecific);
    EXPECT_EQ(SnippetUtils::caseOf(u"sIg", 3), CaseClass::CapitaliseWords);
    EXPECT_EQ(SnippetUtils::caseOf(u"sIG", 1), CaseClass::CapitaliseWords);
    EXPECT_EQ(SnippetUtils::caseOf(u"12", 1), CaseClass::Unspecific);
}

TEST(SnippetUtilsCase, ContentsFollowTheTypedAbbreviation) {
    const struct {
        const char16_t* typed;
        const char16_t* content;
        const char16_t* expected;
    } cases[] = {
        {u"Sig", u"hello world", u"Hello world"},
        {u"SIG", u"hello world", u"HELLO WORLD"},
        {u"sIG", u"hello world", u"Hello World"},
        {u"sig", u"hello World", u"hello World"},
        {u"12", u"hello World", u"hello World"},
        {u"Sig", u"", u""},
        {u"sIG", u"", u""},
        {u"Sig", u"(note)", u"(note)"},
        {u"Sig", u"ßa ß", u"SSa ß"},
        {u"Sig", u"\xdc28x", u"\xdc28x"},
        {u"SIG", u"straße", u"STRASSE"},
        {u"sIG", u"o'neil's dog", u"O'Neil'S Dog"},
        {u"sIG", u"ßa ße bc 9d eF", u"SSa SSe Bc 9D EF"},
        {u"sIG", u"\U00010428\U00010428 \U00010428", u"\U00010400\U00010428 \U00010400"},
        {u"sIG", u"e\u0301te\u0301 ǆa", u"E\u0301te\u0301 Ǆa"},
        {u"sIG", u"\u0301a", u"\u0301a"},  // a combining mark is a letter, so the word has begun
        {u"sIG", u"\xd801z", u"\xd801Z"},
    };
    const std::int64_t words = SnippetUtils::MixedCaseCapitalisesWords;
    EXPECT_EQ(SnippetUtils::correctedCase(std::u16string_view(u"hello world"), u"sIg", words), u"Hello World");
    for (const auto& c : cases) {
        EXPECT_EQ(toUtf8(SnippetUtils::correctedCase(std::u16string_view(c.content), c.typed, 0)), toUtf8(c.expected))
            << toUtf8(c.typed);
        const AttributedString attributed(c.content, test::bold());
        EXPECT_EQ(SnippetUtils::correctedCase(attributed, c.typed, 0), AttributedString(c.expected, test::bold()))
            << toUtf8(c.typed);
    }
}

AttributedString inTwoRuns(std::u16string_view plain, std::u16string_view bold) {
    AttributedString text{std::u16string(plain)};
    text.append(bold, test::bold());
    return text;
}

TEST(SnippetUtilsCase, AttributesStayWithTheirCharacters) {
    const std::tuple<const char16_t*, AttributedString, AttributedString> cases[] = {
        {u"Sig", inTwoRuns(u"ß", u"ab"), inTwoRuns(u"SS", u"ab")},
        {u"SIG", inTwoRuns(u"ß", u"ab"), inTwoRuns(u"SS", u"AB")},
        {u"sIG", inTwoRuns(u"ß ß", u"ab ß"), inTwoRuns(u"SS SS", u"ab SS")},  // a word across the border
        {u"sIG", inTwoRuns(u"a ", u"bc"), inTwoRuns(u"A ", u"Bc")},
        {u"sIG", inTwoRuns(u"\xd801", u"\xdc28 a"), inTwoRuns(u"\xd801\xdc00", u" A")},  // a pair across the border
    };
    for (const auto& [typed, content, expected] : cases) {
        EXPECT_EQ(SnippetUtils::correctedCase(content, typed, 0), expected) << toUtf8(expected.string());
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
        prefixed->addItems({std::make_shared<Snippet>(), prefixedAd, nameless});
        emptyPrefix->addItems({ad, secondAd});
        plain->addItems({plainAd, literal});
    }

    std::shared_ptr<SnippetGroup> prefixed = SnippetGroup::make();
    std::shared_ptr<SnippetGroup> emptyPrefix = SnippetGroup::make();
    std::shared_ptr<SnippetGroup> plain = SnippetGroup::make();
    std::shared_ptr<Snippet> prefixedAd = snippet(u"ad");
    std::shared_ptr<Snippet> nameless = snippet(u"");
    std::shared_ptr<Snippet> ad = snippet(u"ad");
    std::shared_ptr<Snippet> secondAd = snippet(u"ad");
    std::shared_ptr<Snippet> plainAd = snippet(u"Ad");
    std::shared_ptr<Snippet> literal = snippet(u";ad");
    SnippetUtils::Groups groups{prefixed, emptyPrefix, plain};
};

TEST_F(SnippetUtilsLookup, FindsByAbbreviationWithAndWithoutPrefix) {
    const std::tuple<const char16_t*, std::shared_ptr<Snippet>, std::shared_ptr<Snippet>> cases[] = {
        {u"ad", prefixedAd, ad},  {u";ad", literal, prefixedAd}, {u"Ad", plainAd, plainAd},   {u"AD", nullptr, nullptr},
        {u"", nameless, nullptr}, {u";", nullptr, nameless},     {u";add", nullptr, nullptr},
    };
    for (const auto& [text, withoutPrefix, withPrefix] : cases) {
        EXPECT_EQ(SnippetUtils::findSnippetByAbbreviation(text, groups), withoutPrefix) << toUtf8(text);
        EXPECT_EQ(SnippetUtils::findSnippetByAbbreviation(text, groups, true), withPrefix) << toUtf8(text);
    }
}

TEST_F(SnippetUtilsLookup, FindsByUuidInEitherCase) {
    const std::u16string uuid = plainAd->uuid()->toString();
    EXPECT_EQ(SnippetUtils::findSnippetByUUID(uuid, groups), plainAd);
    EXPECT_EQ(SnippetUtils::findSnippetByUUID(lowercased(uuid), groups), plainAd);
    EXPECT_EQ(SnippetUtils::findSnippetByUUID(Uuid::random().toString(), groups), nullptr);
    EXPECT_EQ(SnippetUtils::findSnippetByUUID(u"not a uuid", groups), nullptr);
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
