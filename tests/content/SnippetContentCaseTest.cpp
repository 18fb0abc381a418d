#include "content/SnippetContentCase.h"

#include <gtest/gtest.h>

#include "Foundation/Strings.h"
#include "library/SnippetUtils.h"
#include "tests/content/world/ContentWorld.h"

namespace plume {
namespace {

// How letters follow the abbreviation is the business of SnippetUtils::correctedCase.
TEST(SnippetContentCase, FollowsTheAbbreviationAndMovesVariablesWithTextThatGrows) {
    ContentWorld world;
    world.add("sh", "groß", ContentType::ShellScript);
    for (const ContentType type : {ContentType::PlainText, ContentType::RichText}) {
        const auto content =
            world.expand("【|】ß【key:x code:7】ßa【|】【snippet:sh】【field:end】【key:y code:8】", type);
        correctSnippetContentCase(*content, u"SIG", 0);
        EXPECT_EQ(notation(*content), "SSSSAGROSS");
        EXPECT_EQ(describe(content->variables), "caret@0 key7@2 caret@5 script(sh)@5+5 field(end=nil)@10 key8@10");
    }
    const auto arrow = world.expand("ß【▼】");
    correctSnippetContentCase(*arrow, u"SIG", 0);
    EXPECT_EQ(describe(arrow->variables), "key125@2") << "located past the end: it stays there";
    const auto bold = world.expand("hello *world*", ContentType::RichText);
    correctSnippetContentCase(*bold, u"sIg", SnippetUtils::MixedCaseCapitalisesWords);
    EXPECT_EQ(notation(*bold), "Hello *World*");
    const auto words = world.expand("ß【|】 ßa【|】");
    correctSnippetContentCase(*words, u"sIG", 0);
    EXPECT_EQ(words->caretLocation(), static_cast<std::int64_t>(words->string().size()));
    EXPECT_EQ(words->string().substr(words->variables[0]->location, 1), u" ");
}

}  // namespace
}  // namespace plume
