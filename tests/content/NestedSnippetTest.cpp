// Snippets within snippets: which one is meant, how its content joins the text around it, and where it ends.
#include <gmock/gmock.h>

#include "Foundation/Strings.h"
#include "content/SnippetParser.h"
#include "tests/content/ContentWorld.h"

namespace plume {
namespace {

using testing::AllOf;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

std::string expandedText(ContentWorld& world, const std::shared_ptr<Snippet>& snippet) {
    const auto content = SnippetParser(world.environment).parseSnippet(snippet, world.groups);
    return content ? notation(*content) : "refused";
}

TEST(NestedSnippet, ScansWhatItBringsInTogetherWithWhatFollows) {
    ContentWorld world;
    world.add("sig", "Jo, 【date:yyyy】");
    world.add("outer", "<【snippet:sig】>");
    world.add("open", "【da");
    world.add("close", "te:yyyy】!");
    world.add("empty", "");
    EXPECT_EQ(notation(*world.expand("a 【snippet:sig】 b")), "a Jo, 2026 b");
    EXPECT_EQ(notation(*world.expand("【snippet:outer】【snippet:outer】")), "<Jo, 2026><Jo, 2026>");
    EXPECT_EQ(notation(*world.expand("【snippet:open】te:yyyy】.")), "2026.");
    EXPECT_EQ(notation(*world.expand("【snippet:open】【snippet:close】")), "【da【snippet:close】");
    EXPECT_EQ(notation(*world.expand("【|】【snippet:close】")), "te:yyyy】!");
    EXPECT_EQ(notation(*world.expand("【snippet:empty】x【snippet:empty】")), "x");
    EXPECT_EQ(notation(*world.expand("*【snippet:open】*te:yyyy】", ContentType::RichText)), "*2026*");
}

TEST(NestedSnippet, VanishesWhenThereIsNoneOrItIsTheOuterOne) {
    ContentWorld world;
    const auto self = world.add("self", "a【snippet:self】b【snippet:other】c");
    world.add("other", "(【snippet:self】)");
    world.add("odd", "x", static_cast<ContentType>(9));
    const auto bare = world.add("bare", "");
    bare->setRichTextContent(std::nullopt);
    EXPECT_EQ(expandedText(world, self), "ab()c");
    EXPECT_EQ(notation(*world.expand("<【snippet:missing】>")), "<>");
    EXPECT_EQ(notation(*world.expand("<【snippet:odd】>")), "<>");
    EXPECT_EQ(notation(*world.expand("<【snippet:bare】>")), "<>");
    EXPECT_EQ(notation(*world.expand("<【snippet:bare】>", ContentType::RichText)), "<>");
    EXPECT_THAT(world.reports, IsEmpty());
}

TEST(NestedSnippet, IsLookedUpByUuidThenPrefixThenOwnGroupThenAnywhere) {
    ContentWorld world;
    world.add("a", "first");
    world.add(";b", "written with the prefix");
    const auto prefixed = world.addGroup();
    prefixed->setAbbreviationPrefix(u";");
    const auto own = world.addGroup();
    own->setAbbreviationPrefix(u"/");
    const auto addTo = [&](const std::shared_ptr<SnippetGroup>& group, const char* abbreviation, const char* content) {
        auto snippet = world.snippet(content);
        snippet->setAbbreviation(fromUtf8(abbreviation));
        group->addItem(snippet);
        return snippet;
    };
    const auto byUuid = addTo(prefixed, "a", "prefixed");
    addTo(prefixed, "c", "c of another group");
    addTo(own, "c", "c of the own group");
    addTo(prefixed, "d", "d anywhere");

    const auto expansion = [&](const std::string& content) {
        const auto snippet = addTo(own, "", "");
        snippet->setPlainTextContent(fromUtf8(content));
        return expandedText(world, snippet);
    };
    const std::string uuid = toUtf8(byUuid->uuid()->toString());
    EXPECT_EQ(expansion("【snippet:a】"), "first");
    EXPECT_EQ(expansion("【snippet:;a】"), "prefixed");
    EXPECT_EQ(expansion("【snippet:;b】"), "written with the prefix");
    EXPECT_EQ(expansion("【snippet:c】"), "c of the own group");
    EXPECT_EQ(expansion("【snippet:/c】"), "c of the own group");
    EXPECT_EQ(expansion("【snippet:d】"), "d anywhere");
    EXPECT_EQ(expansion("【snippet:A】"), "");
    EXPECT_EQ(expansion("【snippet:d uuid:" + uuid + "】"), "prefixed");
    EXPECT_EQ(expansion("【snippet:c uuid:00000000-0000-4000-8000-000000000000】"), "c of the own group");
    EXPECT_EQ(expansion("【snippet:d uuid:nonsense】"), "d anywhere");
}

TEST(NestedSnippet, ScriptsAreExpandedApartAndMarked) {
    ContentWorld world;
    world.add("sh", "echo 【date:yyyy】【key:↩ code:36】!", ContentType::ShellScript);
    world.add("as", "say", ContentType::AppleScript);
    world.add("open", "【da", ContentType::ShellScript);
    world.add("both", "<【snippet:as】>", ContentType::ShellScript);
    const auto content = world.expand("a【snippet:sh】b【snippet:as】【|】");
    EXPECT_EQ(notation(*content), "aecho 2026!bsay");
    EXPECT_EQ(describe(content->variables), "script(sh)@1+10 key36@10 script(as)@12+3 caret@15");
    EXPECT_FALSE(content->abbreviations()[0]->isAppleScript);
    EXPECT_TRUE(content->abbreviations()[1]->isAppleScript);
    EXPECT_EQ(content->abbreviations()[1]->snippet, world.groups[0]->items()[1]);

    EXPECT_EQ(notation(*world.expand("【snippet:open】te:yyyy】")), "【date:yyyy】");
    EXPECT_EQ(describe(world.expand("a【snippet:both】")->variables), "script(both)@1+5 script(as)@2+3");
}

TEST(NestedSnippet, ArrowsInAScriptMoveWithIt) {
    ContentWorld world;
    world.add("sh", "ls【▼】", ContentType::ShellScript);
    EXPECT_EQ(describe(world.expand("ab【snippet:sh】")->variables), "script(sh)@2+2 key125@5");
}

TEST(NestedSnippet, AScriptThatNamesTheOuterSnippetLeavesItOut) {
    ContentWorld world;
    const auto outer = world.add("outer", "<【snippet:sh】>");
    world.add("sh", "echo 【snippet:outer】.", ContentType::ShellScript);
    EXPECT_EQ(expandedText(world, outer), "<echo .>");
}

TEST(NestedSnippet, MutualInclusionIsRefusedAndReported) {
    ContentWorld world;
    const auto start = world.add("start", "【snippet:ping】");
    start->setLabel(u"My letter");
    world.add("ping", "a【snippet:pong】");
    world.add("pong", "b【snippet:ping】");
    EXPECT_EQ(expandedText(world, start), "refused");
    ASSERT_EQ(world.reports.size(), 1u);
    EXPECT_THAT(world.reports[0], HasSubstr("\"My letter\""));
    start->setLabel(u"");
    EXPECT_EQ(expandedText(world, start), "refused");
    EXPECT_THAT(world.reports.back(), HasSubstr("\"start\""));
    EXPECT_EQ(world.expand("【snippet:ping】", ContentType::RichText), nullptr);
    EXPECT_EQ(world.expand("【snippet:ping】", ContentType::ShellScript), nullptr);
}

TEST(NestedSnippet, GrowthWithoutEndIsRefused) {
    ContentWorld world;
    const std::string text(100'000, 'x');
    world.add("ping", text + "【snippet:pong】");
    world.add("pong", text + "【snippet:ping】");
    EXPECT_EQ(world.expand("【snippet:ping】"), nullptr);
    EXPECT_EQ(world.reports.size(), 1u);
}

TEST(NestedSnippet, ScriptsThatIncludeEachOtherAreRefused) {
    ContentWorld world;
    world.add("ping", "【snippet:pong】", ContentType::ShellScript);
    world.add("pong", "【snippet:ping】", ContentType::AppleScript);
    EXPECT_EQ(world.expand("【snippet:ping】"), nullptr);
    EXPECT_EQ(world.expand("【snippet:ping】", ContentType::RichText), nullptr);
    EXPECT_EQ(world.reports.size(), 2u);
}

TEST(NestedSnippet, AFiniteDoublingIsExpanded) {
    ContentWorld world;
    world.add("d0", "x");
    for (int level = 1; level <= 13; ++level) {
        const std::string below = "【snippet:d" + std::to_string(level - 1) + "】";
        world.add("d" + std::to_string(level), below + below);
    }
    EXPECT_EQ(notation(*world.expand("【snippet:d13】")), std::string(8192, 'x'));
    EXPECT_EQ(notation(*world.expand("*【snippet:d13】*", ContentType::RichText)), "*" + std::string(8192, 'x') + "*");
}

}  // namespace
}  // namespace plume
