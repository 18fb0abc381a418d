// What is erased, what is sent, what becomes of the key, and how it is taken back.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "tests/engine/SendingDesk.h"

namespace plume {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using ::testing::SizeIs;

constexpr auto AtOnce = ExpandTrigger::Immediately;
constexpr auto Kept = ExpandTrigger::DelimiterKept;
constexpr auto Swallowed = ExpandTrigger::DelimiterSwallowed;

struct ExpansionCase {
    const char* about;
    ExpandTrigger trigger;
    std::u16string content;
    std::u16string typed;
    std::u16string screen;
    std::uint64_t backspaces;
    std::uint64_t undoBackspaces;
    std::u16string undone;             // the screen after undo
    std::u16string undoneWithTrigger;  // and after undo with the trigger
};

void PrintTo(const ExpansionCase& one, std::ostream* stream) {
    *stream << one.about;
}

class Expanding : public ::testing::TestWithParam<ExpansionCase> {};

TEST_P(Expanding, ErasesTheAbbreviationAndSendsTheContent) {
    const ExpansionCase& one = GetParam();
    SendingDesk desk;
    desk.add(u"sig", one.content, one.trigger);
    desk.type(one.typed);
    ASSERT_THAT(desk.service.outputs(), SizeIs(1));
    EXPECT_EQ(desk.lastOutput().backspaceCount, one.backspaces);
    EXPECT_EQ(desk.lastOutput().trigger, SnippetTrigger::Typed);
    EXPECT_EQ(desk.screen(), one.screen);
}

TEST_P(Expanding, IsUndone) {
    const ExpansionCase& one = GetParam();
    for (const bool withTrigger : {false, true}) {
        SendingDesk desk;
        desk.add(u"sig", one.content, one.trigger);
        desk.type(one.typed);
        ASSERT_TRUE(desk.undo(withTrigger));
        EXPECT_EQ(desk.lastOutput().backspaceCount, one.undoBackspaces);
        EXPECT_EQ(desk.lastOutput().trigger, SnippetTrigger::HotKey);
        EXPECT_EQ(desk.screen(), withTrigger ? one.undoneWithTrigger : one.undone);
        EXPECT_EQ(desk.engine.letters(), desk.lastOutput().snippetExpandedContent->string());
        EXPECT_FALSE(desk.undo(withTrigger)) << "there is one expansion to take back";
    }
}

INSTANTIATE_TEST_SUITE_P(
    Triggers, Expanding,
    ::testing::Values(
        ExpansionCase{"at once", AtOnce, u"Best", u"x sig", u"x Best", 2, 4, u"x si", u"x sig"},
        ExpansionCase{"kept delimiter", Kept, u"Best", u"x sig ", u"x Best ", 3, 5, u"x sig", u"x sig "},
        ExpansionCase{"swallowed delimiter", Swallowed, u"Best", u"x sig ", u"x Best", 3, 4, u"x sig", u"x sig "},
        ExpansionCase{"a caret swallows the delimiter", Kept, u"<【|】>", u"sig ", u"<>", 3, 2, u"sig", u"sig "},
        ExpansionCase{"an empty content", AtOnce, u"", u"sig", u"", 2, 0, u"si", u"sig"},
        // Keys are no units of the content: what they typed is not erased.
        ExpansionCase{"keys", Kept, u"a【key:t code:48】", u"sig ", u"a ", 3, 2, u"sig", u"sig "}));

TEST(Undo, IsPossibleUntilTheNextKey) {
    SendingDesk desk;
    desk.add(u"sig", u"Best");
    EXPECT_FALSE(desk.undo(true));
    desk.type(u"sig");
    desk.type(u"x");
    EXPECT_FALSE(desk.undo(true));
    EXPECT_THAT(desk.service.outputs(), SizeIs(1));
}

TEST(Undo, OfASnippetThatWasNotTypedOnlyErases) {
    SendingDesk desk;
    const auto snippet = desk.add(u"sig", u"Best");
    desk.engine.sendSnippetDirectly(snippet);
    EXPECT_EQ(desk.screen(), u"Best");
    EXPECT_EQ(desk.lastOutput().backspaceCount, 0U);
    EXPECT_EQ(desk.lastOutput().trigger, SnippetTrigger::Direct);
    EXPECT_TRUE(desk.undo(true));
    EXPECT_EQ(desk.screen(), u"");
}

TEST(Undo, DoesNotTakeBackWhatStandsBeforeAScript) {
    SendingDesk desk;
    const auto script = desk.add(u"now", u"date", AtOnce, ContentType::ShellScript);
    desk.add(u"sig", u"Best");
    desk.type(u"sig");
    desk.engine.sendSnippetDirectly(script);
    EXPECT_FALSE(desk.undo(true));
    desk.type(u"sig");
    desk.settle();
    EXPECT_FALSE(desk.undo(true)) << "the script's output stands behind the expansion";
    EXPECT_EQ(desk.screen(), u"BestBest<date>");
}

TEST(Expansion, ThatWouldChangeNothingLetsTheKeyThrough) {
    for (const auto trigger : {AtOnce, Kept}) {
        SendingDesk desk;
        desk.add(u"sig", u"sig", trigger);
        desk.type(u"sig ");
        EXPECT_THAT(desk.service.outputs(), IsEmpty());
        EXPECT_EQ(desk.screen(), u"sig ");
        EXPECT_FALSE(desk.undo(true));
    }
}

TEST(Expansion, WithKeysOrAScriptIsSentThoughItsTextIsTheAbbreviation) {
    SendingDesk desk;
    desk.add(u"sig", u"sig【key:t code:48】");
    desk.type(u"sig");
    EXPECT_THAT(desk.service.outputs(), SizeIs(1));
    desk.add(u"zdate", u"date", ExpandTrigger::Never, ContentType::ShellScript);
    desk.add(u"date", u"【snippet:zdate】");
    desk.type(u"date");
    desk.settle();
    EXPECT_EQ(desk.screen(), u"sig<date>");
}

TEST(Expansion, OfASnippetWithoutContentSendsNothing) {
    SendingDesk desk;
    desk.add(u"sig", u"Best")->setRichTextContent(std::nullopt);
    desk.type(u"x sig");
    EXPECT_THAT(desk.service.outputs(), IsEmpty());
    EXPECT_EQ(desk.screen(), u"x sig");
    EXPECT_FALSE(desk.undo(true));
}

TEST(Expansion, TakesTheCaseOfItsAbbreviation) {
    SendingDesk desk;
    desk.add(u"sig", u"best regards")->setCaseSensitivity(CaseSensitivity::IgnoreCaseAndAdapt);
    desk.type(u"Sig SIG sig");
    EXPECT_EQ(desk.screen(), u"Best regards BEST REGARDS best regards");
}

TEST(Expansion, LeavesItsTextInTheBufferUnlessTheCaretMayStandElsewhere) {
    struct Case {
        std::u16string content;
        std::u16string letters;
    };
    for (const Case& one : {Case{u"Best", u"Best"}, Case{u"<【|】>", u""}, Case{u"a【key:t code:48】", u""}}) {
        SendingDesk desk;
        desk.add(u"sig", one.content);
        desk.type(u"sig");
        EXPECT_EQ(desk.engine.letters(), one.letters);
    }
    SendingDesk desk;
    desk.add(u"sig", u"to g");
    desk.add(u"go", u"went")->parentGroup()->setExpandAfter(ExpandAfter::Delimiter);
    desk.type(u"sigo");
    EXPECT_EQ(desk.screen(), u"to went");
}

TEST(Expansion, IsRememberedAsTheLastOne) {
    SendingDesk desk;
    EXPECT_EQ(desk.pipeline.lastUsedSnippet(), nullptr);
    const auto snippet = desk.add(u"sig", u"Best");
    desk.type(u"sig");
    EXPECT_EQ(desk.pipeline.lastUsedSnippet(), snippet);
    EXPECT_TRUE(snippet->lastTimeUsed());
}

TEST(Feedback, IsHeardWithEveryExpansionAndUndo) {
    SendingDesk desk;
    desk.pipeline.setFeedbackSound("Click");
    desk.add(u"sig", u"Best");
    desk.type(u"sig");
    EXPECT_THAT(desk.sounds.names, IsEmpty());
    desk.pipeline.setPlayFeedbackSound(true);
    desk.type(u" sig");
    desk.undo(true);
    EXPECT_THAT(desk.sounds.names, ElementsAre("Click", "Click"));
}

// ---- From lists, and by hot key ----

struct PickCase {
    const char* about;
    ExpandTrigger trigger;
    std::u16string typed;  // ends with the key that opens the list
    std::uint64_t backspaces;
};

void PrintTo(const PickCase& one, std::ostream* stream) {
    *stream << one.about;
}

class Picking : public ::testing::TestWithParam<PickCase> {};

TEST_P(Picking, ErasesTheDelimiterToo) {
    const PickCase& one = GetParam();
    for (const bool digit : {false, true}) {
        SendingDesk desk;
        desk.add(u"ab", u"first", one.trigger);
        desk.add(u"ab", u"second", one.trigger);
        desk.type(one.typed);
        if (one.trigger == ExpandTrigger::HotKey) desk.engine.expandAtHotkey();
        desk.settle();
        ASSERT_TRUE(desk.list.visible);
        desk.type(digit ? u"2" : u"\n");
        EXPECT_EQ(desk.screen(), digit ? u"second" : u"first");
        EXPECT_EQ(desk.lastOutput().backspaceCount, one.backspaces);
        EXPECT_EQ(desk.lastOutput().trigger,
                  (digit ? SnippetTrigger::Digit : SnippetTrigger::Suggestion) | SnippetTrigger::FromSeveralMatches);
    }
}

INSTANTIATE_TEST_SUITE_P(Triggers, Picking,
                         ::testing::Values(PickCase{"kept delimiter", Kept, u"ab ", 3},
                                           PickCase{"swallowed delimiter", Swallowed, u"ab ", 3},
                                           PickCase{"at once", AtOnce, u"ab", 2},
                                           PickCase{"hot key", ExpandTrigger::HotKey, u"ab", 2}));

TEST(Suggestions, EraseWhatMadeThemOne) {
    SendingDesk desk;
    desk.add(u"sig", u"Best", Kept);
    desk.type(u"si");
    desk.engine.suggestAbbreviations();
    desk.type(u"\n");
    EXPECT_EQ(desk.screen(), u"Best");
    EXPECT_EQ(desk.lastOutput().trigger, SnippetTrigger::Suggestion);
}

TEST(ExpandHotKey, ErasesTheWholeAbbreviation) {
    SendingDesk desk;
    desk.add(u"sig", u"Best", ExpandTrigger::HotKey);
    desk.type(u"x sig");
    desk.engine.expandAtHotkey();
    EXPECT_EQ(desk.screen(), u"x Best");
    EXPECT_EQ(desk.lastOutput().trigger, SnippetTrigger::HotKey);
}

TEST(RemoteDesktops, GetSuggestionsOnceTheyTakeKeysAgain) {
    SendingDesk desk;
    desk.processes.setFrontProcess(desk.processes.launch(u"com.citrix.XenAppViewer"));
    desk.service.refreshContextInputSetting();
    desk.add(u"sig", u"Best");
    desk.type(u"si");
    desk.engine.suggestAbbreviations();
    desk.type(u"\n");
    EXPECT_EQ(desk.service.broughtToFront(), 1);
    desk.loop.advance(0.49);
    EXPECT_EQ(desk.screen(), u"si");
    desk.loop.advance(0.01);
    EXPECT_EQ(desk.screen(), u"Best");
}

}  // namespace
}  // namespace plume
