// The older "%" syntax where docs/content-language.md has no example.
#include "content/OldSyntax.h"

#include <gtest/gtest.h>

#include "tests/content/world/ContentWorld.h"

namespace plume {
namespace {

TEST(OldSyntax, IsRewritten) {
    const struct {
        const char* old;
        const char* today;
    } cases[] = {
        {"%field:a \"b\"%", "【field:\"a \"\"b\"\"\"】"},
        {"%field:%", "【field:】"},
        {"%key:space%", "【key:(null) code:0】"},
        {"%clipboard%|%", "【clipboard】【|】%"},
        {"%value", "【key:↓ code:125】alue"},
        {"50%", "50%"},
        {"%date:short", "%date:short"},
        {"%date:short %|", "【date:\"short \"】|"},
        {"%%|", "%【|】"},
        {"%Date:short%", "%Date:short%"},
        {"%unknown%|", "%unknown【|】"},
        {"*a*_%*date:sh*ort%_*b*", "*a*_【date:short】_*b*"},
        {"", ""},
    };
    for (const auto& [old, today] : cases) {
        const auto snippet = ContentWorld().snippet(old, ContentType::RichText);
        convertOldSnippet(*snippet);
        EXPECT_EQ(notation(*snippet->richTextContent()), today) << old;
    }
    Snippet none;
    convertOldSnippet(none);
    EXPECT_FALSE(none.hasContent());
}

}  // namespace
}  // namespace plume
