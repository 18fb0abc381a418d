#include "content/NestedScripts.h"

#include <gmock/gmock.h>

#include "Foundation/Strings.h"
#include "content/FieldMerging.h"
#include "tests/content/world/ContentWorld.h"

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

void runScripts(const std::vector<std::shared_ptr<PLScript>>& scripts) {
    for (const auto& script : scripts) {
        if (!script->script.empty()) script->result = uppercased(script->script);
    }
}

TEST(NestedScripts, AreCutOutAndReplacedByTheirOutput) {
    ContentWorld world;
    world.add("ls", "ls", ContentType::ShellScript);
    world.add("say", "say", ContentType::AppleScript);
    world.add("both", "[【snippet:ls】;【snippet:say】]", ContentType::ShellScript);
    world.add("deep", "{【snippet:both】}", ContentType::ShellScript);
    world.add("keyed", "a【key:x code:7】b", ContentType::ShellScript);
    world.add("none", "", ContentType::ShellScript);
    const struct {
        const char* what;
        const char* content;
        const char* cut;
        const char* scripts;
        const char* variables;
        // With every script replaced by its text in capitals; an empty one has no output.
        const char* delivered;
        const char* deliveredVariables;
    } cases[] = {
        {"no script", "ab【|】", "ab", "", "caret@2", "ab", "caret@2"},
        {"two apart", "a【snippet:ls】b【snippet:say】c", "abc", "1:ls 2:say", "", "aLSbSAYc", ""},
        {"carets all around", "【|】【snippet:ls】【|】【snippet:say】【|】x【|】", "x", "0:ls 0:say",
         "caret@0 caret@0 caret@0 caret@1", "LSSAYx", "caret@0 caret@2 caret@5 caret@6"},
        {"key in a script", "a【snippet:keyed】b【|】", "ab", "1:ab", "key7@1 caret@2", "aABb", "key7@3 caret@4"},
        {"nested twice", "【snippet:deep】", "", "0:{} (1:[;] (1:ls 2:say))", "", "{}", ""},
        {"empty scripts", "a【snippet:none】【snippet:none】b", "ab", "1: (0:)", "", "ab", ""},
        {"arrow behind", "ab【snippet:ls】【◀】", "ab", "2:ls", "key123@0", "abLS", "key123@0"},
    };
    for (const auto& example : cases) {
        for (const ContentType type : {ContentType::PlainText, ContentType::RichText}) {
            SCOPED_TRACE(example.what);
            const auto content = world.expand(example.content, type);
            processScripts(*content);
            EXPECT_EQ(notation(*content), example.cut);
            EXPECT_EQ(describe(content->scripts), example.scripts);
            EXPECT_EQ(describe(content->variables), example.variables);
            runScripts(content->scripts);
            mergeScriptResults(*content);
            EXPECT_EQ(notation(*content), example.delivered);
            EXPECT_EQ(describe(content->variables), example.deliveredVariables);
        }
    }
}

TEST(NestedScripts, KnowTheirPlaceholderAndLookLikeIt) {
    ContentWorld world;
    world.add("say", "say", ContentType::AppleScript);
    const auto content = world.expand("_a_*【snippet:say】*_b_", ContentType::RichText);
    const auto variable = content->abbreviations()[0];
    processScripts(*content);
    EXPECT_EQ(notation(*content), "_ab_");
    EXPECT_EQ(content->scripts[0]->snippetVariable, variable);
    EXPECT_TRUE(content->scripts[0]->isAppleScript);
    runScripts(content->scripts);
    mergeScriptResults(*content);
    EXPECT_EQ(notation(*content), "_a_*SAY*_b_");
}

TEST(NestedScripts, AreCutOutWithTheFormValuesInThem) {
    ContentWorld world;
    world.add("sh", "echo 【field:what】;", ContentType::ShellScript);
    const auto content = world.expand("a【snippet:sh】【field:x】b【|】");
    content->fields()[0]->value = u"hello";
    content->fields()[1]->value = u"X";
    mergeFields(*content);
    processScripts(*content);
    EXPECT_EQ(notation(*content), "aXb");
    EXPECT_EQ(describe(content->scripts), "1:echo hello;");
    EXPECT_EQ(content->caretLocation(), 3);
}

TEST(NestedScripts, MayBeTenThousand) {
    ContentWorld world;
    world.add("ls", "ls", ContentType::ShellScript);
    world.add("none", "", ContentType::ShellScript);
    std::string content;
    for (int count = 0; count < 5'000; ++count) content += "a【snippet:ls】【snippet:none】";
    const auto expanded = world.expand(content);
    processScripts(*expanded);
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
    const auto script = newScriptWithAbbreviationVariable(outer, u"0123456789", variables);
    EXPECT_EQ(describe({script}), "0:247 (1:3 2:56)");
    EXPECT_THAT(variables, ElementsAre(before, overlapping));
}

TEST(NewScript, MayTakeItsVariableFromTheListAndKeepsWithinTheText) {
    std::vector variables = {variableAt(1, 100), variableAt(2, 1), variableAt(50, 1)};
    const auto script = newScriptWithAbbreviationVariable(variables[0], u"abc", variables);
    EXPECT_EQ(describe({script}), "0:b (1:c (1:))");
    EXPECT_THAT(variables, IsEmpty());
}

}  // namespace
}  // namespace plume
