#include "app/ContentPreview.h"

#include <gtest/gtest.h>

#include "Foundation/Strings.h"
#include "tests/content/world/ContentWorld.h"

namespace plume {
namespace {

std::string shown(ContentWorld& world, std::string_view content, ContentType type = ContentType::PlainText) {
    const auto preview = previewOf(world.snippet(content, type), world.groups, world.environment, "en_US");
    if (!preview) return "nothing";
    const auto* rich = std::get_if<AttributedString>(&preview->content);
    return (preview->isScript ? "script: " : "") + (rich ? notation(*rich) : toUtf8(preview->text()));
}

TEST(ContentPreview, SaysWhatWillComeOut) {
    ContentWorld world;
    world.pasteboard.plainText = "copied";
    world.add("now", "touch /tmp/x", ContentType::ShellScript);
    world.add("sig", "Regards");
    const struct {
        const char* content;
        const char* shown;
    } cases[] = {
        {"plain", "plain"},
        {"on 【date:yyyy-MM-dd】", "on 2026-03-09"},
        {"“【clipboard】”", "“copied”"},
        {"a【|】b【key:return】", "ab"},
        {"Dear 【field:name】,", "Dear [name],"},
        {"Dear 【field:name value:Ann】,", "Dear Ann,"},
        {"it is 【snippet:now】", "it is [now]"},
        {"【snippet:sig】!", "Regards!"},
        {"【snippet:none】", ""},
    };
    for (const auto& each : cases) EXPECT_EQ(shown(world, each.content), each.shown) << each.content;
    EXPECT_EQ(shown(world, "echo 【field:name】", ContentType::ShellScript), "script: echo [name]");
    EXPECT_EQ(shown(world, "*Dear* 【field:name】", ContentType::RichText), "*Dear* [name]");
}

// What was only looked at is told when it is used.
TEST(ContentPreview, TellsNobodyOfWhatCannotWork) {
    ContentWorld world;
    world.pasteboard.plainText = "copied";
    const char* content = "【clipboard find:(seen-once replacement:x flags:1】";
    static_cast<void>(shown(world, content));
    EXPECT_TRUE(world.reports.empty());
    const auto used = world.expand(content);
    EXPECT_FALSE(world.reports.empty());
}

TEST(ContentPreview, LeavesTheSnippetAsItIs) {
    ContentWorld world;
    const auto snippet = world.snippet("Dear 【field:name】");
    const auto first = previewOf(snippet, world.groups, world.environment, "en_US");
    const auto second = previewOf(snippet, world.groups, world.environment, "en_US");
    ASSERT_TRUE(first && second);
    EXPECT_EQ(first->text(), second->text());
    EXPECT_EQ(snippet->plainTextContent(), u"Dear 【field:name】");
}

}  // namespace
}  // namespace plume
