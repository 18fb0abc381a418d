// Snippets that cannot be sent at once: they wait for a form or a script.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <future>
#include <memory>

#include "tests/engine/SendingDesk.h"

namespace plume {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using ::testing::SizeIs;

constexpr auto AtOnce = ExpandTrigger::Immediately;
constexpr auto Kept = ExpandTrigger::DelimiterKept;
constexpr auto Swallowed = ExpandTrigger::DelimiterSwallowed;

// ---- The form ----

TEST(Form, OpensAfterTheAbbreviationIsErased) {
    SendingDesk desk;
    desk.pipeline.setPlayFeedbackSound(true);
    desk.pipeline.setFeedbackSound("Click");
    desk.add(u"hi", u"Dear 【field:Name】,");
    desk.service.typeText(u"x hi");
    EXPECT_THAT(desk.forms, IsEmpty()) << "the key callback does not wait for a window";
    ASSERT_THAT(desk.service.outputs(), SizeIs(1));
    EXPECT_EQ(desk.lastOutput().backspaceCount, 1U);
    EXPECT_EQ(desk.lastOutput().snippetExpandedContent, nullptr);

    desk.loop.advance(0.09);
    ASSERT_THAT(desk.forms, SizeIs(1));
    EXPECT_FALSE(desk.forms[0]->shown);
    desk.loop.advance(0.02);
    EXPECT_TRUE(desk.forms[0]->shown);
    EXPECT_THAT(desk.sounds.names, ElementsAre("Pop"));
}

struct FormCase {
    const char* about;
    ExpandTrigger trigger;
    std::u16string content;
    ContentType type;
    std::u16string typed;
    std::u16string screen;
};

void PrintTo(const FormCase& one, std::ostream* stream) {
    *stream << one.about;
}

class FilledForm : public ::testing::TestWithParam<FormCase> {};

TEST_P(FilledForm, IsDelivered) {
    const FormCase& one = GetParam();
    SendingDesk desk;
    desk.add(u"zrun", u"run", ExpandTrigger::Never, ContentType::ShellScript);
    desk.add(u"hi", one.content, one.trigger, one.type);
    desk.type(one.typed);
    EXPECT_EQ(desk.screen(), u"x ");
    desk.settle();
    ASSERT_THAT(desk.forms, SizeIs(1));
    desk.forms[0]->accept({u"Ada"});
    desk.settle();
    EXPECT_EQ(desk.screen(), one.screen);
    EXPECT_THAT(desk.forms, IsEmpty());
    EXPECT_FALSE(desk.undo(true));
}

INSTANTIATE_TEST_SUITE_P(
    Contents, FilledForm,
    ::testing::Values(
        FormCase{"at once", AtOnce, u"Dear 【field:Name】,", ContentType::PlainText, u"x hi", u"x Dear Ada,"},
        FormCase{"kept delimiter", Kept, u"Dear 【field:Name】,", ContentType::PlainText, u"x hi ", u"x Dear Ada, "},
        FormCase{"swallowed delimiter", Swallowed, u"【field:Name】!", ContentType::PlainText, u"x hi ", u"x Ada!"},
        FormCase{"rich text", Kept, u"Dear 【field:Name】", ContentType::RichText, u"x hi.", u"x Dear Ada."},
        FormCase{"with a script", Kept, u"【field:Name】【snippet:zrun】", ContentType::PlainText, u"x hi ",
                 u"x Ada<run> "},
        FormCase{"for a script", Kept, u"greet 【field:Name】", ContentType::ShellScript, u"x hi ", u"x <greet Ada> "},
        FormCase{"for a script at once", AtOnce, u"greet 【field:Name】", ContentType::ShellScript, u"x hi",
                 u"x <greet Ada>"}));

TEST(Form, ThatIsClosedDeliversNothing) {
    SendingDesk desk;
    desk.add(u"hi", u"Dear 【field:Name】,");
    desk.type(u"x hi");
    desk.settle();
    desk.forms.at(0)->dismiss();
    desk.settle();
    EXPECT_EQ(desk.screen(), u"x ");
    EXPECT_THAT(desk.forms, IsEmpty());
}

TEST(Form, DoesNotMixUpTwo) {
    SendingDesk desk;
    desk.add(u"hi", u"Dear 【field:Name】, ");
    desk.add(u"bye", u"Farewell, 【field:Name】. ");
    desk.type(u"hibye");
    desk.settle();
    ASSERT_THAT(desk.forms, SizeIs(2));
    desk.forms[1]->accept({u"Bob"});
    desk.settle();
    ASSERT_THAT(desk.forms, SizeIs(1));
    desk.forms[0]->accept({u"Ada"});
    desk.settle();
    EXPECT_EQ(desk.screen(), u"Farewell, Bob. Dear Ada, ");
}

TEST(Form, GivesRemoteDesktopsTimeToTakeKeysAgain) {
    SendingDesk desk;
    desk.processes.setFrontProcess(desk.processes.launch(u"com.citrix.XenAppViewer"));
    desk.service.refreshContextInputSetting();
    desk.add(u"hi", u"Dear 【field:Name】,");
    desk.type(u"hi");
    desk.settle();
    desk.forms.at(0)->accept({u"Ada"});
    EXPECT_EQ(desk.service.broughtToFront(), 1);
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
    std::uint64_t backspaces;
    std::u16string letters;
};

void PrintTo(const ScriptCase& one, std::ostream* stream) {
    *stream << one.about;
}

class Scripts : public ::testing::TestWithParam<ScriptCase> {};

TEST_P(Scripts, AreDeliveredWhenTheyHaveRun) {
    const ScriptCase& one = GetParam();
    SendingDesk desk;
    desk.pipeline.setPlayFeedbackSound(true);
    desk.pipeline.setFeedbackSound("Click");
    desk.add(u"za", u"a", ExpandTrigger::Never, ContentType::ShellScript);
    desk.add(u"zb", u"b", ExpandTrigger::Never, ContentType::ShellScript);
    desk.add(u"run", one.content, one.trigger, one.type);
    desk.service.typeText(one.typed);
    EXPECT_THAT(desk.service.outputs(), SizeIs(1)) << "the abbreviation goes at once, and nothing else comes";
    EXPECT_EQ(desk.lastOutput().backspaceCount, one.backspaces);
    EXPECT_TRUE(desk.lastOutput().cancelTrigger);

    desk.settle();
    ASSERT_THAT(desk.service.outputs(), SizeIs(2));
    EXPECT_EQ(desk.lastOutput().trigger, SnippetTrigger::ScriptResult);
    EXPECT_EQ(desk.screen(), one.screen);
    EXPECT_EQ(desk.engine.letters(), one.letters);
    EXPECT_THAT(desk.sounds.names, ElementsAre("Click"));
    EXPECT_FALSE(desk.undo(true));
}

INSTANTIATE_TEST_SUITE_P(
    Contents, Scripts,
    ::testing::Values(
        ScriptCase{"snippet", AtOnce, u"date", ContentType::ShellScript, u"run", u"<date>", 2, u""},
        ScriptCase{"snippet, kept delimiter", Kept, u"date", ContentType::ShellScript, u"run ", u"<date> ", 3, u" "},
        ScriptCase{"snippet, swallowed", Swallowed, u"date", ContentType::ShellScript, u"run ", u"<date>", 3, u""},
        ScriptCase{"Apple's", AtOnce, u"beep", ContentType::AppleScript, u"run", u"<beep>", 2, u""},
        ScriptCase{"in a text", AtOnce, u"1【snippet:za】2【snippet:zb】3", ContentType::PlainText, u"run",
                   u"1<a>2<b>3", 2, u"1<a>2<b>3"},
        ScriptCase{"in rich text", AtOnce, u"1【snippet:za】2", ContentType::RichText, u"run", u"1<a>2", 2, u"1<a>2"},
        ScriptCase{"in a text, kept", Kept, u"【snippet:za】!", ContentType::PlainText, u"run ", u"<a>! ", 3, u"<a>!"},
        ScriptCase{"in a script", Kept, u"say 【snippet:za】", ContentType::ShellScript, u"run ", u"<say <a>> ", 3,
                   u" "}));

TEST(Scripts, WithoutResultAddNothing) {
    SendingDesk desk;
    desk.runner.answer = [](const std::u16string&) { return std::nullopt; };
    desk.add(u"za", u"a", ExpandTrigger::Never, ContentType::ShellScript);
    desk.add(u"run", u"date", Kept, ContentType::ShellScript);
    desk.add(u"in", u"1【snippet:za】2", Kept);
    desk.type(u"run ");
    desk.settle();
    EXPECT_EQ(desk.screen(), u"");
    EXPECT_THAT(desk.service.outputs(), SizeIs(1));
    desk.type(u"in ");
    desk.settle();
    EXPECT_EQ(desk.screen(), u"12 ");
}

TEST(Scripts, RunSideBySideAndDoNotHoldUpTheEngine) {
    SendingDesk desk;
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
    EXPECT_TRUE(desk.pipeline.hasPendingScripts());
    gate.set_value();
    desk.settle();
    EXPECT_FALSE(desk.pipeline.hasPendingScripts());
    EXPECT_EQ(desk.screen(), u"quickBestslow");
}

TEST(Scripts, ManyAtOnceAllArrive) {
    SendingDesk desk;
    desk.runner.answer = [](const std::u16string&) { return u"."; };
    const auto script = desk.add(u"za", u"a", AtOnce, ContentType::ShellScript);
    constexpr std::size_t count = 50;
    for (std::size_t i = 0; i < count; ++i) desk.engine.sendSnippetDirectly(script);
    desk.settle();
    EXPECT_EQ(desk.screen(), std::u16string(count, u'.'));
    EXPECT_THAT(desk.runner.ran(), SizeIs(count));
}

// Everything that a form or a script brings back after the end would reach what is gone.
TEST(Scripts, AndFormsEndWithThePipeline) {
    SimulatedProcessManager processes;
    SimulatedInputSources sources;
    MemoryUserDefaults defaults;
    SimulatedRunLoop loop;
    SimulatedInputService service{processes, sources, loop};
    BundleIdentifierResolver resolver{processes};
    SnippetParser parser{ContentEnvironment{}};
    PrefixSuggestions suggestions;
    AnsweringRunner runner;
    std::vector<TestForm*> forms;
    std::promise<void> gate;
    const std::shared_future<void> opened = gate.get_future().share();
    runner.answer = [opened](const std::u16string&) {
        opened.wait();
        return u"late";
    };
    {
        SendingPipeline pipeline({service, parser, runner, nullptr,
                                  [&](std::shared_ptr<SnippetExpandedContent> content, FieldsEditor::Target& target) {
                                      return std::make_unique<TestForm>(std::move(content), target, forms);
                                  },
                                  [](const std::string&) {}});
        AutoText engine({service, resolver, sources, defaults, pipeline, suggestions, nullptr, nullptr, nullptr});
        const auto script = std::make_shared<Snippet>(u"za", u"slow");
        script->setContentType(ContentType::ShellScript);
        const auto letter = std::make_shared<Snippet>(u"hi", u"Dear 【field:Name】,");
        engine.sendSnippetDirectly(script);
        engine.sendSnippetDirectly(letter);
        loop.runReady();
        ASSERT_THAT(forms, SizeIs(1));
        gate.set_value();
    }
    EXPECT_THAT(forms, IsEmpty());
    const std::size_t sent = service.outputs().size();
    loop.runUntilIdle();
    EXPECT_EQ(service.outputs().size(), sent);
}

}  // namespace
}  // namespace plume
