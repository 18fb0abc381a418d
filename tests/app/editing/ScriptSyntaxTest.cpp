#include "app/editing/ScriptSyntax.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <ctime>
#include <sstream>

namespace plume {
namespace {

// Every unit by a letter for what it is shown as: "k" for keywords, "." for none.
std::string looksOf(const std::string& script, ScriptState state = {}) {
    constexpr std::string_view Letters = "ksc$P";
    std::istringstream lines(script);
    std::string all;
    for (std::string each; std::getline(lines, each);) {
        const std::u16string line = fromUtf8(each);
        std::vector<ScriptStretch> found;
        if (all.empty() && state == ScriptState{}) state.language = languageOfScript(line);
        state = scanScriptLine(line, state, found);
        std::string looks(line.size(), '.');
        for (const auto& [token, range] : found) {
            looks.replace(range.location, range.length, range.length, Letters.at(static_cast<std::size_t>(token)));
        }
        all += (all.empty() ? "" : "\n") + looks;
    }
    return all;
}

struct LooksCase {
    const char* name;
    std::string script;
    std::string looks;
};

class ScriptLooksTest : public ::testing::TestWithParam<LooksCase> {};

TEST_P(ScriptLooksTest, AreTold) {
    EXPECT_EQ(looksOf(GetParam().script), GetParam().looks) << GetParam().script;
}

INSTANTIATE_TEST_SUITE_P(
    All, ScriptLooksTest,
    ::testing::Values(
        LooksCase{"Shell", "if [ \"$HOME\" ]; then # end", "kk...s$$$$$s....kkkk.ccccc"},
        LooksCase{"ShellCommentsStartWords", "echo ${#a} a#b $# x;#c", "kkkk.$$$$$.....$$...cc"},
        LooksCase{"ShellTextsSpanLines", "echo 'a\\' if 'b\nfi' done", "kkkk.ssss.kk.ss\nsss.kkkk"},
        LooksCase{"ShellEscapes", "echo \\' \"\\\"\" fi", "kkkk....ssss.kk"},
        LooksCase{"NamesThatHoldKeywords", "./if x-do done", "..........kkkk"},
        LooksCase{"HereDocument", "cat <<END; do\nit's\n END\nEND\nfi", "...........kk\nssss\nssss\nsss\nkk"},
        LooksCase{"IndentedHereDocument", "cat <<-'E' x\n\tE\nfi", "............\nss\nkk"},
        LooksCase{"OtherThanHereDocuments", "cat <<< x $((1<<y))\nfi", "...................\nkk"},
        LooksCase{"Placeholders", "echo \"【clipboard】\" # 【date】 【", "kkkk.sPPPPPPPPPPPs.ccPPPPPPcc"},
        LooksCase{"Python", "#!/usr/bin/env python3\nx = '''a\nif ''' if \"\"\"'\"\"\" else 'a\nif x: # \"",
                  "cccccccccccccccccccccc\n....ssss\nssssss.kk.sssssss.kkkk.ss\nkk....ccc"},
        LooksCase{"Perl", "#!/usr/bin/perl -w\nmy @a = $#b; print \"$x{y}\" . 'it",
                  "cccccccccccccccccc\nkk.$$...$$...kkkkk.s$$ssss...sss"},
        LooksCase{"JavaScript", "#!/usr/bin/node\nlet a = `x\n'` // c\n/* if\n*/ if /*/ */ else",
                  "...............\nkkk.....ss\nss.cccc\nccccc"
                  "\ncc.kk.cccccc.kkkk"},
        LooksCase{"Unknown", "#!/usr/bin/awk\nif \"x\" # y", "cccccccccccccc\n...sss.ccc"}),
    [](const auto& each) { return each.param.name; });

TEST(ScriptSyntaxTest, AppleScriptHasItsOwnComments) {
    const ScriptState appleScript{.language = ScriptLanguage::AppleScript};
    EXPECT_EQ(looksOf("tell it -- don't\n(* \"a\n*) \"b\"", appleScript), "kkkk.kk.cccccccc\nccccc\ncc.sss");
}

TEST(ScriptSyntaxTest, TheFirstLineNamesTheLanguage) {
    const std::vector<std::pair<std::u16string, ScriptLanguage>> lines{
        {u"", ScriptLanguage::Shell},
        {u"python", ScriptLanguage::Shell},
        {u"#!/bin/bash -e", ScriptLanguage::Shell},
        {u"#! /usr/bin/python3.11", ScriptLanguage::Python},
        {u"#!/usr/bin/env -S LANG=C ruby", ScriptLanguage::Ruby},
        {u"#!/opt/perl5.36/bin/perl", ScriptLanguage::Perl},
        {u"#!/usr/bin/env node", ScriptLanguage::JavaScript},
        {u"#!", ScriptLanguage::Other},
        {u"#!/usr/bin/env", ScriptLanguage::Other},
    };
    for (const auto& [line, language] : lines) EXPECT_EQ(languageOfScript(line), language) << toUtf8(line);
}

// Steps that grow with the square of the length would take a hundred times the seconds that are allowed.
TEST(ScriptSyntaxTest, HostileLinesTakeLinearTime) {
    constexpr std::size_t Length = 50'000;
    constexpr double Allowed = 0.3;  // seconds of the processor
    for (const auto* piece :
         {u"【", u"【】", u"\"", u"'", u"`", u"${", u"\"${", u"<<",     u"<<-", u"<<A ",   u"<<  ",
          u"(",  u"/*",   u"\\", u"$", u"#", u"if", u"$a",   u"\"\"\"", u"@@",  u"\xD800", u"((<<x "}) {
        std::u16string line;
        while (line.size() < Length) line += piece;
        for (int number = 0; number <= static_cast<int>(ScriptLanguage::Other); ++number) {
            std::vector<ScriptStretch> found;
            const ScriptState before{.language = static_cast<ScriptLanguage>(number)};
            const std::clock_t start = std::clock();
            scanScriptLine(line, before, found);
            const double seconds = static_cast<double>(std::clock() - start) / CLOCKS_PER_SEC;
            EXPECT_LT(seconds, Allowed) << toUtf8(piece) << " in language " << number;
            for (const auto& stretch : found) ASSERT_LE(stretch.range.end(), line.size());
        }
    }
}

TEST(ScriptSyntaxTest, LinesAreIndentedBelowEachOther) {
    const auto below = [](const std::u16string& line, ScriptLanguage language = ScriptLanguage::Shell) {
        return toUtf8(indentBelow(line, language));
    };
    EXPECT_EQ(below(u""), "");
    EXPECT_EQ(below(u" \techo"), " \t");
    EXPECT_EQ(below(u"if true; then "), "\t");
    EXPECT_EQ(below(u"  while true; do"), "      ");
    EXPECT_EQ(below(u"echo undo"), "");
    EXPECT_EQ(below(u"\tf() {"), "\t\t");
    EXPECT_EQ(below(u"x:"), "");
    EXPECT_EQ(below(u"if x:", ScriptLanguage::Python), "\t");
    EXPECT_EQ(below(u"   "), "   ");
}

}  // namespace
}  // namespace plume
