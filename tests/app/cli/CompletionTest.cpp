// What shells offer behind what was typed so far.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <sstream>
#include <string>
#include <vector>

#include "tests/app/cli/ProgramRun.h"

namespace plume {
namespace {

using ::testing::Contains;
using ::testing::ElementsAre;
using ::testing::IsEmpty;
using ::testing::IsSupersetOf;
using ::testing::Not;

using Lines = std::vector<std::string>;

Lines linesOf(const std::string& text) {
    Lines lines;
    std::istringstream stream(text);
    for (std::string line; std::getline(stream, line);) lines.push_back(line);
    return lines;
}

constexpr const char* OddLibrary = R"([{"name": "Odd", "items": [
    {"abbreviation": ":hello", "content": "1"}, {"abbreviation": ":help", "content": "2"},
    {"abbreviation": ";date", "content": "3"}, {"abbreviation": "back\\slash", "content": "4"},
    {"abbreviation": "it's", "content": "5"}, {"abbreviation": "$HOME", "content": "6"},
    {"abbreviation": "two words", "content": "7"}, {"abbreviation": "q\"q", "content": "8"},
    {"abbreviation": "a:b:c", "content": "9"}, {"abbreviation": "x=y", "content": "10"},
    {"abbreviation": "-> ", "content": "11"}, {"abbreviation": "*?[", "content": "12"},
    {"abbreviation": "äö", "content": "13"}, {"abbreviation": "break\nline", "content": "14"}]}])";

class CompletionTest : public testing::Test {
  protected:
    CompletionTest() {
        home.write("config/plume/library.json", OddLibrary);
        script = home.write("completion.bash", home.run({"completion", "bash"}).output);
    }

    // What the function offers for a line; `replaced` is what the shell will put it in place of.
    Lines offered(const std::string& typed, const std::string& replaced) {
        const std::string run = "source " + script +
                                "; compopt() { echo files; }; COMP_LINE=$1 COMP_POINT=${#1} COMP_WORDS=(\"$3\");"
                                "_plume plume \"$2\"; ((${#COMPREPLY[@]})) && printf '%s\\n' \"${COMPREPLY[@]}\"";
        const ProgramResult result =
            home.runOther("/bin/bash", {"--norc", "-c", run, "bash", typed, replaced, ProgramHome::program()});
        EXPECT_EQ(result.error, "") << typed;
        return linesOf(result.output);
    }

    // The last argument of a line as the shell reads it.
    std::string lastArgument(const std::string& line) {
        const ProgramResult result =
            home.runOther("/bin/bash", {"--norc", "-c", "eval \"set -- $1\"; printf %s \"${@: -1}\"", "bash", line});
        EXPECT_EQ(result.error, "") << line;
        return result.output;
    }

    ProgramHome home;
    std::string script;
};

TEST_F(CompletionTest, OffersCommandsOptionsWindowsSettingsAndFiles) {
    EXPECT_THAT(offered("plume se", "se"), ElementsAre("search", "settings"));
    EXPECT_THAT(offered("plume ", ""), IsSupersetOf({"list", "completion", "quick-search", "--help"}));
    EXPECT_THAT(offered("plume search --", "--"), ElementsAre("--help", "--library", "--json"));
    EXPECT_THAT(offered("plume show new-f", "new-f"), ElementsAre("new-from-clipboard", "new-from-selection"));
    EXPECT_THAT(offered("plume settings Sync", "Sync"), Contains("SyncDirectory"));
    for (const char* line : {"plume import x", "plume list --library ", "plume run --settings a", "plume open 'my "}) {
        EXPECT_THAT(offered(line, ""), ElementsAre("files")) << line;
    }
    EXPECT_THAT(offered("plume add ", ""), IsEmpty());
    EXPECT_THAT(offered("plume completion f", "f"), ElementsAre("fish"));
}

TEST_F(CompletionTest, PutsInAbbreviationsThatTheShellReadsAsTheyAre) {
    const struct {
        std::string typed;     // behind "plume expand "
        std::string replaced;  // as the shell says
        Lines meant;
    } cases[] = {
        {"':h", ":h", {":hello", ":help"}},
        {":h", "h", {":hello", ":help"}},
        {"\\;d", "\\;d", {";date"}},
        {"';", ";", {";date"}},
        {"\";", ";", {";date"}},
        {"ba", "ba", {"back\\slash"}},
        {"'back", "back", {"back\\slash"}},
        {"\"ba", "ba", {"back\\slash"}},
        {"back\\\\s", "back\\\\s", {"back\\slash"}},
        {"it", "it", {"it's"}},
        {"'it", "it", {"it's"}},
        {"\"it'", "it'", {"it's"}},
        {"\\$", "\\$", {"$HOME"}},
        {"'$", "$", {"$HOME"}},
        {"\"\\$", "\\$", {"$HOME"}},
        {"two\\ ", "two\\ ", {"two words"}},
        {"'two w", "two w", {"two words"}},
        {"q", "q", {"q\"q"}},
        {"\"q", "q", {"q\"q"}},
        {"a:b", "b", {"a:b:c"}},
        {"a:", "", {"a:b:c"}},
        {"x=", "", {"x=y"}},
        {"-", "-", {"-> "}},
        {"\\*", "\\*", {"*?["}},
        {"ä", "ä", {"äö"}},
        {"zzz", "zzz", {}},
    };
    for (const auto& [typed, replaced, meant] : cases) {
        const std::string line = "plume expand " + typed;
        const Lines found = offered(line, replaced);
        ASSERT_EQ(found.size(), meant.size()) << line;
        const std::string quote = typed.starts_with('\'') || typed.starts_with('"') ? typed.substr(0, 1) : "";
        for (std::size_t i = 0; i < found.size(); ++i) {
            const std::string before = line.substr(0, line.size() - replaced.size());
            EXPECT_EQ(lastArgument(before + found[i] + quote), meant[i]) << line << " and " << found[i];
        }
    }
    EXPECT_THAT(offered("plume remove ':he", ":he"), ElementsAre(":hello", ":help"));
}

TEST_F(CompletionTest, ListsAbbreviationsOneALine) {
    const Lines lines = linesOf(home.run({"list", "--abbreviations"}).output);
    EXPECT_EQ(lines.size(), 13U);
    EXPECT_THAT(lines, IsSupersetOf({":hello", "it's", "-> ", "äö"}));
    EXPECT_THAT(lines, Not(Contains("break")));
}

TEST_F(CompletionTest, RefusesShellsThatItDoesNotKnow) {
    EXPECT_EQ(home.run({"completion", "cmd"}).status, 2);
    EXPECT_EQ(home.run({"completion"}).status, 2);
}

}  // namespace
}  // namespace plume
