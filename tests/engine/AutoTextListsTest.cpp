// The list at the caret and quick search, as the engine drives them.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "content/PLOutput.h"
#include "tests/engine/EngineDesk.h"

namespace plume {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using ::testing::SizeIs;
using Sent = RecordingSender::Sent;

TEST(Suggestions, ComeUpAtTheCaretAndFollowWhatIsTyped) {
    EngineDesk desk;
    desk.add({u"abc", u"abde", u"abdf"});
    desk.service.typeText(u"ab");
    desk.engine.suggestAbbreviations();
    EXPECT_THAT(desk.list.entries, ElementsAre(u"abc", u"abde", u"abdf"));
    EXPECT_EQ(desk.list.shownAtCaret, 1);

    desk.service.typeText(u"d");
    EXPECT_THAT(desk.list.entries, ElementsAre(u"abde", u"abdf"));
    EXPECT_EQ(desk.list.heights, 1);
    desk.service.pressKey(KeyCode::Delete);
    EXPECT_THAT(desk.list.entries, SizeIs(3));
    desk.service.typeText(u"x");
    EXPECT_FALSE(desk.list.visible);
    EXPECT_EQ(desk.list.shownAtCaret, 1);
}

TEST(Suggestions, AreOneWindowHoweverOftenTheyAreAskedFor) {
    EngineDesk desk;
    desk.add({u"abc"});
    desk.add({u"xyz"});
    desk.service.typeText(u"ab");
    desk.engine.suggestAbbreviations();
    desk.engine.clear();
    desk.service.typeText(u"x");
    desk.engine.suggestAbbreviations();
    EXPECT_THAT(desk.list.entries, ElementsAre(u"xyz"));
    EXPECT_EQ(desk.list.made, 1);
    EXPECT_EQ(desk.list.shownAtCaret, 2);
}

TEST(Suggestions, AreNotShownWhenThereAreNone) {
    EngineDesk desk;
    desk.add({u"abc"});
    desk.engine.suggestAbbreviations();
    desk.service.typeText(u"x");
    desk.engine.suggestAbbreviations();
    EXPECT_EQ(desk.list.made, 0);
}

TEST(Suggestions, LeaveOutGroupsOfOtherPrograms) {
    EngineDesk desk;
    desk.add({u"abc"})->availability().availability = PLFunctionAvailability::OnlyListed;
    desk.add({u"abd"});
    desk.service.typeText(u"a");
    desk.engine.suggestAbbreviations();
    EXPECT_THAT(desk.list.entries, ElementsAre(u"abd"));
}

TEST(Suggestions, AClickSendsTheEntry) {
    EngineDesk desk;
    desk.add({u"abc", u"abd"});
    desk.service.typeText(u"ab");
    desk.engine.suggestAbbreviations();
    desk.list.selected = 1;
    desk.list.click();
    EXPECT_THAT(desk.sender.sent, ElementsAre(Sent{u"abd", u"ab", SnippetTrigger::Digit, u"ab", false}));
    EXPECT_FALSE(desk.list.visible);
}

TEST(Suggestions, AreClosedByEverythingThatEmptiesTheBuffer) {
    EngineDesk desk;
    desk.openListOf(2);
    desk.engine.clear();
    EXPECT_FALSE(desk.list.visible);
    EXPECT_FALSE(desk.engine.selectingSnippet());
    EXPECT_TRUE(desk.engine.suggestions().isEmpty());
}

TEST(Suggestions, AnIndexPastTheEndClosesTheListAndKeepsTheBuffer) {
    EngineDesk desk;
    desk.openListOf(2);
    desk.engine.sendSuggestionAtIndex(2, SnippetTrigger::Digit);
    EXPECT_THAT(desk.sender.sent, IsEmpty());
    EXPECT_FALSE(desk.list.visible);
    EXPECT_EQ(desk.engine.letters(), u"ab");
}

TEST(QuickSearch, OpensAtTheCaretOnce) {
    EngineDesk desk;
    desk.add({u"abc"});
    desk.engine.quickSearch();
    EXPECT_TRUE(desk.engine.snippetQuickSearchWindowVisible());
    EXPECT_FALSE(desk.search.atTopRightCorner);
    EXPECT_EQ(desk.search.groupCount, 1U);
    desk.engine.quickSearchAtTopRightCorner();
    EXPECT_TRUE(desk.search.atTopRightCorner);
    desk.engine.quickSearch();
    EXPECT_TRUE(desk.search.atTopRightCorner) << "a visible window stays where it is";
    EXPECT_EQ(desk.search.made, 1);
}

TEST(QuickSearch, SearchesTheLibraryAsItIsNow) {
    EngineDesk desk;
    desk.engine.quickSearch();
    desk.add({u"abc"});
    desk.add({u"abd"});
    EXPECT_EQ(desk.search.groupCount, 2U);
}

TEST(QuickSearch, SendsWhatWasChosen) {
    EngineDesk desk;
    desk.service.typeText(u"ab");
    desk.engine.quickSearch();
    desk.search.choose();
    EXPECT_THAT(desk.sender.sent, IsEmpty()) << "nothing was chosen";
    desk.search.selected = std::make_shared<Snippet>(u"one", u"1");
    desk.search.choose();
    EXPECT_THAT(desk.sender.sent, ElementsAre(Sent{u"one", std::nullopt, SnippetTrigger::Direct, u"ab", false}));
}

}  // namespace
}  // namespace plume
