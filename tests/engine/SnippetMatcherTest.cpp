#include "engine/SnippetMatcher.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "tests/engine/MatcherSupport.h"

namespace plume {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;

struct RuleCase {
    const char* about;
    ExpandAfter expandAfter;
    ExpandTrigger expandTrigger;
    std::u16string prefix;
    std::u16string abbreviation;
    CaseSensitivity caseSensitivity;
    std::u16string before;    // the buffer before the key
    std::u16string key;       // the typed key, or the hot key
    std::u16string expected;  // the typed text of the match; empty for none
};

class MatchingRules : public ::testing::TestWithParam<RuleCase> {};

TEST_P(MatchingRules, AreHeld) {
    const RuleCase& rule = GetParam();
    const auto group = SnippetGroup::make();
    group->setExpandAfter(rule.expandAfter);
    group->setExpandTrigger(rule.expandTrigger);
    if (!rule.prefix.empty()) group->setAbbreviationPrefix(rule.prefix);
    const auto snippet = std::make_shared<Snippet>(rule.abbreviation, u"content");
    snippet->setCaseSensitivity(rule.caseSensitivity);
    group->addItem(snippet);

    SnippetMatcher matcher(testDelimiters());
    matcher.setSnippetGroups({group});
    const auto matches = typeKey(matcher, rule.before, rule.key);
    ASSERT_EQ(matches.size(), rule.expected.empty() ? 0U : 1U) << rule.about;
    if (!matches.empty()) {
        EXPECT_EQ(matches[0].first, snippet);
        EXPECT_EQ(matches[0].second, rule.expected) << rule.about;
    }
}

constexpr auto Exact = CaseSensitivity::CaseSensitive;
constexpr auto Ignore = CaseSensitivity::IgnoreCase;
constexpr auto Adapt = CaseSensitivity::IgnoreCaseAndAdapt;
constexpr auto Delimiter = ExpandAfter::Delimiter;
constexpr auto Whitespace = ExpandAfter::Whitespace;
constexpr auto Anything = ExpandAfter::Anything;
constexpr auto Digits = ExpandAfter::Digits;
constexpr auto AtOnce = ExpandTrigger::Immediately;
constexpr auto Kept = ExpandTrigger::DelimiterKept;
constexpr auto Swallowed = ExpandTrigger::DelimiterSwallowed;
constexpr auto Never = ExpandTrigger::Never;
constexpr auto AtHotKey = ExpandTrigger::HotKey;

INSTANTIATE_TEST_SUITE_P(
    Triggers, MatchingRules,
    ::testing::Values(RuleCase{"last letter", Delimiter, AtOnce, u"", u"sig", Exact, u"x si", u"g", u"sig"},
                      RuleCase{"not before the last", Delimiter, AtOnce, u"", u"sig", Exact, u"x s", u"i", u""},
                      RuleCase{"empty buffer", Delimiter, AtOnce, u"", u"s", Exact, u"", u"s", u"s"},
                      RuleCase{"whole buffer", Delimiter, AtOnce, u"", u"sig", Exact, u"si", u"g", u"sig"},
                      RuleCase{"two units in one key", Delimiter, AtOnce, u"", u"sig", Exact, u"s", u"ig", u"sig"},
                      RuleCase{"not at the hot key", Delimiter, AtOnce, u"", u"sig", Exact, u"sig", u"", u""},
                      RuleCase{"space", Delimiter, Kept, u"", u"sig", Exact, u"x sig", u" ", u"sig"},
                      RuleCase{"return", Delimiter, Swallowed, u"", u"sig", Exact, u"sig", u"\r", u"sig"},
                      RuleCase{"enter", Delimiter, Kept, u"", u"sig", Exact, u"sig", u"\x03", u"sig"},
                      RuleCase{"no delimiter", Delimiter, Kept, u"", u"sig", Exact, u"si", u"g", u""},
                      RuleCase{"line feed is none", Delimiter, Kept, u"", u"sig", Exact, u"sig", u"\n", u""},
                      RuleCase{"never", Delimiter, Never, u"", u"sig", Exact, u"si", u"g", u""},
                      RuleCase{"never, space", Delimiter, Never, u"", u"sig", Exact, u"sig", u" ", u""},
                      RuleCase{"never, hot key", Delimiter, Never, u"", u"sig", Exact, u"sig", u"", u""},
                      RuleCase{"hot key", Delimiter, AtHotKey, u"", u"sig", Exact, u"a sig", u"", u"sig"},
                      RuleCase{"hot key only", Delimiter, AtHotKey, u"", u"sig", Exact, u"si", u"g", u""},
                      RuleCase{"hot key, not space", Delimiter, AtHotKey, u"", u"sig", Exact, u"sig", u" ", u""},
                      RuleCase{"unknown trigger", Delimiter, static_cast<ExpandTrigger>(9), u"", u"sig", Exact, u"si",
                               u"g", u""}));

INSTANTIATE_TEST_SUITE_P(
    ExpandAfter, MatchingRules,
    ::testing::Values(
        RuleCase{"inside a word", Delimiter, AtOnce, u"", u"sig", Exact, u"xsi", u"g", u""},
        RuleCase{"after a bracket", Delimiter, AtOnce, u"", u"sig", Exact, u"(si", u"g", u"sig"},
        RuleCase{"after a line feed", Delimiter, AtOnce, u"", u"sig", Exact, u"a\nsi", u"g", u"sig"},
        RuleCase{"after an image", Delimiter, AtOnce, u"", u"sig", Exact, u"\xfffcsi", u"g", u"sig"},
        RuleCase{"digits after an image", Digits, AtOnce, u"", u"kg", Exact, u"\xfffck", u"g", u"kg"},
        RuleCase{"white space: bracket", Whitespace, AtOnce, u"", u"sig", Exact, u"(si", u"g", u""},
        RuleCase{"white space: tab", Whitespace, AtOnce, u"", u"sig", Exact, u"\tsi", u"g", u"sig"},
        RuleCase{"white space: line separator", Whitespace, AtOnce, u"", u"sig", Exact, u"\x2028si", u"g", u"sig"},
        RuleCase{"white space: start", Whitespace, AtOnce, u"", u"sig", Exact, u"si", u"g", u"sig"},
        RuleCase{"anything", Anything, AtOnce, u"", u"sig", Exact, u"xsi", u"g", u"sig"},
        RuleCase{"digits", Digits, AtOnce, u"", u"kg", Exact, u"5k", u"g", u"kg"},
        RuleCase{"digits after a space", Digits, AtOnce, u"", u"kg", Exact, u"a 12k", u"g", u"kg"},
        RuleCase{"digits after a delimiter", Digits, AtOnce, u"", u"kg", Exact, u"a-12k", u"g", u"kg"},
        RuleCase{"digits of another script", Digits, AtOnce, u"", u"kg", Exact, u"\u0663k", u"g", u"kg"},
        RuleCase{"no digits", Digits, AtOnce, u"", u"kg", Exact, u"xk", u"g", u""},
        RuleCase{"no digits but a space", Digits, AtOnce, u"", u"kg", Exact, u" k", u"g", u""},
        RuleCase{"digits in a word", Digits, AtOnce, u"", u"kg", Exact, u"a5k", u"g", u""},
        RuleCase{"digits at the start", Digits, AtOnce, u"", u"kg", Exact, u"k", u"g", u""},
        RuleCase{"unknown rule", static_cast<ExpandAfter>(7), AtOnce, u"", u"sig", Exact, u" si", u"g", u""},
        RuleCase{"unknown rule at the start", static_cast<ExpandAfter>(7), AtOnce, u"", u"sig", Exact, u"si", u"g",
                 u"sig"}));

INSTANTIATE_TEST_SUITE_P(
    Case, MatchingRules,
    ::testing::Values(RuleCase{"exact", Anything, AtOnce, u"", u"Sig", Exact, u"si", u"g", u""},
                      RuleCase{"ignored", Anything, AtOnce, u"", u"Sig", Ignore, u"si", u"g", u"sig"},
                      RuleCase{"adapted", Anything, AtOnce, u"", u"sig", Adapt, u"SI", u"G", u"SIG"},
                      RuleCase{"umlaut", Anything, AtOnce, u"", u"\u00fcb", Ignore, u"\u00dc", u"B", u"\u00dcB"},
                      RuleCase{"sigma", Anything, AtOnce, u"", u"\u03b1\u03c2", Ignore, u"\u0391", u"\u03a3",
                               u"\u0391\u03a3"},
                      RuleCase{"beyond the basic plane", Anything, AtOnce, u"", u"x\U00010428", Ignore, u"X",
                               u"\U00010400", u"X\U00010400"},
                      RuleCase{"exact with prefix", Anything, AtOnce, u"x;", u"Ad", Exact, u"x;A", u"d", u"x;Ad"},
                      RuleCase{"prefix not exact", Anything, AtOnce, u"x;", u"Ad", Exact, u"X;A", u"d", u""},
                      RuleCase{"prefix ignored", Anything, AtOnce, u"x;", u"Ad", Ignore, u"X;a", u"d", u"X;ad"}));

INSTANTIATE_TEST_SUITE_P(
    Prefix, MatchingRules,
    ::testing::Values(
        RuleCase{"prefix", Delimiter, AtOnce, u";", u"ad", Exact, u"x ;a", u"d", u";ad"},
        RuleCase{"prefix alone", Delimiter, AtOnce, u";", u"ad", Exact, u"", u";", u""},
        RuleCase{"without its prefix", Delimiter, AtOnce, u";", u"ad", Exact, u"a", u"d", u""},
        RuleCase{"a letter before it", Delimiter, AtOnce, u";", u"ad", Exact, u"a;a", u"d", u""},
        RuleCase{"anything before it", Anything, AtOnce, u";", u"ad", Exact, u"a;a", u"d", u";ad"},
        RuleCase{"the last of two", Delimiter, AtOnce, u";", u"ad", Exact, u";x ;a", u"d", u";ad"},
        RuleCase{"delimiter", Delimiter, Kept, u";", u"ad", Exact, u" ;ad", u" ", u";ad"},
        RuleCase{"hot key", Delimiter, AtHotKey, u";", u"ad", Exact, u" ;ad", u"", u";ad"},
        RuleCase{"overlapping, found", Anything, AtOnce, u";;", u"a", Exact, u";;;;", u"a", u";;a"},
        RuleCase{"overlapping, passed over", Anything, AtOnce, u";;", u"a", Exact, u";;;", u"a", u""},
        RuleCase{"overlapping, after a letter", Anything, AtOnce, u";;", u"a", Exact, u";x;;", u"a", u";;a"},
        RuleCase{"overlapping by one of three", Anything, AtOnce, u"aba", u"x", Exact, u"ababa", u"x", u""},
        RuleCase{"overlap ends in time", Anything, AtOnce, u"aba", u"x", Exact, u"abaaba", u"x", u"abax"},
        RuleCase{"prefix in the abbreviation", Anything, AtOnce, u";", u";;", Exact, u";;", u";", u";;;"}));

TEST(SnippetMatcher, ReturnsEveryMatchInLibraryOrder) {
    const auto first = SnippetGroup::make();
    const auto second = SnippetGroup::make();
    const auto prefixed = SnippetGroup::make();
    for (const auto& group : {first, second, prefixed}) group->setExpandAfter(ExpandAfter::Anything);
    prefixed->setAbbreviationPrefix(u"s");
    const auto add = [](const auto& group, std::u16string abbreviation, std::u16string content) {
        group->addItem(std::make_shared<Snippet>(abbreviation, content));
    };
    add(first, u"g", u"1");
    add(first, u"sig", u"2");
    add(prefixed, u"g", u"no: the prefix is elsewhere");
    add(prefixed, u"ig", u"3");
    add(second, u"ig", u"4");
    add(second, u"ig", u"5");

    SnippetMatcher matcher(testDelimiters());
    matcher.setSnippetGroups({first, prefixed, second});
    EXPECT_THAT(contentsOf(typeKey(matcher, u"si", u"g")), ElementsAre(u"1", u"2", u"3", u"4", u"5"));
    matcher.setSnippetGroups({second, first});
    EXPECT_THAT(contentsOf(typeKey(matcher, u"si", u"g")), ElementsAre(u"4", u"5", u"1", u"2"));
}

TEST(SnippetMatcher, ASnippetWithoutContentNeverMatches) {
    const auto group = SnippetGroup::make();
    group->addItem(std::make_shared<Snippet>(u"sig", std::nullopt));
    group->addItem(std::make_shared<Snippet>(u"", u"empty abbreviation"));
    group->addItem(std::make_shared<Snippet>(std::nullopt, u"no abbreviation"));
    SnippetMatcher matcher(testDelimiters());
    matcher.setSnippetGroups({group});
    EXPECT_THAT(typeKey(matcher, u"si", u"g"), IsEmpty());
    EXPECT_THAT(typeKey(matcher, u"", u"x"), IsEmpty());
}

TEST(SnippetMatcher, UsesTheGroupsOwnDelimiters) {
    const auto group = SnippetGroup::make();
    group->setExpandTrigger(ExpandTrigger::DelimiterKept);
    group->setDelimiters(CharacterSet::withCharacters(u"x\u00a7"));
    group->setExpandAfterDelimiters(CharacterSet::withCharacters(u"\r"));
    group->addItem(std::make_shared<Snippet>(u"sig", u"content"));
    SnippetMatcher matcher(testDelimiters());
    matcher.setSnippetGroups({group});
    EXPECT_THAT(typeKey(matcher, u"sig", u"\u00a7"), ::testing::SizeIs(1));
    EXPECT_THAT(typeKey(matcher, u"sig", u" "), IsEmpty());
    EXPECT_THAT(typeKey(matcher, u"a\nsig", u"x"), ::testing::SizeIs(1)) << "a line feed counts as return";
    EXPECT_THAT(typeKey(matcher, u"a sig", u"x"), IsEmpty());

    group->setDelimiters(std::nullopt);
    EXPECT_THAT(typeKey(matcher, u"sig", u" "), ::testing::SizeIs(1)) << "seen at the next key";
    EXPECT_THAT(typeKey(matcher, u"sig", u"x"), IsEmpty());
}

struct PlaceCase {
    const char* about;
    std::int64_t availability;
    std::int64_t inputMethodsOption;
    std::optional<std::u16string> application;
    std::optional<std::u16string> inputSource;
    bool matches;
};

TEST(SnippetMatcher, HonoursWhereAGroupIsActive) {
    const PlaceCase cases[] = {
        {"everywhere", 0, 0, u"org.editor", u"US", true},
        {"except: listed", 1, 0, u"org.mail", u"US", false},
        {"except: other", 1, 0, u"org.editor", u"US", true},
        {"except: unknown application", 1, 0, std::nullopt, u"US", true},
        {"only: listed", 2, 0, u"org.mail", u"US", true},
        {"only: other", 2, 0, u"org.editor", u"US", false},
        {"only: unknown application", 2, 0, std::nullopt, u"US", false},
        {"nowhere", 3, 0, u"org.mail", u"US", false},
        {"source except: listed", 0, 1, u"org.editor", u"German", false},
        {"source except: other", 0, 1, u"org.editor", u"US", true},
        {"source only: listed", 0, 2, u"org.editor", u"German", true},
        {"source only: other", 0, 7, u"org.editor", u"US", false},
        {"both hold", 2, 2, u"org.mail", u"German", true},
        {"one fails", 2, 2, u"org.mail", u"US", false},
    };
    const auto group = SnippetGroup::make();
    group->addItem(std::make_shared<Snippet>(u"sig", u"content"));
    group->availability().applications = {{u"org.mail"}};
    group->availability().inputMethods = {{u"German"}};
    SnippetMatcher matcher(testDelimiters());
    matcher.setSnippetGroups({group});
    for (const PlaceCase& place : cases) {
        group->availability().availability = place.availability;
        group->availability().inputMethodsOption = place.inputMethodsOption;
        const Place context{place.application, place.inputSource};
        EXPECT_EQ(typeKey(matcher, u"si", u"g", context).size(), place.matches ? 1U : 0U) << place.about;
    }
}

TEST(SnippetMatcher, FollowsEveryEditOfTheLibrary) {
    const auto group = SnippetGroup::make();
    group->setExpandAfter(ExpandAfter::Anything);
    SnippetMatcher matcher(testDelimiters());
    matcher.setSnippetGroups({group});
    const auto one = std::make_shared<Snippet>(u"ab", u"1");
    const auto two = std::make_shared<Snippet>(u"b", u"2");
    const auto three = std::make_shared<Snippet>(u"ab", u"3");
    const auto found = [&] { return contentsOf(typeKey(matcher, u"a", u"b")); };

    group->addItem(one);
    group->addItem(two);
    EXPECT_THAT(found(), ElementsAre(u"1", u"2"));
    group->insertItem(three, 0);
    EXPECT_THAT(found(), ElementsAre(u"3", u"1", u"2"));
    one->setAbbreviation(u"zz");
    EXPECT_THAT(found(), ElementsAre(u"3", u"2"));
    one->setAbbreviation(u"B");
    one->setCaseSensitivity(CaseSensitivity::IgnoreCase);
    EXPECT_THAT(found(), ElementsAre(u"3", u"1", u"2"));
    group->removeItem(three);
    group->addItem(three);
    EXPECT_THAT(found(), ElementsAre(u"1", u"2", u"3"));
    group->setAbbreviationPrefix(u"a");
    EXPECT_THAT(found(), ElementsAre(u"1", u"2"));
    group->setExpandTrigger(ExpandTrigger::Never);
    EXPECT_THAT(found(), IsEmpty());
    group->setExpandTrigger(ExpandTrigger::Immediately);
    matcher.setSnippetGroups({});
    EXPECT_THAT(found(), IsEmpty());
    two->setAbbreviation(u"still safe to edit");
}

TEST(SnippetMatcher, ASnippetListedByTwoGroupsMatchesWhereItsAbbreviationIsKnown) {
    const auto first = SnippetGroup::make();
    const auto second = SnippetGroup::make();
    first->setExpandAfter(ExpandAfter::Anything);
    second->setExpandAfter(ExpandAfter::Anything);
    const auto snippet = std::make_shared<Snippet>(u"sig", u"content");
    first->addItem(snippet);
    SnippetMatcher matcher(testDelimiters());
    matcher.setSnippetGroups({first, second});
    second->addItem(snippet);
    snippet->setAbbreviation(u"signature");
    EXPECT_THAT(typeKey(matcher, u"si", u"g"), IsEmpty());
    EXPECT_THAT(contentsOf(typeKey(matcher, u"signatur", u"e")), ElementsAre(u"content"));
    snippet->setAbbreviation(std::nullopt);
    EXPECT_THAT(typeKey(matcher, u"si", u"g"), IsEmpty());
}

TEST(SnippetMatcher, FindsVeryLongAbbreviations) {
    const std::u16string common(100, u'x');
    const auto group = SnippetGroup::make();
    group->setExpandAfter(ExpandAfter::Anything);
    group->addItem(std::make_shared<Snippet>(u"a" + common, u"a"));
    group->addItem(std::make_shared<Snippet>(u"b" + common, u"b"));
    group->addItem(std::make_shared<Snippet>(common.substr(36), u"short"));
    SnippetMatcher matcher(testDelimiters());
    matcher.setSnippetGroups({group});
    EXPECT_THAT(contentsOf(typeKey(matcher, u"b" + common.substr(1), u"x")), ElementsAre(u"b", u"short"));
    EXPECT_THAT(contentsOf(typeKey(matcher, common.substr(1), u"x")), ElementsAre(u"short"));
}

}  // namespace
}  // namespace plume
