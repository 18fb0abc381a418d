// Cutting scripts out of a content, and putting their output in.
#include <gmock/gmock.h>

#include "Foundation/Strings.h"
#include "content/SnippetParser.h"
#include "tests/content/ContentWorld.h"

namespace plume {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

// "3:echo" is a script at 3, "3:echo (5:ls)" one with a nested one in it.
std::string describe(const std::vector<std::shared_ptr<PLScript>>& scripts) {
    std::string text;
    for (const auto& script : scripts) {
        if (!text.empty()) text += " ";
        text += std::to_string(script->location) + ":" + toUtf8(script->script);
        if (!script->nestedScripts.empty()) text += " (" + describe(script->nestedScripts) + ")";
    }
    return text;
}

struct Case {
    const char* what;
    const char* content;
    const char* cut;
    const char* scripts;
    const char* variables;
    // With every script replaced by its text in capitals.
    const char* delivered;
    const char* deliveredVariables;
};

void runScripts(const std::vector<std::shared_ptr<PLScript>>& scripts) {
    for (const auto& script : scripts) script->result = uppercased(script->script);
}

class ScriptCutting : public testing::TestWithParam<ContentType> {};

TEST_P(ScriptCutting, CutsAndPutsIn) {
    ContentWorld world;
    world.add("ls", "ls", ContentType::ShellScript);
    world.add("say", "say", ContentType::AppleScript);
    world.add("both", "[【snippet:ls】;【snippet:say】]", ContentType::ShellScript);
    world.add("deep", "{【snippet:both】}", ContentType::ShellScript);
    world.add("only", "【snippet:ls】", ContentType::ShellScript);
    world.add("keyed", "a【key:x code:7】b", ContentType::ShellScript);
    world.add("none", "", ContentType::ShellScript);
    const Case cases[] = {
        {"no script", "ab【|】", "ab", "", "caret@2", "ab", "caret@2"},
        {"text around", "a【snippet:ls】b", "ab", "1:ls", "", "aLSb", ""},
        {"two in a row", "【snippet:ls】【snippet:say】.", ".", "0:ls 0:say", "", "LSSAY.", ""},
        {"two apart", "a【snippet:ls】b【snippet:say】c", "abc", "1:ls 2:say", "", "aLSbSAYc", ""},
        {"caret in front", "【|】【snippet:ls】", "", "0:ls", "caret@0", "LS", "caret@0"},
        {"caret behind", "【snippet:ls】【|】", "", "0:ls", "caret@0", "LS", "caret@2"},
        {"carets all around", "【|】【snippet:ls】【|】【snippet:say】【|】x【|】", "x", "0:ls 0:say",
         "caret@0 caret@0 caret@0 caret@1", "LSSAYx", "caret@0 caret@2 caret@5 caret@6"},
        {"key in a script", "a【snippet:keyed】b【|】", "ab", "1:ab", "key7@1 caret@2", "aABb", "key7@3 caret@4"},
        {"nested", "<【snippet:both】>", "<>", "1:[;] (1:ls 2:say)", "", "<[;]>", ""},
        {"nested twice", "【snippet:deep】", "", "0:{} (1:[;] (1:ls 2:say))", "", "{}", ""},
        {"nothing but a nested one", "【snippet:only】", "", "0: (0:ls)", "", "", ""},
        {"empty scripts", "a【snippet:none】【snippet:none】b", "ab", "1: (0:)", "", "ab", ""},
        {"arrow behind", "ab【snippet:ls】【◀】", "ab", "2:ls", "key123@0", "abLS", "key123@0"},
    };
    for (const Case& example : cases) {
        SCOPED_TRACE(example.what);
        const auto content = world.expand(example.content, GetParam());
        SnippetParser::processScripts(*content);
        EXPECT_EQ(notation(*content), example.cut);
        EXPECT_EQ(describe(content->scripts), example.scripts);
        EXPECT_EQ(describe(content->variables), example.variables);
        EXPECT_THAT(content->abbreviations(), IsEmpty());
        runScripts(content->scripts);
        SnippetParser::mergeScriptResults(*content);
        EXPECT_EQ(notation(*content), example.delivered);
        EXPECT_EQ(describe(content->variables), example.deliveredVariables);
    }
}

INSTANTIATE_TEST_SUITE_P(PlainAndRich, ScriptCutting, testing::Values(ContentType::PlainText, ContentType::RichText));

TEST(ScriptCutting, OutputLooksLikeItsPlaceholder) {
    ContentWorld world;
    world.add("ls", "ls", ContentType::ShellScript);
    const auto content = world.expand("_a_*【snippet:ls】*_b_", ContentType::RichText);
    SnippetParser::processScripts(*content);
    EXPECT_EQ(notation(*content), "_ab_");
    runScripts(content->scripts);
    SnippetParser::mergeScriptResults(*content);
    EXPECT_EQ(notation(*content), "_a_*LS*_b_");
}

TEST(ScriptCutting, ScriptsKnowTheirPlaceholder) {
    ContentWorld world;
    world.add("say", "say", ContentType::AppleScript);
    const auto content = world.expand("【snippet:say】");
    const auto variable = content->abbreviations()[0];
    SnippetParser::processScripts(*content);
    ASSERT_EQ(content->scripts.size(), 1u);
    EXPECT_EQ(content->scripts[0]->snippetVariable, variable);
    EXPECT_TRUE(content->scripts[0]->isAppleScript);
}

TEST(ScriptCutting, AScriptWithoutOutputLeavesNothing) {
    ContentWorld world;
    world.add("ls", "ls", ContentType::ShellScript);
    const auto content = world.expand("a【snippet:ls】b【|】");
    SnippetParser::processScripts(*content);
    SnippetParser::mergeScriptResults(*content);
    EXPECT_EQ(notation(*content), "ab");
    EXPECT_EQ(describe(content->variables), "caret@2");
}

TEST(ScriptCutting, FormValuesAreCutOutWithTheScriptTheyLieIn) {
    ContentWorld world;
    world.add("sh", "echo 【field:what】;", ContentType::ShellScript);
    const auto content = world.expand("a【snippet:sh】【field:x】b");
    content->fields()[0]->value = u"hello";
    content->fields()[1]->value = u"X";
    SnippetParser::mergeFields(*content);
    SnippetParser::processScripts(*content);
    EXPECT_EQ(notation(*content), "aXb");
    EXPECT_EQ(describe(content->scripts), "1:echo hello;");
}

TEST(ScriptCutting, TakesTenThousandScripts) {
    ContentWorld world;
    world.add("ls", "ls", ContentType::ShellScript);
    world.add("none", "", ContentType::ShellScript);
    std::string content;
    for (int count = 0; count < 5'000; ++count) content += "a【snippet:ls】【snippet:none】";
    const auto expanded = world.expand(content);
    SnippetParser::processScripts(*expanded);
    EXPECT_EQ(notation(*expanded), std::string(5'000, 'a'));
    EXPECT_EQ(expanded->scripts.size(), 5'000u);
}

std::shared_ptr<SnippetAbbreviationVariable> variableAt(std::size_t location, std::size_t length) {
    auto variable = std::make_shared<SnippetAbbreviationVariable>();
    variable->location = location;
    variable->scriptLength = length;
    return variable;
}

TEST(NewScript, TakesItselfAndWhatIsNestedFromTheList) {
    const auto before = variableAt(0, 2);
    const auto outer = variableAt(2, 6);
    const auto first = variableAt(3, 1);
    const auto second = variableAt(5, 2);
    const auto overlapping = variableAt(7, 3);
    std::vector variables = {before, outer, first, second, overlapping};
    const auto script = SnippetParser::newScriptWithAbbreviationVariable(outer, u"0123456789", variables);
    EXPECT_EQ(describe({script}), "0:247 (1:3 2:56)");
    EXPECT_THAT(variables, ElementsAre(before, overlapping));
}

TEST(NewScript, MayTakeItsVariableFromTheListItself) {
    std::vector variables = {variableAt(0, 3), variableAt(1, 1)};
    const auto script = SnippetParser::newScriptWithAbbreviationVariable(variables[0], u"abc", variables);
    EXPECT_EQ(describe({script}), "0:ac (1:b)");
    EXPECT_THAT(variables, IsEmpty());
}

TEST(NewScript, KeepsWithinTheText) {
    std::vector variables = {variableAt(2, 100), variableAt(50, 1)};
    const auto script = SnippetParser::newScriptWithAbbreviationVariable(variables[0], u"abc", variables);
    EXPECT_EQ(describe({script}), "0:c (1:)");
}

}  // namespace
}  // namespace plume
