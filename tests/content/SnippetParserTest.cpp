#include "content/SnippetParser.h"

#include <gmock/gmock.h>

#include "Foundation/Strings.h"
#include "Foundation/text/RTFD.h"
#include "tests/content/ContentWorld.h"

namespace plume {
namespace {

using testing::Each;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

struct Case {
    const char* what;
    const char* content;
    const char* text;
    const char* variables = "";
};

bool isBold(const AttributedString& text, std::size_t index) {
    const SharedAttributes attributes = text.attributesAt(index);
    return attributes && attributes->font && attributes->font->bold;
}

void expectExpansions(ContentWorld& world, const std::vector<Case>& cases, ContentType type) {
    for (const Case& example : cases) {
        SCOPED_TRACE(example.what);
        const auto content = world.expand(example.content, type);
        ASSERT_NE(content, nullptr);
        EXPECT_EQ(content->isRich(), type == ContentType::RichText);
        EXPECT_EQ(notation(*content), example.text);
        EXPECT_EQ(describe(content->variables), example.variables);
    }
}

TEST(SnippetParser, ExpandsPlainText) {
    ContentWorld world;
    world.pasteboard.plainText = "clip";
    expectExpansions(
        world,
        {{"nothing", "", ""},
         {"text alone", "Dear Sir", "Dear Sir"},
         {"date", "a【date:yyyy-MM-dd】b", "a2026-03-09b"},
         {"time", "【time:\"HH:mm\"】", "14:05"},
         {"date with an offset", "【date:yyyy-MM-dd day:1】", "2026-03-10"},
         {"caret in front", "【|】x", "x", "caret@0"},
         {"caret behind", "ab【|】", "ab", "caret@2"},
         {"two carets", "【|】a【|】", "a", "caret@0 caret@1"},
         {"left arrow", "x【◀】", "x", "key123@0"},
         {"up arrow", "xyz【▲】", "xyz", "key126@1"},
         {"right arrow", "【▶】", "", "key124@2"},
         {"down arrow", "x【▼】", "x", "key125@3"},
         {"arrow and more is no arrow", "【◀◀】", "【◀◀】"},
         {"bar and more is no caret", "【| 】", "【| 】"},
         {"key", "a【key:↩ code:36 count:3】b", "ab", "key36x3@1"},
         {"field", "Hi 【field:Name】!", "Hi !", "field(Name=nil)@3"},
         {"field without a colon", "【fieldname】", "", "field(=nil)@0"},
         {"fields next to each other", "【field:a】【field:b value:1】", "", "field(a=nil)@0 field(b=1)@0"},
         {"clipboard", "<【clipboard】>", "<clip>"},
         {"clipboard and more", "【clipboards】", "clip"},
         {"clipboard, replaced", "【clipboard find:l replacement:h】", "chip"},
         {"unknown", "a【unknown】b", "a【unknown】b"},
         {"empty", "【】", "【】"},
         {"kinds are written small", "【Date:yyyy】", "【Date:yyyy】"},
         {"unclosed", "【date:short", "【date:short"},
         {"closed only", "a】b", "a】b"},
         {"closed before it opens", "】【", "】【"},
         {"an opening marker belongs to the body", "【【date:yyyy】【date:yyyy】", "【【date:yyyy】2026"},
         {"body in body", "【a【b】】", "【a【b】】"},
         {"known body with an opening marker", "【field:a【b】】", "】", "field(a【b=nil)@0"}},
        ContentType::PlainText);
    EXPECT_THAT(world.reports, IsEmpty());
}

TEST(SnippetParser, TurnsOptionalPlaceholdersOfPlainTextIntoFields) {
    ContentWorld world;
    world.pasteboard.plainText = "clip";
    world.add("sig", "Jo");
    world.add("rich", "*Jo*", ContentType::RichText);
    world.add("sh", "ls", ContentType::ShellScript);
    world.add("deep", "【snippet:sig】");
    expectExpansions(
        world,
        {{"date", "a【date:yyyy optional:1】b", "ab", "field?+(=2026)@1"},
         {"date, not ticked", "【date:yyyy optional:0】", "", "field?(=2026)@0"},
         {"time", "【time:mm optional】", "", "field?(=05)@0"},
         {"clipboard", "【clipboard optional:1】", "", "field?+!(=clip)@0"},
         {"field", "【field:a optional:1】", "", "field?+(a=nil)@0"},
         {"snippet", "<【snippet:sig optional:1】>", "<>", "field?+(=Jo)@1"},
         {"rich snippet in plain text", "【snippet:rich optional】", "", "field?(=Jo)@0"},
         {"a script without placeholders is shown as it stands", "【snippet:sh optional】", "", "field?(=ls)@0"},
         {"a snippet with placeholders is expanded", "【snippet:deep optional】", "Jo"}},
        ContentType::PlainText);
}

TEST(SnippetParser, ExpandsRichText) {
    ContentWorld world;
    world.pasteboard.plainText = "clip";
    world.add("plain", "Jo【|】");
    world.add("rich", "_J_o", ContentType::RichText);
    world.add("sh", "ls", ContentType::ShellScript);
    expectExpansions(world,
                     {{"text alone", "a*b*_c_", "a*b*_c_"},
                      {"a value looks like its opening marker", "a*【*_date:yyyy】_b", "a*2026*b"},
                      {"optional dates are expanded", "【date:yyyy optional:1】", "2026"},
                      {"plain clipboard", "*【clipboard】*", "*clip*"},
                      {"optional plain clipboard", "【clipboard optional:1】", "", "field?+!(=clip)@0"},
                      {"fields, keys and carets", "*a*【field:x】【key:⇥ code:48】*b【|】*", "*ab*",
                       "field(x=nil)@1 key48@1 caret@2"},
                      {"arrow", "*ab*【◀】", "*ab*", "key123@0"},
                      {"plain snippet looks like its placeholder", "*【snippet:plain】*!", "*Jo*!", "caret@2"},
                      {"rich snippet keeps its own look", "*【snippet:rich】!*", "_J_o*!*"},
                      {"optional snippet", "【snippet:rich optional:0】", "", "field?(=Jo|_J_o)@0"},
                      {"optional plain snippet", "【snippet:sh optional:0】", "", "field?(=ls|ls)@0"},
                      {"script", "a*【snippet:sh】*", "a*ls*", "script(sh)@1+2"},
                      {"unknown", "a【*un*known】", "a【*un*known】"},
                      {"unclosed", "*a【b*", "*a【b*"}},
                     ContentType::RichText);
}

TEST(SnippetParser, GivesVariablesOfRichTextTheLookOfTheirMarker) {
    ContentWorld world;
    const auto content = world.expand("a*【field:x】*_【clipboard optional】_", ContentType::RichText);
    ASSERT_EQ(content->variables.size(), 2u);
    ASSERT_NE(content->variables[0]->attributes, nullptr);
    EXPECT_TRUE(content->variables[0]->attributes->font->bold);
    ASSERT_NE(content->variables[1]->attributes, nullptr);
    EXPECT_TRUE(content->variables[1]->attributes->font->italic);
}

TEST(SnippetParser, TakesTheRichestFormOfTheClipboardIntoRichText) {
    ContentWorld world;
    world.pasteboard.plainText = "plain";
    world.pasteboard.rtf = rtfFromAttributedString(rich("r*tf*"));
    EXPECT_EQ(world.expand("<【clipboard】>", ContentType::RichText)->string(), u"<rtf>");
    world.pasteboard.rtfd = rtfdFromAttributedString(rich("*rt*fd"));

    const auto content = world.expand("_<【clipboard】>_", ContentType::RichText);
    EXPECT_EQ(content->string(), u"<rtfd>");
    const auto& text = std::get<AttributedString>(content->content);
    EXPECT_TRUE(isBold(text, 1));
    EXPECT_FALSE(isBold(text, 4));
    ASSERT_NE(text.attributesAt(5), nullptr);
    EXPECT_TRUE(text.attributesAt(5)->font->italic);

    const auto optional = world.expand("【clipboard find:d replacement:x optional:1】", ContentType::RichText);
    ASSERT_EQ(optional->fields().size(), 1u);
    EXPECT_EQ(optional->fields()[0]->value, u"rtfx");
    EXPECT_EQ(optional->fields()[0]->richTextValue->string(), u"rtfx");
    EXPECT_TRUE(optional->fields()[0]->isReadonly);

    EXPECT_EQ(world.expand("【clipboard】")->string(), u"plain");
}

TEST(SnippetParser, PassesOverRichClipboardsThatCannotBeRead) {
    ContentWorld world;
    world.pasteboard.plainText = "plain";
    world.pasteboard.rtf = "no rich text";
    EXPECT_EQ(notation(*world.expand("【clipboard】", ContentType::RichText)), "plain");
}

TEST(SnippetParser, LeavesNothingForAnEmptyClipboard) {
    ContentWorld world;
    EXPECT_EQ(world.expand("<【clipboard】>")->string(), u"<>");
    EXPECT_EQ(world.expand("<【clipboard】>", ContentType::RichText)->string(), u"<>");
    world.environment.pasteboard = nullptr;
    EXPECT_EQ(world.expand("<【clipboard】>")->string(), u"<>");
    EXPECT_EQ(world.expand("<【clipboard】>", ContentType::RichText)->string(), u"<>");
}

TEST(SnippetParser, ReadsTheClipboardOncePerExpansion) {
    ContentWorld world;
    world.pasteboard.plainText = "x";
    EXPECT_EQ(world.expand("【clipboard】【clipboard】【clipboard】")->string(), u"xxx");
    EXPECT_EQ(world.pasteboard.readCount, 1u);
}

TEST(SnippetParser, DoesNotScanWhatTheClipboardBringsIn) {
    ContentWorld world;
    world.pasteboard.plainText = "【date:yyyy】【";
    EXPECT_EQ(toUtf8(world.expand("【clipboard】date:yyyy】")->string()), "【date:yyyy】【date:yyyy】");
}

TEST(SnippetParser, ExpandsScriptSnippetsAsPlainText) {
    ContentWorld world;
    EXPECT_EQ(notation(*world.expand("echo 【date:yyyy】", ContentType::ShellScript)), "echo 2026");
    EXPECT_EQ(notation(*world.expand("say 【date:yyyy】", ContentType::AppleScript)), "say 2026");
}

TEST(SnippetParser, ExpandsNothingWithoutContentOrOfUnknownType) {
    ContentWorld world;
    SnippetParser parser(world.environment);
    EXPECT_EQ(parser.parseSnippet(std::make_shared<Snippet>(), world.groups), nullptr);
    EXPECT_EQ(parser.parseSnippet(nullptr, world.groups), nullptr);
    EXPECT_EQ(world.expand("a", static_cast<ContentType>(4)), nullptr);
    EXPECT_THAT(world.reports, IsEmpty());
}

TEST(SnippetParser, RemembersTheMomentOfTheLastExpansion) {
    ContentWorld world;
    SnippetParser parser(world.environment);
    parser.parseSnippet(world.snippet("a"), world.groups);
    EXPECT_EQ(parser.date(), world.environment.now());
}

TEST(SnippetParser, FinishesLongTextsOfMarkersThatMatchNothing) {
    ContentWorld world;
    std::string opened;
    std::string pairs;
    for (int count = 0; count < 200'000; ++count) {
        opened += "【";
        pairs += "【x】";
    }
    EXPECT_EQ(toUtf8(world.expand(opened)->string()), opened);
    EXPECT_EQ(toUtf8(world.expand(opened, ContentType::RichText)->string()), opened);
    EXPECT_EQ(toUtf8(world.expand(pairs)->string()), pairs);
    EXPECT_EQ(toUtf8(world.expand(opened + "】")->string()), opened + "】");
    EXPECT_THAT(world.reports, IsEmpty());
}

TEST(SnippetParser, ExpandsTenThousandPlaceholdersInRichTextOfManyRuns) {
    ContentWorld world;
    world.add("n", "_N_", ContentType::RichText);
    std::string content;
    std::string expected;
    for (int count = 0; count < 10'000; ++count) {
        content += "*a*【snippet:n】";
        expected += "*a*_N_";
    }
    EXPECT_EQ(notation(*world.expand(content, ContentType::RichText)), expected);
}

TEST(SnippetParser, RefusesMoreReplacementsThanTheLimit) {
    ContentWorld world;
    std::string content;
    for (std::size_t count = 0; count < SnippetParser::MaximumReplacements; ++count) content += "【|】";
    const auto largest = world.expand(content);
    ASSERT_NE(largest, nullptr);
    EXPECT_EQ(largest->variables.size(), SnippetParser::MaximumReplacements);
    EXPECT_EQ(world.expand(content + "【|】"), nullptr);
    EXPECT_EQ(world.reports.size(), 1u);
}

TEST(SnippetParser, RefusesAContentLongerThanTheLimit) {
    ContentWorld world;
    world.add("half", std::string(SnippetParser::MaximumLength / 2, 'x'));
    EXPECT_NE(world.expand("【snippet:half】"), nullptr);
    EXPECT_EQ(world.expand("【snippet:half】【snippet:half】"), nullptr);
    EXPECT_EQ(world.expand("【snippet:half】【snippet:half optional】"), nullptr);
    world.pasteboard.plainText = std::string(SnippetParser::MaximumLength / 2, 'x');
    EXPECT_EQ(world.expand("【clipboard】【clipboard】"), nullptr);
    EXPECT_EQ(world.reports.size(), 3u);
}

}  // namespace
}  // namespace plume
