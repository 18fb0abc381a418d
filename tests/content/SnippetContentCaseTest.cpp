#include "content/SnippetContentCase.h"

#include <gtest/gtest.h>

#include "Foundation/Strings.h"
#include "library/SnippetUtils.h"
#include "tests/content/world/ContentWorld.h"

namespace plume {
namespace {

struct Case {
    const char* content;
    const char* typed;
    const char* text;
    const char* variables = "";
    std::int64_t flags = 0;
};

TEST(SnippetContentCase, FollowsTheTypedAbbreviation) {
    const Case cases[] = {
        {"hello *world*", "sig", "hello *world*"},
        {"hello *world*", "Sig", "Hello *world*"},
        {"hello *world*", "SIG", "HELLO *WORLD*"},
        {"hello *world*", "sIG", "Hello *World*"},
        {"hello *world*", "sIg", "hello *world*"},
        {"hello *world*", "sIg", "Hello *World*", "", SnippetUtils::MixedCaseCapitalisesWords},
        {"(note)", "Sig", "(note)"},
        {"", "Sig", ""},
        {"a【|】b", "SIG", "AB", "caret@1"},
    };
    ContentWorld world;
    for (const Case& example : cases) {
        SCOPED_TRACE(std::string(example.content) + " as " + example.typed);
        for (const ContentType type : {ContentType::PlainText, ContentType::RichText}) {
            if (type == ContentType::PlainText && std::string_view(example.content).find('*') != std::string::npos) {
                continue;
            }
            const auto content = world.expand(example.content, type);
            correctSnippetContentCase(*content, fromUtf8(example.typed), example.flags);
            EXPECT_EQ(notation(*content), example.text);
            EXPECT_EQ(describe(content->variables), example.variables);
        }
    }
}

TEST(SnippetContentCase, VariablesMoveWithTextThatGrows) {
    ContentWorld world;
    world.add("sh", "groß", ContentType::ShellScript);
    for (const ContentType type : {ContentType::PlainText, ContentType::RichText}) {
        const auto content =
            world.expand("【|】ß【key:x code:7】ßa【|】【snippet:sh】【field:end】【key:y code:8】", type);
        correctSnippetContentCase(*content, u"SIG", 0);
        EXPECT_EQ(notation(*content), "SSSSAGROSS");
        EXPECT_EQ(describe(content->variables), "caret@0 key7@2 caret@5 script(sh)@5+5 field(end=nil)@10 key8@10");
    }
    const auto words = world.expand("ß【|】 ßa【|】");
    correctSnippetContentCase(*words, u"sIG", 0);
    EXPECT_EQ(words->caretLocation(), static_cast<std::int64_t>(words->string().size()));
    EXPECT_EQ(words->string().substr(words->variables[0]->location, 1), u" ");
}

TEST(SnippetContentCase, ArrowsLocatedPastTheEndStayThere) {
    ContentWorld world;
    const auto content = world.expand("ß【▼】");
    correctSnippetContentCase(*content, u"SIG", 0);
    EXPECT_EQ(notation(*content), "SS");
    EXPECT_EQ(describe(content->variables), "key125@2");
}

}  // namespace
}  // namespace plume
