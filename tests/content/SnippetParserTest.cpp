// What the examples of docs/content-language.md and the model do not show: rich text, the clipboard's forms, and
// limits.
#include "content/SnippetParser.h"

#include <gmock/gmock.h>

#include "Foundation/Strings.h"
#include "Foundation/text/RTFD.h"
#include "content/ExpansionContext.h"
#include "tests/content/world/ContentWorld.h"

namespace plume {
namespace {

using testing::IsEmpty;
using testing::SizeIs;

constexpr auto Plain = ContentType::PlainText;
constexpr auto Rich = ContentType::RichText;

TEST(SnippetParser, ExpandsEveryType) {
    ContentWorld world;
    world.pasteboard.plainText = "clip";
    world.add("plain", "Jo【|】");
    world.add("rich", "_J_o", Rich);
    world.add("sh", "ls", ContentType::ShellScript);
    const struct {
        const char* what;
        ContentType type;
        const char* content;
        const char* text;
        const char* variables = "";
    } cases[] = {
        {"nothing", Plain, "", ""},
        {"a rich snippet in a field of plain text", Plain, "【snippet:rich optional】", "", "field?(=Jo)@0"},
        {"optional script", Plain, "a【snippet:sh optional】", "als", "field?!(=sh)@1 script(sh)@1+2"},
        {"shell script", ContentType::ShellScript, "echo 【date:yyyy】", "echo 2026"},
        {"AppleScript", ContentType::AppleScript, "say 【date:yyyy】", "say 2026"},
        {"plain clipboard in rich text", Rich, "*【clipboard】*", "*clip*"},
        {"optional plain clipboard", Rich, "【clipboard optional:1】", "", "field?+!(=clip)@0"},
        {"variables", Rich, "*a*【field:x】【key:⇥ code:48】*b【|】*", "*ab*", "field(x=nil)@1 key48@1 caret@2"},
        {"arrow", Rich, "*ab*【◀】", "*ab*", "key123@0"},
        {"plain snippet looks like its placeholder", Rich, "*【snippet:plain】*!", "*Jo*!", "caret@2"},
        {"rich snippet keeps its own look", Rich, "*【snippet:rich】!*", "_J_o*!*"},
        {"optional snippet", Rich, "【snippet:rich optional:0】", "", "field?(=Jo|_J_o)@0"},
        {"script", Rich, "a*【snippet:sh】*", "a*ls*", "script(sh)@1+2"},
        {"unknown and unclosed", Rich, "a【*un*known】*a【b*", "a【*un*known】*a【b*"},
    };
    for (const auto& example : cases) {
        SCOPED_TRACE(example.what);
        const auto content = world.expand(example.content, example.type);
        ASSERT_NE(content, nullptr);
        EXPECT_EQ(content->isRich(), example.type == Rich);
        EXPECT_EQ(notation(*content), example.text);
        EXPECT_EQ(describe(content->variables), example.variables);
    }
}

TEST(SnippetParser, GivesVariablesOfRichTextTheLookOfTheirMarker) {
    ContentWorld world;
    const auto content = world.expand("a*【field:x】*_【clipboard optional】_", Rich);
    ASSERT_THAT(content->variables, SizeIs(2));
    EXPECT_TRUE(content->variables[0]->attributes->font->bold);
    EXPECT_TRUE(content->variables[1]->attributes->font->italic);
}

TEST(SnippetParser, TakesTheRichestReadableFormOfTheClipboardIntoRichText) {
    ContentWorld world;
    const auto expanded = [&](const char* content) { return toUtf8(world.expand(content, Rich)->string()); };
    world.pasteboard.plainText = "plain";
    world.pasteboard.rtf = "no rich text";
    EXPECT_EQ(expanded("<【clipboard】>"), "<plain>");
    world.pasteboard.rtf = rtfFromAttributedString(rich("r*tf*"));
    EXPECT_EQ(expanded("<【clipboard】>"), "<rtf>");
    world.pasteboard.rtfd = rtfdFromAttributedString(rich("*rt*fd"));
    EXPECT_EQ(expanded("<【clipboard】>"), "<rtfd>");

    const auto content = world.expand("_<【clipboard】>_", Rich);
    const auto& text = std::get<AttributedString>(content->content);
    EXPECT_EQ(notation(text.substring({0, 1})) + notation(text.substring({5, 1})), "_<__>_");
    EXPECT_EQ(notation(text.substring({1, 4})), "*rt*fd");

    const auto optional = world.expand("【clipboard find:d replacement:x optional:1】", Rich);
    ASSERT_THAT(optional->fields(), SizeIs(1));
    EXPECT_EQ(optional->fields()[0]->value, u"rtfx");
    EXPECT_EQ(optional->fields()[0]->richTextValue->string(), u"rtfx");
    EXPECT_TRUE(optional->fields()[0]->isReadonly);
    EXPECT_EQ(world.expand("【clipboard】")->string(), u"plain");
}

TEST(SnippetParser, ReadsTheClipboardOnceAndBearsThatThereIsNone) {
    ContentWorld world;
    for (const PasteboardReader* pasteboard :
         {world.environment.pasteboard, static_cast<const PasteboardReader*>(nullptr)}) {
        world.environment.pasteboard = pasteboard;
        for (const ContentType type : {Plain, Rich}) {
            EXPECT_EQ(world.expand("<【clipboard】>", type)->string(), u"<>");
        }
    }
    world.environment.pasteboard = &world.pasteboard;
    world.pasteboard.plainText = "x";
    world.pasteboard.readCount = 0;
    EXPECT_EQ(world.expand("【clipboard】【clipboard】【clipboard】")->string(), u"xxx");
    EXPECT_EQ(world.pasteboard.readCount, 1u);
}

TEST(SnippetParser, ExpandsNothingWithoutContentOrOfUnknownType) {
    ContentWorld world;
    SnippetParser parser(world.environment);
    EXPECT_EQ(parser.parseSnippet(std::make_shared<Snippet>(), world.groups), nullptr);
    EXPECT_EQ(parser.parseSnippet(nullptr, world.groups), nullptr);
    EXPECT_EQ(world.expand("a", static_cast<ContentType>(4)), nullptr);
    EXPECT_THAT(world.reports, IsEmpty());
    EXPECT_EQ(parser.date(), world.environment.now()) << "the moment of the last expansion";
}

TEST(SnippetParser, FinishesLongTextsOfMarkersThatMatchNothing) {
    ContentWorld world;
    std::string opened;
    std::string pairs;
    for (int count = 0; count < 200'000; ++count) {
        opened += "【";
        pairs += "【x】";
    }
    for (const std::string& text : {opened, pairs, opened + "】"}) {
        EXPECT_EQ(toUtf8(world.expand(text)->string()), text);
        EXPECT_EQ(toUtf8(world.expand(text, Rich)->string()), text);
    }
    EXPECT_THAT(world.reports, IsEmpty());
}

TEST(SnippetParser, ExpandsTenThousandPlaceholdersInRichTextOfManyRuns) {
    ContentWorld world;
    world.add("n", "_N_", Rich);
    std::string content;
    std::string expected;
    for (int count = 0; count < 10'000; ++count) {
        content += "*a*【snippet:n】";
        expected += "*a*_N_";
    }
    EXPECT_EQ(notation(*world.expand(content, Rich)), expected);
}

TEST(SnippetParser, RefusesMoreThanItsLimits) {
    ContentWorld world;
    std::string content;
    for (std::size_t count = 0; count < ExpansionContext::MaximumReplacements; ++count) content += "【|】";
    EXPECT_THAT(world.expand(content)->variables, SizeIs(ExpansionContext::MaximumReplacements));
    EXPECT_EQ(world.expand(content + "【|】"), nullptr);

    const std::string half(ExpansionContext::MaximumLength / 2, 'x');
    world.add("half", half);
    world.pasteboard.plainText = half;
    EXPECT_NE(world.expand("【snippet:half】"), nullptr);
    EXPECT_EQ(world.expand("【snippet:half】【snippet:half】"), nullptr);
    EXPECT_EQ(world.expand("【snippet:half】【snippet:half optional】"), nullptr);
    EXPECT_EQ(world.expand("【clipboard】【clipboard】"), nullptr);
    EXPECT_THAT(world.reports, SizeIs(4));
}

}  // namespace
}  // namespace plume
