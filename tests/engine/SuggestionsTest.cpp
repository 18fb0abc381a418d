// What is suggested for what was typed, and when a list comes by itself.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "tests/engine/EngineDesk.h"

namespace plume {
namespace {

using ::testing::ElementsAre;

struct GroupOfCase {
    std::vector<std::u16string> abbreviations;
    std::u16string prefix;
    ExpandAfter rule = ExpandAfter::Delimiter;
    CaseSensitivity caseSensitivity = CaseSensitivity::CaseSensitive;
};

struct SuggestionCase {
    const char* about;
    std::vector<GroupOfCase> groups;
    std::u16string typed;
    std::vector<std::u16string> suggested;  // "abbreviation:filter"
};

void fill(EngineDesk& desk, const std::vector<GroupOfCase>& groups) {
    for (const GroupOfCase& one : groups) {
        const auto group = desk.add(one.abbreviations, ExpandTrigger::Never);
        group->setAbbreviationPrefix(one.prefix);
        group->setExpandAfter(one.rule);
        for (const auto& snippet : group->items()) snippet->setCaseSensitivity(one.caseSensitivity);
    }
}

std::vector<std::u16string> suggestedBy(const AutoText& engine) {
    std::vector<std::u16string> lines;
    const SuggestionList& list = engine.suggestions();
    for (std::size_t i = 0; i < list.size(); ++i) {
        lines.push_back(*list.suggestions[i]->abbreviation() + u":" + list.suggestionFilters[i]);
    }
    return lines;
}

TEST(Suggestions, AreWhatTheLettersMayBecome) {
    constexpr auto AnyCase = CaseSensitivity::IgnoreCase;
    const SuggestionCase cases[] = {
        {"the last word begins it", {{{u"sig"}, u""}}, u"x si", {u"sig:si"}},
        {"not within a word", {{{u"sig"}, u""}}, u"xsi", {}},
        {"complete ones too", {{{u"sig", u"signature"}, u""}}, u"sig", {u"sig:sig", u"signature:sig"}},
        {"more than is typed only", {{{u"sig", u"signature"}, u""}}, u"x sign", {u"signature:sign"}},
        {"the longest text first", {{{u"n", u"in n", u"in N"}, u""}}, u"in n", {u"in n:in n", u"n:n"}},
        {"once, for the longest text", {{{u"a aa"}, u""}}, u"a a", {u"a aa:a a"}},
        {"for a shorter text in its case", {{{u"a Aa"}, u""}}, u"a a", {u"a Aa:a"}},
        {"library order within a length", {{{u"sib"}, u""}, {{u"sia"}, u""}}, u"si", {u"sib:si", u"sia:si"}},
        {"in the abbreviation's own case", {{{u"Sig"}, u"", ExpandAfter::Delimiter, AnyCase}}, u"sI", {u"Sig:Si"}},
        {"exactly where case matters", {{{u"Sig"}, u""}}, u"si", {}},
        {"after a digit, not after a letter", {{{u"kg"}, u"", ExpandAfter::Digits}}, u"5k", {u"kg:k"}},
        {"after a letter where digits are asked for", {{{u"kg"}, u"", ExpandAfter::Digits}}, u"xk", {}},
        {"at the start, where digits are asked for", {{{u"kg"}, u"", ExpandAfter::Digits}}, u"k", {u"kg:k"}},
        {"inside a word", {{{u"sig"}, u"", ExpandAfter::Anything}}, u"xsi", {u"sig:si"}},
        {"after white space only", {{{u"sig"}, u"", ExpandAfter::Whitespace}}, u"(si", {}},
        {"after any sign", {{{u"sig"}, u""}}, u"(si", {u"sig:si"}},
        {"the prefix alone", {{{u"ad", u"be"}, u";"}}, u"x ;", {u"ad:;", u"be:;"}},
        {"the prefix and more", {{{u"ad", u"be"}, u";"}}, u";a", {u"ad:;a"}},
        {"less than the prefix", {{{u"ad"}, u";;"}}, u";", {}},
        {"prefixes that overlap, from the left", {{{u";a"}, u";;"}}, u";;;", {u";a:;;;", u";a:;;"}},
        {"the prefix as it was typed", {{{u"Ad"}, u"Zz", ExpandAfter::Delimiter, AnyCase}}, u"zZa", {u"Ad:zZa"}},
        {"the prefix in its case", {{{u"ad"}, u"Zz"}}, u"zza", {}},
        {"the prefix only after what is asked for", {{{u"ad"}, u";"}}, u"a;a", {}},
        {"groups with a prefix first", {{{u";abc"}, u""}, {{u"ab"}, u";"}}, u";a", {u"ab:;a", u";abc:;a"}},
    };
    for (const SuggestionCase& one : cases) {
        EngineDesk desk;
        fill(desk, one.groups);
        desk.suggest(one.typed);
        EXPECT_EQ(suggestedBy(desk.engine), one.suggested) << one.about;
        EXPECT_EQ(desk.list.visible, !one.suggested.empty()) << one.about;
    }
}

TEST(Suggestions, LeaveOutGroupsThatDoNotSuggestAndSnippetsWithoutContent) {
    EngineDesk desk;
    const auto silent = desk.add({u"sia"});
    silent->setSuggestAbbreviations(false);
    desk.add({u"sib"})->items()[0]->setRichTextContent(std::nullopt);
    desk.suggest(u"si");
    EXPECT_FALSE(desk.list.visible);
    silent->setSuggestAbbreviations(true);
    desk.engine.suggestAbbreviations();
    EXPECT_THAT(desk.list.entries, ElementsAre(u"sia"));
}

// Types, waits a moment and tells whether the list is there.
bool comesAfter(EngineDesk& desk, std::u16string_view text, double seconds = 0.45) {
    desk.type(text);
    desk.loop.advance(seconds);
    return desk.list.visible;
}

TEST(SuggestionsByItself, ComeWhenTheUserPausesAfterTwoLetters) {
    EngineDesk desk;
    fill(desk, {{{u"sig", u"other"}, u""}, {{u"sin"}, u";;"}});
    EXPECT_FALSE(comesAfter(desk, u"x si")) << "they have to be switched on";
    desk.engine.clear();
    desk.engine.setSuggestsByItself(true);
    EXPECT_FALSE(comesAfter(desk, u"x s"));
    EXPECT_TRUE(desk.engine.suggestions().isEmpty());
    EXPECT_FALSE(comesAfter(desk, u"i", 0.39));
    EXPECT_FALSE(comesAfter(desk, u"g", 0.39)) << "every key starts the pause anew";
    desk.loop.advance(0.02);
    EXPECT_TRUE(desk.list.visible);
    EXPECT_THAT(desk.list.entries, ElementsAre(u"sig"));

    desk.engine.clear();
    EXPECT_FALSE(comesAfter(desk, u";;s")) << "a prefix is no letter of an abbreviation";
    EXPECT_TRUE(comesAfter(desk, u"i"));
    EXPECT_THAT(desk.list.entries, ElementsAre(u"sin", u"sig"));
    desk.engine.clear();
    EXPECT_TRUE(comesAfter(desk, u"six\b")) << "Backspace is a key like others";
}

TEST(SuggestionsByItself, StayAwayOnceTheyAreSentAwayUntilSomethingIsTyped) {
    for (const bool clicked : {true, false}) {
        EngineDesk desk;
        fill(desk, {{{u"sig"}, u""}});
        desk.engine.setSuggestsByItself(true);
        ASSERT_TRUE(comesAfter(desk, u"s", 0) || comesAfter(desk, u"i"));
        // A key comes first: its pause must not bring the list back.
        desk.type(u"g");
        if (clicked) {
            desk.clickAt(1, 1);
        } else {
            desk.desktop.pressAndRelease(KeyCode::Escape);
        }
        EXPECT_FALSE(desk.list.visible);
        EXPECT_FALSE(comesAfter(desk, u"", 2));
        EXPECT_EQ(comesAfter(desk, u"\b"), !clicked) << "after a click nothing of it is known";
    }
}

TEST(SuggestionsByItself, LeaveOtherListsAlone) {
    EngineDesk desk;
    desk.add({u"sig", u"sig"});
    desk.add({u"sigma"});
    desk.engine.setSuggestsByItself(true);
    EXPECT_TRUE(comesAfter(desk, u"sig", 2));
    EXPECT_THAT(desk.list.entries, ElementsAre(u"sig", u"sig")) << "the matches to choose from";
    desk.engine.clear();
    desk.type(u"si");
    desk.engine.quickSearch();
    EXPECT_FALSE(comesAfter(desk, u"", 2));
}

TEST(SuggestionsByItself, EndWithTheBufferTheSettingAndTheEngine) {
    EngineDesk desk;
    fill(desk, {{{u"sig"}, u""}});
    desk.engine.setSuggestsByItself(true);
    desk.type(u"si");
    desk.desktop.pressAndRelease(KeyCode::Left);
    EXPECT_FALSE(comesAfter(desk, u""));
    desk.type(u"x ");
    desk.engine.sendSnippetDirectly(std::make_shared<Snippet>(u"one", u"si"));
    EXPECT_FALSE(comesAfter(desk, u"")) << "what Plume has put there is no beginning";
    desk.engine.clear();
    desk.type(u"si");
    desk.engine.setSuggestsByItself(false);
    EXPECT_FALSE(comesAfter(desk, u""));
    desk.engine.setSuggestsByItself(true);
    desk.type(u"g");
    desk.owner.reset();
    desk.loop.advance(1);
    EXPECT_FALSE(desk.list.visible);
}

}  // namespace
}  // namespace plume
