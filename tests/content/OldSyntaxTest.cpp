// Snippets of the older "%" syntax in today's.
#include <gtest/gtest.h>

#include "content/SnippetParser.h"
#include "tests/content/ContentWorld.h"

namespace plume {
namespace {

std::string converted(std::string_view old) {
    ContentWorld world;
    const auto snippet = world.snippet(old, ContentType::RichText);
    SnippetParser::convertOldSnippet(*snippet);
    return notation(*snippet->richTextContent());
}

TEST(OldSyntax, IsRewritten) {
    struct Case {
        const char* old;
        const char* today;
    };
    const Case cases[] = {
        {"Dear %field:Name%, today is %date:short%%|", "Dear 【field:Name】, today is 【date:short】【|】"},
        {"%time:HH:mm%", "【time:\"HH:mm\"】"},
        {"%snippet:sig%", "【snippet:sig】"},
        {"%fill:Name%", "【field:Name】"},
        {"%field:Last name%", "【field:\"Last name\"】"},
        {"%field:a \"b\"%", "【field:\"a \"\"b\"\"\"】"},
        {"%field:%", "【field:】"},
        {"%key:enter%%key:tab%%key:esc%", "【key:↩ code:36】【key:⇥ code:48】【key:⎋ code:53】"},
        {"%key:space%", "【key:(null) code:0】"},
        {"%clipboard", "【clipboard】"},
        {"%clipboard%|%", "【clipboard】【|】%"},
        {"%<%^%>%v", "【key:← code:123】【key:↑ code:126】【key:→ code:124】【key:↓ code:125】"},
        {"%value", "【key:↓ code:125】alue"},
        {"50%", "50%"},
        {"100% sure", "100% sure"},
        {"%date:short", "%date:short"},
        {"%date:short %|", "【date:\"short \"】|"},
        {"%%|", "%【|】"},
        {"%Date:short%", "%Date:short%"},
        {"%unknown%|", "%unknown【|】"},
        {"【|】", "【|】"},
        {"", ""},
    };
    for (const Case& example : cases) EXPECT_EQ(converted(example.old), example.today) << example.old;
}

TEST(OldSyntax, KeepsTheLookOfThePlaceholder) {
    EXPECT_EQ(converted("*a*_%*date:sh*ort%_*b*"), "*a*_【date:short】_*b*");
}

TEST(OldSyntax, LeavesASnippetWithoutContentAlone) {
    Snippet snippet;
    SnippetParser::convertOldSnippet(snippet);
    EXPECT_FALSE(snippet.hasContent());
}

TEST(OldSyntax, CanBeExpandedAfterwards) {
    ContentWorld world;
    const auto snippet = world.snippet("%field:Last name%x%|%v", ContentType::RichText);
    SnippetParser::convertOldSnippet(*snippet);
    const auto content = SnippetParser(world.environment).parseSnippet(snippet, world.groups);
    EXPECT_EQ(notation(*content), "x");
    EXPECT_EQ(describe(content->variables), "field(Last name=nil)@0 caret@1 key125@1");
}

}  // namespace
}  // namespace plume
