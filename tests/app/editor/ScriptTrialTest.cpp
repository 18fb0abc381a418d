#include "app/editor/ScriptTrial.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "Foundation/Strings.h"
#include "library/SnippetGroup.h"
#include "ports/posix/PosixProcessLauncher.h"

namespace plume {
namespace {

using ::testing::ElementsAre;
using ::testing::HasSubstr;

// Writes what it is given, and keeps it.
class EchoRunner final : public TrialRunner {
  public:
    ScriptOutput run(std::u16string_view script, bool isAppleScript) override {
        scripts.push_back((isAppleScript ? "AppleScript: " : "") + toUtf8(script));
        ScriptOutput written = next;
        if (written.output.empty()) written.output = "<" + toUtf8(script) + ">";
        return written;
    }
    void stop() override {}

    std::vector<std::string> scripts;
    ScriptOutput next;
};

class ScriptTrialTest : public ::testing::Test {
  protected:
    std::shared_ptr<Snippet> add(const std::u16string& abbreviation, const std::u16string& text, ContentType type) {
        auto snippet = std::make_shared<Snippet>(abbreviation, text);
        snippet->setContentType(type);
        group->addItem(snippet);
        return snippet;
    }
    std::shared_ptr<ScriptTrial> tried(const std::u16string& text, TrialRunner& runner,
                                       ContentType type = ContentType::ShellScript) {
        auto trial = ScriptTrial::prepare(add(u"tried", u"stored", type), text, {group}, {}, "en_US");
        if (trial) trial->run(runner);
        return trial;
    }

    std::shared_ptr<SnippetGroup> group = SnippetGroup::make();
    EchoRunner echo;
};

TEST_F(ScriptTrialTest, FieldsHaveWhatTheyBeginWith) {
    EXPECT_FALSE(tried(u"echo", echo)->hasFields());
    EXPECT_TRUE(tried(u"echo 【field:name value:Ada】!", echo)->hasFields());
    EXPECT_THAT(echo.scripts, ElementsAre("echo", "echo Ada!"));
}

TEST_F(ScriptTrialTest, IncludedScriptsRunFirst) {
    add(u"in", u"date", ContentType::ShellScript);
    add(u"plain", u"text", ContentType::PlainText);
    echo.next.error = "oh\n";
    const auto trial = tried(u"a 【snippet:in】 b 【snippet:plain】", echo);
    EXPECT_THAT(echo.scripts, ElementsAre("date", "a <date> b text"));
    EXPECT_EQ(trial->output().text, u"<a <date> b text>");
    EXPECT_EQ(trial->errors().text, u"oh\noh\n");
    EXPECT_EQ(trial->endings().size(), 2U);
}

TEST_F(ScriptTrialTest, WhatEndedAnIncludedScriptIsTold) {
    add(u"in", u"date", ContentType::AppleScript);
    echo.next.end = ScriptEnd::NotStarted;
    const auto trial = tried(u"[【snippet:in】]", echo);
    EXPECT_THAT(echo.scripts, ElementsAre("AppleScript: date", "[]"));
    EXPECT_EQ(trial->endings().front().end, ScriptEnd::NotStarted);
}

TEST_F(ScriptTrialTest, WhatNeverEndsIsNotRun) {
    add(u"loop", u"【snippet:loop2】【snippet:loop2】", ContentType::PlainText);
    add(u"loop2", u"【snippet:loop】【snippet:loop】", ContentType::PlainText);
    EXPECT_EQ(tried(u"【snippet:loop】", echo), nullptr);
}

TEST_F(ScriptTrialTest, LongOutputIsCutBetweenCharacters) {
    echo.next.output = "x";
    while (echo.next.output.size() < 200'001) echo.next.output += "\U0001F600";
    const auto output = tried(u"", echo)->output();
    EXPECT_EQ(output.text.size(), TriedText::MaximumLength - 1);
    EXPECT_EQ(output.text.size() + output.left, 100'001U);
    EXPECT_TRUE(fromUtf8(toUtf8(output.text)) == output.text);
}

TEST_F(ScriptTrialTest, OtherBytesThanTextAreTold) {
    echo.next.output = "a\xFF";
    const auto output = tried(u"", echo)->output();
    EXPECT_FALSE(output.isUtf8);
    EXPECT_EQ(output.text, u"a\uFFFD");
}

// ---- For real ----

class RealScriptTrialTest : public ScriptTrialTest {
  protected:
    PosixProcessLauncher launcher;
};

TEST_F(RealScriptTrialTest, ShellScriptsAndOthersRun) {
    add(u"in", u"x=kept; echo in", ContentType::ShellScript);
    const auto shell = tried(u"echo \"$x 【snippet:in】\"; echo oh >&2; exit 3", *makeTrialRunner(launcher, {}));
    EXPECT_EQ(shell->output().text, u"kept in\n");
    EXPECT_EQ(shell->errors().text, u"oh\n");
    EXPECT_TRUE(shell->endings().back().failed);
    const auto other = tried(u"#!/bin/cat\nitself", *makeTrialRunner(launcher, {}));
    EXPECT_THAT(toUtf8(other->output().text), HasSubstr("itself"));
    EXPECT_FALSE(other->endings().back().failed);
}

TEST_F(RealScriptTrialTest, StopsAtTheLimitAndWhenTold) {
    const auto slow = tried(u"echo begun; sleep 60", *makeTrialRunner(launcher, {.time = 0.05}));
    EXPECT_EQ(slow->endings().back().end, ScriptEnd::TimeLimit);
    const auto runner = makeTrialRunner(launcher, {});
    runner->stop();
    EXPECT_EQ(tried(u"echo", *runner)->endings().back().end, ScriptEnd::Stopped);
}

TEST_F(RealScriptTrialTest, AppleScriptIsRefused) {
    const auto trial = tried(u"beep", *makeTrialRunner(launcher, {}), ContentType::AppleScript);
    EXPECT_EQ(trial->endings().back().end, ScriptEnd::NotStarted);
    EXPECT_THAT(trial->endings().back().problem, HasSubstr("osascript"));
}

}  // namespace
}  // namespace plume
