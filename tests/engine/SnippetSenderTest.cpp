// What is sent without typing, and what waits for forms and scripts.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <future>
#include <memory>

#include "tests/engine/EngineDesk.h"

namespace plume {
namespace {

using ::testing::IsEmpty;
using ::testing::SizeIs;

constexpr auto AtOnce = ExpandTrigger::Immediately;

TEST(Expansion, SentDirectlyErasesNothingAndIsUndoneByErasing) {
    EngineDesk desk;
    const auto snippet = desk.add(u"sig", u"Best");
    desk.type(u"x");
    const auto made = snippet->lastTimeUsed();
    desk.engine.sendSnippetDirectly(snippet);
    EXPECT_EQ(desk.screen(), u"xBest");
    EXPECT_EQ(desk.engine.sender().lastUsedSnippet(), snippet);
    EXPECT_GT(snippet->lastTimeUsed(), made);
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

TEST(Form, OpensOutsideTheKeyCallbackAndIsShownALittleLater) {
    EngineDesk desk;
    desk.add(u"h", u"Dear 【field:Name】,");
    desk.desktop.typeCharacter(u"h");
    EXPECT_THAT(desk.forms, IsEmpty());
    desk.loop.advance(0.09);
    ASSERT_THAT(desk.forms, SizeIs(1));
    EXPECT_FALSE(desk.forms[0]->shown);
    desk.loop.advance(0.02);
    EXPECT_TRUE(desk.forms[0]->shown);
    desk.forms[0]->close();
    EXPECT_THAT(desk.forms, SizeIs(1)) << "the form is calling";
    desk.loop.runReady();
    EXPECT_THAT(desk.forms, IsEmpty());
}

TEST(Scripts, RunAfterThoseNestedInThem) {
    EngineDesk desk;
    desk.add(u"za", u"a", ExpandTrigger::Never, ContentType::AppleScript);
    desk.add(u"run", u"say 【snippet:za】", ExpandTrigger::DelimiterKept, ContentType::ShellScript);
    desk.type(u"run ");
    desk.settle();
    EXPECT_EQ(desk.screen(), u"<say <Apple's a>> ");
    EXPECT_EQ(desk.engine.letters(), u" ");
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
