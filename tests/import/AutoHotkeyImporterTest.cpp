#include "tests/import/ImportSupport.h"

namespace plume {
namespace {

using test::remarksOf;
using test::shown;
using testing::HasSubstr;

TEST(AutoHotkeyImporter, TakesHotstringsWithReplacements) {
    const struct {
        const char* about;
        std::string text;
        std::string shown;
        std::string remark;
    } cases[] = {
        {"plain", "::btw::by the way\n", "btw|by the way|", ""},
        {"in quotes", "\"::btw::by the way\"\r\n", "btw|by the way|", ""},
        {"at once", ":*:btw::by the way\n", "btw|by the way|", "line 1, \"btw\": it expands at once there (*)"},
        {"inside words", ":?*:btw::by\n", "btw|by|", "(*), but after a delimiter here"},
        {"more options", ":*?C1 O:btw::by\n", "btw|by|", "(?), but not here; the delimiter goes there (O)"},
        {"indented, with a comment", "\n\t ::btw::by the way \t; oh\n", "btw|by the way|", ""},
        {"a semicolon that starts no comment", "::btw::by;the\n", "btw|by;the|", ""},
        {"spaces and colons", "::a b:: c :: d\n::::)::smile\n", "a b| c :: d|nil\n::)|smile|", ""},
        {"no replacement", "::btw::\n::omw:: ;none\nreturn\n::a::b\n", "a|b|", "2 hotstrings without a replacement"},
        {"other code", "#NoEnv\nx := 1\n; ::no::no\n::a::b\n", "a|b|", "1 line of other code"},
        {"a block of comment", "/* ::no::no\n::no::no\n*/\n::a::b\n/*\n::no::no\n", "a|b|",
         "3 hotstrings inside /* */"},
        {"a block that ends at once", "/* x */\n::a::b\n", "a|b|", ""},
        {"several lines", "::a::\n(\n  b  \n\nc\n)\n::d::e\n(LTrim\n  f\n)\n", "a|  b\n\nc|nil\nd|ef|", ""},
        {"keys and escapes", "::a::b{Enter}\n:R:c::{d}`n\n", "a|b{Enter}|nil\nc|{d}`n|",
         "line 1, \"a\": keys in braces"},
        {"a command", ":X:a::Run b\n", "a|Run b|", "its command is taken as text"},
        {"a condition", "#IfWinActive Notepad\n::a::b\n", "a|b|", "line 1: the condition"},
        {"what is no option", ":abc:btw::x\n::a::b\n", "a|b|", "line 1: this is no hotstring"},
        {"CP1252", "::a::caf\xE9 \x80\n", "a|café €|", ""},
        {"no end of the last line", "\xEF\xBB\xBF::a::é", "a|é|", ""},
    };
    for (const auto& one : cases) {
        const auto library = importFile("/x/Words.ahk", one.text);
        ASSERT_TRUE(library) << one.about << ": " << library.error().message;
        EXPECT_EQ(shown(library.value()), "[Words]\n" + one.shown + "nil\n") << one.about;
        EXPECT_THAT(remarksOf(library.value()), HasSubstr(one.remark)) << one.about;
        EXPECT_EQ(library.value().remarks.empty(), one.remark.empty()) << one.about << remarksOf(library.value());
    }
}

TEST(AutoHotkeyImporter, KeepsHowTheyExpand) {
    const auto library = importFile("/x/w.ahk", "::a::b\n:C:c::d\n:C1:e::f\n");
    ASSERT_TRUE(library);
    const SnippetGroup& group = *library.value().groups.front();
    EXPECT_EQ(group.expandTrigger(), ExpandTrigger::DelimiterKept);
    EXPECT_EQ(group.items()[0]->caseSensitivity(), CaseSensitivity::IgnoreCaseAndAdapt);
    EXPECT_EQ(group.items()[1]->caseSensitivity(), CaseSensitivity::CaseSensitive);
    EXPECT_EQ(group.items()[2]->caseSensitivity(), CaseSensitivity::IgnoreCase);
}

TEST(AutoHotkeyImporter, WithoutAHotstringIsAnError) {
    for (const std::string text : {":", "::", ":::", "::a", "::a:", "::a::", "x", "::::", ":*:"}) {
        EXPECT_THAT(importFile("/x/w.ahk", text).error().message, HasSubstr("/x/w.ahk: no hotstring")) << text;
    }
}

}  // namespace
}  // namespace plume
