// Snippets within snippets: which one is meant, how its content joins the text around it, and where it ends.
#include <gmock/gmock.h>

#include "Foundation/Strings.h"
#include "content/SnippetParser.h"
#include "tests/content/world/ContentWorld.h"

namespace plume {
namespace {

using testing::HasSubstr;
using testing::IsEmpty;
using testing::SizeIs;

std::string expandedText(ContentWorld& world, const std::shared_ptr<Snippet>& snippet) {
    const auto content = SnippetParser(world.environment).parseSnippet(snippet, world.groups);
    return content ? notation(*content) : "refused";
}

TEST(NestedSnippets, JoinTheTextAroundThemOrVanish) {
    ContentWorld world;
    const auto self = world.add("self", "a【snippet:self】b【snippet:other】c【snippet:sh】");
    world.add("other", "(【snippet:self】)");
    world.add("sh", "echo 【snippet:self】.", ContentType::ShellScript);
    world.add("open", "【da");
    world.add("odd", "x", static_cast<ContentType>(9));
    world.add("bare", "")->setRichTextContent(std::nullopt);
    EXPECT_EQ(expandedText(world, self), "ab()cecho .") << "the outer one, wherever it is named";
    EXPECT_EQ(notation(*world.expand("*【snippet:open】*te:yyyy】", ContentType::RichText)), "*2026*");
    for (const ContentType type : {ContentType::PlainText, ContentType::RichText}) {
        EXPECT_EQ(notation(*world.expand("<【snippet:missing】【snippet:odd】【snippet:bare】>", type)), "<>");
    }
    EXPECT_THAT(world.reports, IsEmpty());
}

TEST(NestedSnippets, AreLookedUpByUuidThenPrefixThenOwnGroupThenAnywhere) {
    ContentWorld world;
    world.add("a", "first");
    world.add(";b", "written with the prefix");
    const auto prefixed = world.addGroup();
    prefixed->setAbbreviationPrefix(u";");
    const auto own = world.addGroup();
    own->setAbbreviationPrefix(u"/");
    const auto addTo = [&](const std::shared_ptr<SnippetGroup>& group, const char* abbreviation,
                           const std::string& content) {
        auto snippet = world.snippet(content);
        snippet->setAbbreviation(fromUtf8(abbreviation));
        group->addItem(snippet);
        return snippet;
    };
    const std::string uuid = toUtf8(addTo(prefixed, "a", "prefixed")->uuid()->toString());
    addTo(prefixed, "c", "c of another group");
    addTo(own, "c", "c of the own group");
    addTo(prefixed, "d", "d anywhere");
    const struct {
        std::string name;
        const char* found;
    } cases[] = {
        {"a", "first"},
        {";a", "prefixed"},
        {";b", "written with the prefix"},
        {"c", "c of the own group"},
        {"/c", "c of the own group"},
        {"d", "d anywhere"},
        {"A", ""},
        {"d uuid:" + uuid, "prefixed"},
        {"c uuid:00000000-0000-4000-8000-000000000000", "c of the own group"},
        {"d uuid:nonsense", "d anywhere"},
    };
    for (const auto& [name, found] : cases) {
        EXPECT_EQ(expandedText(world, addTo(own, "", "【snippet:" + name + "】")), found) << name;
    }
}

TEST(NestedSnippets, ScriptsKnowWhatTheyAre) {
    ContentWorld world;
    world.add("sh", "ls", ContentType::ShellScript);
    const auto say = world.add("as", "say", ContentType::AppleScript);
    const auto scripts = world.expand("【snippet:sh】【snippet:as】")->abbreviations();
    EXPECT_FALSE(scripts[0]->isAppleScript);
    EXPECT_TRUE(scripts[1]->isAppleScript);
    EXPECT_EQ(scripts[1]->snippet, say);
}

TEST(NestedSnippets, InclusionWithoutEndIsRefusedAndReported) {
    ContentWorld world;
    const auto start = world.add("start", "【snippet:ping】");
    start->setLabel(u"My letter");
    world.add("ping", "a【snippet:pong】");
    world.add("pong", "b【snippet:ping】");
    world.add("shell", "【snippet:apple】", ContentType::ShellScript);
    world.add("apple", "【snippet:shell】", ContentType::AppleScript);
    const std::string text(100'000, 'x');
    world.add("grow", text + "【snippet:growing】");
    world.add("growing", text + "【snippet:grow】");
    EXPECT_EQ(expandedText(world, start), "refused");
    EXPECT_THAT(world.reports.back(), HasSubstr("\"My letter\""));
    start->setLabel(u"");
    EXPECT_EQ(expandedText(world, start), "refused");
    EXPECT_THAT(world.reports.back(), HasSubstr("\"start\""));
    EXPECT_EQ(world.expand("【snippet:ping】", ContentType::RichText), nullptr);
    EXPECT_EQ(world.expand("【snippet:ping】", ContentType::ShellScript), nullptr);
    EXPECT_EQ(world.expand("【snippet:shell】"), nullptr);
    EXPECT_EQ(world.expand("【snippet:shell】", ContentType::RichText), nullptr);
    EXPECT_EQ(world.expand("【snippet:grow】"), nullptr);
    EXPECT_THAT(world.reports, SizeIs(7));
}

}  // namespace
}  // namespace plume
