// What random libraries and typings seldom come upon.
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
    std::u16string before;  // the buffer before the key
    std::u16string key;
    std::u16string expected;  // the typed text of the match; empty for none
};

constexpr auto Delimiter = ExpandAfter::Delimiter;
constexpr auto Whitespace = ExpandAfter::Whitespace;
constexpr auto Anything = ExpandAfter::Anything;
constexpr auto Digits = ExpandAfter::Digits;
constexpr auto Unknown = static_cast<ExpandAfter>(7);
constexpr auto AtOnce = ExpandTrigger::Immediately;
constexpr auto Kept = ExpandTrigger::DelimiterKept;

TEST(SnippetMatcher, HoldsTheRules) {
    const RuleCase cases[] = {
        {"line feed is no delimiter", Delimiter, Kept, u"", u"sig", u"sig", u"\n", u""},
        {"unknown trigger", Delimiter, static_cast<ExpandTrigger>(9), u"", u"sig", u"si", u"g", u""},
        {"after an image", Delimiter, AtOnce, u"", u"sig", u"\xfffcsi", u"g", u"sig"},
        {"digits after an image", Digits, AtOnce, u"", u"kg", u"\xfffck", u"g", u"kg"},
        {"white space: line separator", Whitespace, AtOnce, u"", u"sig", u"\x2028si", u"g", u"sig"},
        {"digits of another script", Digits, AtOnce, u"", u"kg", u"\u0663k", u"g", u"kg"},
        {"unknown rule", Unknown, AtOnce, u"", u"sig", u" si", u"g", u""},
        {"unknown rule at the start", Unknown, AtOnce, u"", u"sig", u"si", u"g", u"sig"},
        {"overlapping, found", Anything, AtOnce, u";;", u"a", u";;;;", u"a", u";;a"},
        {"overlapping, passed over", Anything, AtOnce, u";;", u"a", u";;;", u"a", u""},
        {"overlapping, after a letter", Anything, AtOnce, u";;", u"a", u";x;;", u"a", u";;a"},
        {"overlapping by one of three", Anything, AtOnce, u"aba", u"x", u"ababa", u"x", u""},
        {"overlap ends in time", Anything, AtOnce, u"aba", u"x", u"abaaba", u"x", u"abax"},
        {"prefix in the abbreviation", Anything, AtOnce, u";", u";;", u";;", u";", u";;;"},
    };
    for (const RuleCase& rule : cases) {
        const auto group = SnippetGroup::make();
        group->setExpandAfter(rule.expandAfter);
        group->setExpandTrigger(rule.expandTrigger);
        if (!rule.prefix.empty()) group->setAbbreviationPrefix(rule.prefix);
        group->addItem(std::make_shared<Snippet>(rule.abbreviation, u"content"));
        SnippetMatcher matcher(testDelimiters());
        matcher.setSnippetGroups({group});
        const auto matches = typeKey(matcher, rule.before, rule.key);
        EXPECT_EQ(matches.size(), rule.expected.empty() ? 0U : 1U) << rule.about;
        for (const auto& match : matches) EXPECT_EQ(match.second, rule.expected) << rule.about;
    }
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

    snippet->setAbbreviation(u"sig");
    matcher.setSnippetGroups({});
    EXPECT_THAT(typeKey(matcher, u"si", u"g"), IsEmpty());
    snippet->setAbbreviation(u"still safe to edit");
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
