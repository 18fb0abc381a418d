// What is found in abbreviations, contents and labels.
#include "engine/SnippetSearch.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <limits>

#include "Foundation/Strings.h"

namespace plume {
namespace {

std::shared_ptr<Snippet> labelled(const char16_t* abbreviation, Snippet::Text content, const char16_t* label) {
    auto snippet = std::make_shared<Snippet>(abbreviation, std::move(content));
    snippet->setLabel(label);
    return snippet;
}

// Letters name the snippets that are found.
std::string foundIn(const SnippetSearch::Groups& groups, std::u16string_view text, bool isWildcard,
                    std::int64_t searchBy) {
    SnippetSearch::Groups ordered;
    const auto found = SnippetSearch::filter(std::u16string(text), groups, isWildcard, searchBy, &ordered);
    EXPECT_EQ(found->size(), ordered.size());
    std::string names;
    for (const auto& group : ordered) {
        for (const auto& snippet : found->at(group)) names += toUtf8(*snippet->note());
    }
    return names;
}

class SearchedLibrary {
  public:
    SearchedLibrary() {
        groups[0]->addItems({labelled(u"abc", u"Dear Sir", u"Letter"), labelled(u"abcd", u"a*c", u"")});
        groups[1]->setAbbreviationPrefix(u";;");
        groups[1]->addItems(
            {labelled(u"", u"ABC again", u"**"), labelled(u"x", std::nullopt, u"Wide\U0001F600letter")});
        char name = 'a';
        for (const auto& group : groups) {
            for (const auto& snippet : group->items())
                snippet->setNote(std::u16string(1, static_cast<char16_t>(name++)));
        }
    }
    SnippetSearch::Groups groups{SnippetGroup::make(), SnippetGroup::make()};
};

TEST(SnippetSearch, FindsWhatIsSearchedForWhereItIsSearchedFor) {
    constexpr std::int64_t All = std::numeric_limits<std::int64_t>::max();
    const struct {
        std::u16string_view text;
        bool isWildcard;
        std::int64_t searchBy;
        const char* found;
    } cases[] = {
        {u"bC", false, 1, "ab"},     {u"BC", false, All, "abc"},     {u"abc", false, 2, "c"},
        {u"letter", false, 4, "ad"}, {u"letter", false, 3, ""},      {u"abc", false, 0, ""},
        {u"abc", false, 8, ""},      {u";;x", false, 1, "d"},        {u";;", false, 1, "d"},
        {u";;", false, 6, ""},       {u"a*c", true, 1, "a"},         {u"a*c", false, 1, ""},
        {u"a*c", false, All, "b"},   {u"A*C", true, All, "ab"},      {u"a?c*", true, 1, "ab"},
        {u"a??", true, 1, "a"},      {u"*b*", true, 1, "ab"},        {u"abc", true, 1, "ab"},
        {u"b*", true, 1, ""},        {u"**", true, All, "c"},        {u"*", true, 2, "b"},
        {u"?", true, All, ""},       {u";*", true, All, "d"},        {u"dear*", true, 7, "a"},
        {u"*?R", true, All, "ad"},   {u"wide?letter", true, 4, "d"}, {u"wide??letter", true, 4, ""},
        {u"letter*", true, 4, "a"},
    };
    const SearchedLibrary library;
    for (const auto& one : cases) {
        EXPECT_EQ(foundIn(library.groups, one.text, one.isWildcard, one.searchBy), one.found)
            << toUtf8(one.text) << (one.isWildcard ? " with wildcards by " : " by ") << one.searchBy;
    }
}

TEST(SnippetSearch, GivesNothingForNoText) {
    const SearchedLibrary library;
    SnippetSearch::Groups ordered = library.groups;
    EXPECT_FALSE(SnippetSearch::filter(std::nullopt, library.groups, false, 7, &ordered));
    EXPECT_FALSE(SnippetSearch::filter(u"", library.groups, true, 7, &ordered));
    EXPECT_EQ(ordered, library.groups) << "and leaves what was found before";
    EXPECT_TRUE(SnippetSearch::filter(u"nowhere", library.groups, true, 7, &ordered)->empty());
    EXPECT_TRUE(ordered.empty());
    EXPECT_EQ(SnippetSearch::filter(u"abc", library.groups, true, 7, nullptr)->size(), 2U);
}

// "*" tried at every length.
bool naivelyMatches(std::u16string_view pattern, std::u16string_view text) {
    if (pattern.empty()) return text.empty();
    if (pattern[0] == u'*') {
        for (std::size_t skipped = 0; skipped <= text.size(); ++skipped) {
            if (naivelyMatches(pattern.substr(1), text.substr(skipped))) return true;
        }
        return false;
    }
    if (text.empty() || (pattern[0] != u'?' && !equalsIgnoringCase(pattern.substr(0, 1), text.substr(0, 1))))
        return false;
    return naivelyMatches(pattern.substr(1), text.substr(1));
}

std::u16string randomOf(std::u16string_view characters, int most) {
    std::u16string text;
    const int length = *rc::gen::inRange(0, most + 1);
    for (int i = 0; i < length; ++i) text += characters[*rc::gen::inRange<std::size_t>(0, characters.size())];
    return text;
}

RC_GTEST_PROP(SnippetSearchModel, AgreesOnWildcards, ()) {
    const std::u16string pattern = u"a" + randomOf(u"aB?**", 5) + u"*" + randomOf(u"aB?**", 5);
    const auto group = SnippetGroup::make();
    group->addItem(std::make_shared<Snippet>(u"A" + randomOf(u"aAb", 12), u""));
    const bool found = !SnippetSearch::filter(pattern, {group}, true, SnippetSearch::Abbreviation, nullptr)->empty();
    RC_ASSERT(found == naivelyMatches(pattern, *group->items()[0]->abbreviation()));
    RC_CLASSIFY(found);
}

TEST(SnippetSearch, IsNotLostInManyWildcards) {
    std::u16string pattern;
    for (int i = 0; i < 40; ++i) pattern += u"a*";
    const auto group = SnippetGroup::make();
    group->addItem(std::make_shared<Snippet>(u"x", std::u16string(20'000, u'a')));
    EXPECT_TRUE(SnippetSearch::filter(pattern + u"b", {group}, true, 7, nullptr)->empty());
    EXPECT_EQ(SnippetSearch::filter(pattern, {group}, true, 7, nullptr)->size(), 1U);
}

}  // namespace
}  // namespace plume
