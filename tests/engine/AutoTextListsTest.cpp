// Several matches, suggestions and quick search, as the engine drives their windows.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "tests/engine/EngineDesk.h"

namespace plume {
namespace {

using ::testing::ElementsAre;
using ::testing::SizeIs;

TEST(SeveralMatches, AreOfferedAfterTheKeyHasPassed) {
    EngineDesk desk;
    desk.add({u"ab"});
    desk.add({u"ab", u"b", u"Ab"})->items()[2]->setCaseSensitivity(CaseSensitivity::IgnoreCase);
    desk.type(u"a");
    desk.desktop.typeCharacter(u"b");
    EXPECT_EQ(desk.screen(), u"ab");
    EXPECT_EQ(desk.engine.letters(), u"ab");
    EXPECT_TRUE(desk.engine.selectingSnippet());
    EXPECT_FALSE(desk.list.visible);
    EXPECT_THAT(desk.engine.suggestions().suggestionFilters, ElementsAre(u"ab", u"ab", u"ab"));

    desk.loop.runReady();
    EXPECT_TRUE(desk.list.visible);
    EXPECT_THAT(desk.list.entries, ElementsAre(u"ab", u"ab", u"Ab"));
}

TEST(SeveralMatches, AreWithdrawnByTheNextKeyBeforeTheyAreShown) {
    for (const char16_t* next : {u"c", u"."}) {
        EngineDesk desk;
        desk.add({u"ab", u"ab"});
        desk.add({u"ab."});
        for (const char16_t* key : {u"a", u"b", next}) desk.desktop.typeCharacter(key);
        desk.loop.runReady();
        EXPECT_EQ(desk.list.made, 0);
        EXPECT_FALSE(desk.engine.selectingSnippet());
        EXPECT_TRUE(desk.engine.suggestions().isEmpty());
    }
}

TEST(SeveralMatches, OfferedTwiceBeforeTheListOpensOpenItOnce) {
    EngineDesk desk;
    desk.add({u"a", u"a", u"ab", u"ab", u"ab"});
    for (const char16_t* key : {u"a", u"b"}) desk.desktop.typeCharacter(key);
    desk.loop.runReady();
    EXPECT_THAT(desk.list.entries, ElementsAre(u"ab", u"ab", u"ab"));
    EXPECT_EQ(desk.list.shownAtCaret, 1);
}

TEST(Suggestions, ComeUpAtTheCaretAndFollowWhatIsTyped) {
    EngineDesk desk;
    desk.add({u"abc", u"abde", u"abdf"});
    desk.engine.suggestAbbreviations();
    desk.suggest(u"x");
    EXPECT_EQ(desk.list.made, 0) << "there is nothing to show";
    desk.engine.clear();
    desk.suggest(u"ab");
    EXPECT_THAT(desk.list.entries, ElementsAre(u"abc", u"abde", u"abdf"));
    EXPECT_EQ(desk.list.shownAtCaret, 1);

    desk.type(u"d");
    EXPECT_THAT(desk.list.entries, ElementsAre(u"abde", u"abdf"));
    EXPECT_EQ(desk.list.heights, 1);
    desk.type(u"\b");
    EXPECT_THAT(desk.list.entries, SizeIs(3));
    desk.type(u"x");
    EXPECT_FALSE(desk.list.visible);

    desk.engine.clear();
    desk.suggest(u"abd");
    EXPECT_THAT(desk.list.entries, ElementsAre(u"abde", u"abdf"));
    EXPECT_EQ(desk.list.made, 1) << "it is one window however often it is shown";
}

TEST(Suggestions, LeaveOutGroupsOfOtherProgramsWhateverTheInputSource) {
    EngineDesk desk;
    desk.add({u"abc"})->availability().availability = PLFunctionAvailability::OnlyListed;
    desk.add({u"abd"})->availability().inputMethodsOption = PLFunctionAvailability::OnlyListed;
    desk.suggest(u"a");
    EXPECT_THAT(desk.list.entries, ElementsAre(u"abd"));
}

TEST(Suggestions, EraseWhatMadeThemOneWhenTheyAreSent) {
    for (const bool clicked : {true, false}) {
        EngineDesk desk;
        desk.add({u"abc"});
        desk.add(u"abd", u"Best", ExpandTrigger::DelimiterKept);
        desk.suggest(u"ab");
        desk.list.selected = 1;
        if (clicked) {
            desk.list.click();
        } else {
            desk.type(u"\n");
        }
        EXPECT_EQ(desk.screen(), u"Best");
        EXPECT_FALSE(desk.list.visible);
    }
}

TEST(Suggestions, WaitForProgramsThatTakeKeysLate) {
    EngineDesk desk;
    desk.add({u"sig"});
    desk.desktop.activate(u"com.citrix.XenAppViewer");
    desk.service.refreshContextInputSetting();
    desk.suggest(u"si");
    desk.desktop.activate(u"org.example.editor");
    desk.list.click();
    desk.suggest(u"");
    desk.list.click();
    desk.loop.advance(0.49);
    EXPECT_EQ(desk.screen(), u"si");
    desk.loop.advance(0.01);
    EXPECT_EQ(desk.screen(), u"contecontent") << "both were sent, and each erased two letters";
}

TEST(QuickSearch, OpensAtTheCaretOnceForTheLibraryAsItIs) {
    EngineDesk desk;
    desk.add({u"abc"});
    desk.engine.quickSearch();
    EXPECT_TRUE(desk.engine.snippetQuickSearchWindowVisible());
    EXPECT_FALSE(desk.search.atTopRightCorner);
    EXPECT_EQ(desk.search.groupCount, 1U);
    desk.engine.quickSearchAtTopRightCorner();
    desk.engine.quickSearch();
    EXPECT_TRUE(desk.search.atTopRightCorner) << "a visible window stays where it is";
    EXPECT_EQ(desk.search.made, 1);
    desk.add({u"abd"});
    EXPECT_EQ(desk.search.groupCount, 2U);
}

TEST(QuickSearch, SendsWhatWasChosenWithoutErasing) {
    EngineDesk desk;
    desk.type(u"ab");
    desk.engine.quickSearch();
    desk.search.choose();
    EXPECT_EQ(desk.screen(), u"ab") << "nothing was chosen";
    desk.search.selected = std::make_shared<Snippet>(u"one", u"1");
    desk.search.choose();
    EXPECT_EQ(desk.screen(), u"ab1");
}

TEST(SelectorModifier, IsTheSameInBothWindows) {
    EngineDesk desk;
    desk.engine.setSnippetSelectorKeyModifier(2);
    desk.engine.quickSearch();
    EXPECT_EQ(desk.search.modifier, 2);
    desk.search.visible = false;
    desk.add({u"ab", u"ab"});
    desk.type(u"ab");
    EXPECT_EQ(desk.list.modifier, 2);

    desk.engine.setSnippetSelectorKeyModifier(3);
    EXPECT_EQ(desk.search.modifier, 3);
    EXPECT_EQ(desk.list.modifier, 3);
}

TEST(Lifetime, AListThatIsToOpenGoesWithTheEngine) {
    EngineDesk desk;
    desk.add({u"x", u"x"});
    desk.desktop.typeCharacter(u"x");
    desk.owner.reset();
    desk.loop.runReady();
    EXPECT_EQ(desk.list.made, 0);
}

}  // namespace
}  // namespace plume
