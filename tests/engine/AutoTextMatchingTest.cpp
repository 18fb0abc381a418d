// What becomes of matches: one is sent, several are offered, none goes on to correction.
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

struct SendCase {
    const char* about;
    ExpandTrigger trigger;
    std::u16string typed;
    bool swallows;
    std::u16string expansion;  // what the sender leaves in the buffer
    std::u16string lettersBefore;
    std::u16string lettersAfter;
};

void PrintTo(const SendCase& one, std::ostream* stream) {
    *stream << one.about;
}

class OneMatch : public ::testing::TestWithParam<SendCase> {};

TEST_P(OneMatch, IsSentWithTheBufferBeforeTheKey) {
    const SendCase& one = GetParam();
    EngineDesk desk;
    desk.add({u"sig"}, one.trigger);
    desk.sender.swallows = one.swallows;
    desk.sender.lettersAfter = one.expansion;

    const std::u16string passed = desk.service.typeText(one.typed);
    EXPECT_EQ(passed, one.swallows ? one.typed.substr(0, one.typed.size() - 1) : one.typed);
    EXPECT_THAT(desk.sender.sent, ElementsAre(Sent{u"sig", u"sig", SnippetTrigger::Typed, one.lettersBefore, false}));
    EXPECT_EQ(desk.engine.letters(), one.lettersAfter);
}

constexpr auto AtOnce = ExpandTrigger::Immediately;
constexpr auto Kept = ExpandTrigger::DelimiterKept;
constexpr auto Swallowed = ExpandTrigger::DelimiterSwallowed;

INSTANTIATE_TEST_SUITE_P(
    Triggers, OneMatch,
    ::testing::Values(SendCase{"at once", AtOnce, u"x sig", true, u"", u"x si", u""},
                      SendCase{"at once, with its text kept", AtOnce, u"sig", true, u"Best", u"si", u"Best"},
                      SendCase{"at once, let through", AtOnce, u"sig", false, u"", u"si", u""},
                      SendCase{"kept delimiter", Kept, u"sig.", false, u"", u"sig", u"."},
                      SendCase{"kept delimiter after the text", Kept, u"sig ", false, u"Best", u"sig", u"Best "},
                      SendCase{"kept delimiter that is typed later", Kept, u"sig ", true, u"Best ", u"sig", u"Best  "},
                      SendCase{"swallowed delimiter", Swallowed, u"sig ", true, u"Best", u"sig", u"Best"}));

TEST(SeveralMatches, AreOfferedAfterTheKeyHasPassed) {
    EngineDesk desk;
    desk.add({u"ab"});
    desk.add({u"ab", u"b", u"ab"});
    EXPECT_EQ(desk.service.typeText(u"ab"), u"ab");
    EXPECT_EQ(desk.engine.letters(), u"ab");
    EXPECT_TRUE(desk.engine.selectingSnippet());
    EXPECT_FALSE(desk.list.visible);
    EXPECT_EQ(desk.loop.nextDue(), 0.0);

    desk.loop.runReady();
    EXPECT_TRUE(desk.list.visible);
    EXPECT_THAT(desk.list.entries, ElementsAre(u"ab", u"ab", u"ab"));
    EXPECT_THAT(desk.engine.suggestions().suggestionFilters, ElementsAre(u"ab", u"ab", u"ab"));
    EXPECT_THAT(desk.sender.sent, IsEmpty());
    EXPECT_THAT(desk.corrector.asked, SizeIs(1)) << "only the first key completed nothing";
}

TEST(SeveralMatches, KeepTheTextAsItWasTypedForEach) {
    EngineDesk desk;
    const auto sensitive = desk.add({u"Ab"});
    const auto insensitive = desk.add({u"ab"});
    insensitive->items()[0]->setCaseSensitivity(CaseSensitivity::IgnoreCase);
    desk.service.typeText(u"Ab");
    EXPECT_THAT(desk.engine.suggestions().suggestions, ElementsAre(sensitive->items()[0], insensitive->items()[0]));
    EXPECT_THAT(desk.engine.suggestions().suggestionFilters, ElementsAre(u"Ab", u"Ab"));
}

TEST(SeveralMatches, AreWithdrawnByTheNextKeyAlsoBeforeTheyAreShown) {
    EngineDesk desk;
    desk.add({u"ab", u"ab"});
    desk.service.typeText(u"abc");
    EXPECT_FALSE(desk.engine.selectingSnippet());
    desk.loop.runReady();
    EXPECT_EQ(desk.list.made, 0);

    desk.engine.clear();
    desk.openListOf(2, u"xy");
    ASSERT_TRUE(desk.list.visible);
    desk.service.typeText(u"z");
    EXPECT_FALSE(desk.list.visible);
    EXPECT_TRUE(desk.engine.suggestions().isEmpty());
}

TEST(SeveralMatches, ReplaceAnOlderOffer) {
    EngineDesk desk;
    desk.add({u"a", u"a"});
    desk.add({u"a+b", u"a+b", u"a+b"});
    desk.service.typeText(u"a");
    desk.loop.runReady();
    EXPECT_THAT(desk.list.entries, ElementsAre(u"a", u"a"));
    desk.service.typeText(u"+b");
    EXPECT_FALSE(desk.list.visible);
    desk.loop.runReady();
    EXPECT_THAT(desk.list.entries, ElementsAre(u"a+b", u"a+b", u"a+b"));
    EXPECT_EQ(desk.list.made, 1);
}

TEST(SeveralMatches, OfferedTwiceBeforeTheListOpensOpenItOnce) {
    EngineDesk desk;
    desk.add({u"a", u"a"});
    desk.add({u"a+b", u"a+b", u"a+b"});
    desk.service.typeText(u"a+b");
    desk.loop.runReady();
    EXPECT_THAT(desk.list.entries, ElementsAre(u"a+b", u"a+b", u"a+b"));
    EXPECT_EQ(desk.list.shownAtCaret, 1);
}

TEST(SeveralMatches, GiveWayToASingleOne) {
    EngineDesk desk;
    desk.add({u"a", u"a"});
    desk.add({u"a."});
    desk.service.typeText(u"a");
    desk.loop.runReady();
    ASSERT_TRUE(desk.list.visible);
    desk.service.typeText(u".");
    EXPECT_THAT(desk.sender.sent, ElementsAre(Sent{u"a.", u"a.", SnippetTrigger::Typed, u"a", false}));
    EXPECT_FALSE(desk.engine.selectingSnippet());
}

TEST(SeveralMatches, TellTheSenderThatTheyWereSeveral) {
    EngineDesk desk;
    desk.openListOf(2);
    desk.service.pressKey(KeyCode::Return);
    desk.loop.runReady();
    ASSERT_THAT(desk.sender.sent, SizeIs(1));
    EXPECT_EQ(desk.sender.sent[0].trigger, SnippetTrigger::Suggestion | SnippetTrigger::FromSeveralMatches);
    EXPECT_FALSE(desk.engine.selectingSnippet());
}

TEST(NoMatch, IsHandedToCorrectionWithTheTextBeforeTheKey) {
    EngineDesk desk;
    desk.service.typeText(u"en");
    EXPECT_THAT(desk.corrector.asked,
                ElementsAre(RecordingCorrector::Asked{u"", u"e", u"e"}, RecordingCorrector::Asked{u"e", u"n", u"en"}));
    desk.corrector.swallows = true;
    EXPECT_EQ(desk.service.typeText(u"d"), u"");
}

TEST(HotKey, ExpandsWhatStandsInTheBuffer) {
    EngineDesk desk;
    desk.add({u"sig"}, ExpandTrigger::HotKey);
    desk.service.typeText(u"x sig");
    EXPECT_THAT(desk.sender.sent, IsEmpty());
    desk.engine.expandAtHotkey();
    EXPECT_THAT(desk.sender.sent, ElementsAre(Sent{u"sig", u"sig", SnippetTrigger::HotKey, u"x sig", false}));
}

TEST(HotKey, OffersSeveralMatchesAndKeepsTheBuffer) {
    EngineDesk desk;
    desk.add({u"sig", u"sig"}, ExpandTrigger::HotKey);
    desk.service.typeText(u"sig");
    desk.engine.expandAtHotkey();
    EXPECT_EQ(desk.engine.letters(), u"sig");
    desk.loop.runReady();
    EXPECT_TRUE(desk.list.visible);
    EXPECT_TRUE(desk.engine.selectingSnippet());
}

TEST(HotKey, DoesNothingInPlumeOrInQuickSearchOrWithoutAMatch) {
    EngineDesk desk;
    desk.add({u"sig"}, ExpandTrigger::HotKey);
    desk.service.typeText(u"si");
    desk.engine.expandAtHotkey();
    EXPECT_EQ(desk.engine.letters(), u"si");

    desk.service.typeText(u"g");
    desk.engine.quickSearch();
    desk.engine.expandAtHotkey();
    desk.search.visible = false;
    desk.processes.setFrontProcess(desk.processes.currentProcess());
    desk.service.pressKey(KeyCode::F1);
    desk.engine.setLetters(u"sig");
    desk.engine.expandAtHotkey();
    EXPECT_THAT(desk.sender.sent, IsEmpty());
}

TEST(Availability, LooksAtTheProgramThatReceivedTheLastKey) {
    EngineDesk desk;
    const auto group = desk.add({u"sig"});
    group->availability().availability = PLFunctionAvailability::OnlyListed;
    group->availability().applications = {u"org.example.editor"};
    desk.service.typeText(u"sig");
    EXPECT_THAT(desk.sender.sent, SizeIs(1));
    EXPECT_THAT(desk.engine.filteredGroupsByApplication(), ElementsAre(group));

    desk.processes.setFrontProcess(desk.processes.launch(u"org.example.terminal"));
    desk.service.typeText(u"sig");
    EXPECT_THAT(desk.sender.sent, SizeIs(1));
    EXPECT_THAT(desk.engine.filteredGroupsByApplication(), IsEmpty());
}

TEST(Availability, OfTheInputSourceCountsForMatchingAlone) {
    EngineDesk desk;
    const auto group = desk.add({u"sig"});
    group->availability().inputMethodsOption = PLFunctionAvailability::ExceptListed;
    group->availability().inputMethods = {std::u16string(SimulatedInputSources::US)};
    desk.service.typeText(u"sig");
    EXPECT_THAT(desk.sender.sent, IsEmpty());
    EXPECT_THAT(desk.engine.filteredGroupsByApplication(), ElementsAre(group));

    desk.sources.setIdentifier(u"org.example.keylayout.Other");
    desk.service.typeText(u" sig");
    EXPECT_THAT(desk.sender.sent, SizeIs(1));
}

TEST(Library, ChangesAreSeenByTheNextKey) {
    EngineDesk desk;
    const auto group = desk.add({u"old"});
    group->items()[0]->setAbbreviation(u"new");
    desk.service.typeText(u"old ");
    EXPECT_THAT(desk.sender.sent, IsEmpty());
    desk.service.typeText(u"new");
    EXPECT_THAT(desk.sender.sent, SizeIs(1));
    desk.engine.setSnippetGroups({});
    desk.service.typeText(u"new");
    EXPECT_THAT(desk.sender.sent, SizeIs(1));
}

}  // namespace
}  // namespace plume
