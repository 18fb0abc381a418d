// What is erased, how it is taken back, and what waits for forms and scripts.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <future>
#include <memory>

#include "tests/engine/EngineDesk.h"

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
    std::u16string letters;  // the buffer
    std::uint64_t undoBackspaces;
    std::u16string undone;             // the screen after undo
    std::u16string undoneWithTrigger;  // and after undo with the trigger
};

TEST(Expansion, ReplacesTheAbbreviationAndIsUndone) {
    const ExpansionCase cases[] = {
        {"at once", AtOnce, u"Best", u"x sig", u"x Best", u"Best", 4, u"x si", u"x sig"},
        {"kept delimiter", Kept, u"Best", u"x sig ", u"x Best ", u"Best ", 5, u"x sig", u"x sig "},
        {"swallowed", Swallowed, u"Best", u"x sig ", u"x Best", u"Best", 4, u"x sig", u"x sig "},
        {"a caret swallows the delimiter", Kept, u"<>【|】", u"sig ", u"<> ", u" ", 3, u"sig ", u"sig  "},
        {"an empty content", AtOnce, u"", u"sig", u"", u"", 0, u"si", u"sig"},
        // Keys are no units of the content: what they typed is not erased.
        {"keys", Kept, u"a【key:t code:48】", u"sig ", u"a\t ", u" ", 2, u"asig", u"asig "},
    };
    for (const ExpansionCase& one : cases) {
        for (const bool withTrigger : {false, true}) {
            EngineDesk desk;
            desk.add(u"sig", one.content, one.trigger);
            desk.type(one.typed);
            EXPECT_EQ(desk.screen(), one.screen) << one.about;
            EXPECT_EQ(desk.engine.letters(), one.letters) << one.about;
            ASSERT_TRUE(desk.engine.undoInfo()) << one.about;
            EXPECT_EQ(desk.engine.undoInfo()->backspaceCount, one.undoBackspaces) << one.about;
            const std::u16string undone =
                withTrigger ? desk.engine.undoInfo()->textWithTrigger : desk.engine.undoInfo()->text;
            EXPECT_TRUE(desk.engine.undo(withTrigger));
            EXPECT_EQ(desk.screen(), withTrigger ? one.undoneWithTrigger : one.undone) << one.about;
            EXPECT_EQ(desk.engine.letters(), undone) << one.about;
            EXPECT_FALSE(desk.engine.undo(withTrigger)) << "there is one expansion to take back";
        }
    }
}

TEST(Expansion, SentDirectlyErasesNothingAndIsUndoneByErasing) {
    EngineDesk desk;
    const auto snippet = desk.add(u"sig", u"Best");
    desk.type(u"x");
    desk.engine.sendSnippetDirectly(snippet);
    EXPECT_EQ(desk.screen(), u"xBest");
    EXPECT_EQ(desk.engine.sender().lastUsedSnippet(), snippet);
    EXPECT_TRUE(snippet->lastTimeUsed());
    EXPECT_TRUE(desk.engine.undo(true));
    EXPECT_EQ(desk.screen(), u"x");
}

TEST(Expansion, ThatIsNotSentLeavesUndoAsItIs) {
    EngineDesk desk;
    desk.add(u"sig", u"Best");
    const auto empty = desk.add(u"none", u"");
    empty->setRichTextContent(std::nullopt);
    desk.type(u"sig");
    desk.engine.sendSnippetDirectly(empty);
    EXPECT_EQ(desk.engine.letters(), u"");
    EXPECT_TRUE(desk.engine.undo(true));
}

TEST(Expansion, ReadsHowContentIsAdaptedToCase) {
    MemoryUserDefaults settings;
    settings.set("SnippetAdaptToAbbreviationCaseOption", std::int64_t{3});
    EXPECT_EQ(EngineDesk(settings).engine.snippetAdaptToAbbreviationCaseOption(), 3);
}

// ---- The form ----

TEST(Form, OpensOutsideTheKeyCallbackAndIsShownALittleLater) {
    EngineDesk desk;
    desk.engine.sender().setPlayFeedbackSound(true);
    desk.engine.sender().setFeedbackSound("Click");
    desk.add(u"hi", u"Dear 【field:Name】,");
    desk.type(u"h");
    desk.desktop.typeCharacter(u"i");
    EXPECT_THAT(desk.forms, IsEmpty());
    EXPECT_EQ(desk.screen(), u"");
    desk.loop.advance(0.09);
    ASSERT_THAT(desk.forms, SizeIs(1));
    EXPECT_FALSE(desk.forms[0]->shown);
    desk.loop.advance(0.02);
    EXPECT_TRUE(desk.forms[0]->shown);
    EXPECT_THAT(desk.desktop.sounds().played(), ElementsAre("Pop"));
}

TEST(Form, DoesNotMixUpTwo) {
    EngineDesk desk;
    desk.add(u"hi", u"Dear 【field:Name】, ");
    desk.add(u"bye", u"Farewell, 【field:Name】. ");
    desk.type(u"hibye");
    desk.settle();
    ASSERT_THAT(desk.forms, SizeIs(2));
    desk.forms[1]->accept(u"Bob");
    desk.settle();
    ASSERT_THAT(desk.forms, SizeIs(1));
    desk.forms[0]->accept(u"Ada");
    desk.settle();
    EXPECT_EQ(desk.screen(), u"Farewell, Bob. Dear Ada, ");
    EXPECT_THAT(desk.forms, IsEmpty());
}

TEST(Form, GivesRemoteDesktopsTimeToTakeKeysAgain) {
    EngineDesk desk;
    desk.desktop.activate(u"com.citrix.XenAppViewer");
    desk.service.refreshContextInputSetting();
    desk.add(u"hi", u"Dear 【field:Name】,");
    desk.type(u"hi");
    desk.settle();
    desk.forms.at(0)->accept(u"Ada");
    desk.loop.advance(0.49);
    EXPECT_EQ(desk.screen(), u"");
    desk.loop.advance(0.01);
    EXPECT_EQ(desk.screen(), u"Dear Ada,");
}

// ---- Scripts ----

struct ScriptCase {
    const char* about;
    ExpandTrigger trigger;
    std::u16string content;
    ContentType type;
    std::u16string typed;
    std::u16string screen;
    std::u16string letters;
};

TEST(Scripts, AreDeliveredWhenTheyHaveRun) {
    const ScriptCase cases[] = {
        {"snippet, kept", Kept, u"date", ContentType::ShellScript, u"run ", u"<date> ", u" "},
        {"snippet, swallowed", Swallowed, u"date", ContentType::ShellScript, u"run ", u"<date>", u""},
        {"Apple's", AtOnce, u"beep", ContentType::AppleScript, u"run", u"<beep>", u""},
        {"in rich text", AtOnce, u"1【snippet:za】2", ContentType::RichText, u"run", u"1<a>2", u"1<a>2"},
        {"in a text, kept", Kept, u"【snippet:za】!", ContentType::PlainText, u"run ", u"<a>! ", u"<a>! "},
        {"in a script", Kept, u"say 【snippet:za】", ContentType::ShellScript, u"run ", u"<say <a>> ", u" "},
        {"the text is the abbreviation", AtOnce, u"ru【snippet:za】n", ContentType::PlainText, u"run", u"ru<a>n",
         u"ru<a>n"},
    };
    for (const ScriptCase& one : cases) {
        EngineDesk desk;
        desk.engine.sender().setPlayFeedbackSound(true);
        desk.engine.sender().setFeedbackSound("Click");
        desk.add(u"za", u"a", ExpandTrigger::Never, ContentType::ShellScript);
        desk.add(u"run", one.content, one.trigger, one.type);
        desk.type(one.typed);
        desk.settle();
        EXPECT_EQ(desk.screen(), one.screen) << one.about;
        EXPECT_EQ(desk.engine.letters(), one.letters) << one.about;
        EXPECT_THAT(desk.desktop.sounds().played(), ElementsAre("Click")) << one.about;
        EXPECT_FALSE(desk.engine.undo(true)) << one.about;
    }
}

TEST(Scripts, WithoutResultAddNothing) {
    EngineDesk desk;
    desk.runner.answer = [](const std::u16string&) { return std::nullopt; };
    desk.add(u"za", u"a", ExpandTrigger::Never, ContentType::ShellScript);
    desk.add(u"run", u"date", Kept, ContentType::ShellScript);
    desk.add(u"in", u"1【snippet:za】2", Kept);
    desk.type(u"run ");
    desk.settle();
    EXPECT_EQ(desk.screen(), u"");
    desk.type(u"in ");
    desk.settle();
    EXPECT_EQ(desk.screen(), u"12 ");
}

TEST(Scripts, EndTheChanceToUndoWhatStandsBeforeThem) {
    EngineDesk desk;
    std::promise<void> gate;
    const std::shared_future<void> opened = gate.get_future().share();
    desk.runner.answer = [opened](const std::u16string&) {
        opened.wait();
        return u"<date>";
    };
    const auto script = desk.add(u"now", u"date", AtOnce, ContentType::ShellScript);
    desk.add(u"sig", u"Best");
    desk.type(u"sig");
    desk.engine.sendSnippetDirectly(script);
    EXPECT_FALSE(desk.engine.undo(true));
    desk.type(u"sig");
    gate.set_value();
    desk.settle();
    EXPECT_FALSE(desk.engine.undo(true)) << "the script's output stands behind the expansion";
    EXPECT_EQ(desk.screen(), u"BestBest<date>");
}

TEST(Scripts, RunSideBySideAndDoNotHoldUpTheEngine) {
    EngineDesk desk;
    std::promise<void> gate;
    const std::shared_future<void> opened = gate.get_future().share();
    desk.runner.answer = [opened](const std::u16string& script) -> std::optional<std::u16string> {
        if (script == u"slow") opened.wait();
        return script;
    };
    const auto slow = desk.add(u"za", u"slow", AtOnce, ContentType::ShellScript);
    const auto quick = desk.add(u"zb", u"quick", AtOnce, ContentType::ShellScript);
    desk.add(u"sig", u"Best");
    desk.engine.sendSnippetDirectly(slow);
    desk.engine.sendSnippetDirectly(quick);
    while (desk.screen().empty()) desk.loop.runReady();
    desk.type(u"sig");
    EXPECT_EQ(desk.screen(), u"quickBest");
    EXPECT_TRUE(desk.engine.sender().hasPendingScripts());
    gate.set_value();
    desk.settle();
    EXPECT_FALSE(desk.engine.sender().hasPendingScripts());
    EXPECT_EQ(desk.screen(), u"quickBestslow");
}

TEST(Scripts, ManyAtOnceAllArrive) {
    EngineDesk desk;
    desk.runner.answer = [](const std::u16string&) { return u"."; };
    const auto script = desk.add(u"za", u"a", AtOnce, ContentType::ShellScript);
    constexpr std::size_t Count = 50;
    for (std::size_t i = 0; i < Count; ++i) desk.engine.sendSnippetDirectly(script);
    desk.settle();
    EXPECT_EQ(desk.screen(), std::u16string(Count, u'.'));
}

// Everything that a form or a script brings back after the end would reach what is gone.
TEST(Scripts, AndFormsEndWithTheEngine) {
    EngineDesk desk;
    std::promise<void> gate;
    const std::shared_future<void> opened = gate.get_future().share();
    desk.runner.answer = [opened](const std::u16string&) {
        opened.wait();
        return u"late";
    };
    desk.engine.sendSnippetDirectly(desk.add(u"za", u"slow", AtOnce, ContentType::ShellScript));
    desk.engine.sendSnippetDirectly(desk.add(u"hi", u"Dear 【field:Name】,"));
    desk.loop.runReady();
    ASSERT_THAT(desk.forms, SizeIs(1));
    gate.set_value();
    desk.owner.reset();
    EXPECT_THAT(desk.forms, IsEmpty());
    desk.loop.advance(1);
    EXPECT_EQ(desk.screen(), u"");
}

}  // namespace
}  // namespace plume
