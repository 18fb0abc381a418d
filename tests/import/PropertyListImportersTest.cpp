#include <fstream>
#include <sstream>

#include "tests/import/ImportSupport.h"

namespace plume {
namespace {

using test::remarksOf;
using test::shown;
using testing::HasSubstr;

Result<ImportedLibrary> importedFile(const std::string& name) {
    std::ifstream file("tests/import/data/" + name, std::ios::binary);
    std::ostringstream bytes;
    bytes << file.rdbuf();
    return importFile("/x/" + name, bytes.str());
}

TEST(PropertyListImporters, ReadWhatOtherProgramsWrite) {
    const struct {
        const char* file;
        const char* shown;
        const char* remarks;
    } cases[] = {
        {"greetings.textexpander",
         "[Greetings]\n"
         "hw|Hello 【field:who】,【key:↩ code:36】【|】|Hello\n"
         "td|【date:\"EEEE, MMMM d, yyyy\"】|Today\n"
         "|no abbreviation|\n"
         "sh|#!/bin/sh\ndate +%Y|\n"
         "js|1 + 1|A sum\n"
         "pct|100% of 【field:x value:y】|\n"
         "ht|a bold 【date:yyyy】|\n"
         "odd|text|\n"
         "rich|plain|\n"
         "broken|kept 【date:yyyy】|\n",
         "\"js\": it is JavaScript, which Plume does not run; it is kept and expands to nothing\n"
         "\"odd\": its type 9 is not known; it is taken as plain text\n"
         "\"broken\": its formatting cannot be read"},
        {"settings.textexpbackup",
         "[First]\nb|B|\na|A|\nd|D|\ne|E|\n[Second]\na|A|\n[TextExpander Snippets]\n[settings]\nc|C|\n",
         "1 snippet was in no group and is put into one named settings\n"},
        {"nogroup.tedist", "[nogroup]\nx|X|\ny|Y|\n", ""},
        {"clips.typeit4me", "[clips]\nkr|Kind regards|Closing\npt|plain %d text|nil\nbad|kept|nil\n",
         "\"bad\": its formatting cannot be read"},
        {"replacements.plist",
         "[System's Symbol And Text Substitutions]\nomw|On my way!|nil\n(c)|©|nil\nbtw|by the way|nil\n",
         "1 replacement was switched off; it expands here\n1 entry is no snippet and is left out\n"},
        {"global.plist", "[System's Symbol And Text Substitutions]\nomw|On my way!|nil\n", ""},
        {"letters.autotyper",
         "[letters]\n"
         "dear|Dear 【field:Who】 on 【date:dd.MM.yyyy】【|】x|A & letter\n"
         "btw|by 【clipboard】 the 【field:\"a ${b} c\"】 way ${odd}|nil\nbad||nil\nworse||nil\n",
         "\"worse\": its content cannot be read (expected base 64) and is empty\n"},
        {"words.glossary", "[words]\nteh|the|nil\nrecieve|receive|nil\nadn|and|nil\n", ""},
    };
    for (const auto& one : cases) {
        const auto library = importedFile(one.file);
        ASSERT_TRUE(library) << library.error().message;
        EXPECT_EQ(shown(library.value()), one.shown) << one.file;
        EXPECT_THAT(remarksOf(library.value()), HasSubstr(one.remarks)) << one.file;
        EXPECT_EQ(library.value().remarks.empty(), std::string(one.remarks).empty()) << one.file;
    }
}

TEST(PropertyListImporters, KeepHowGroupsAndSnippetsExpand) {
    const auto settings = importedFile("settings.textexpbackup");
    const auto& groups = settings.value().groups;
    EXPECT_EQ(groups[0]->expandAfter(), ExpandAfter::Delimiter);
    EXPECT_FALSE(groups[0]->suggestAbbreviations());
    EXPECT_EQ(groups[1]->expandAfter(), ExpandAfter::Anything);
    EXPECT_TRUE(groups[1]->suggestAbbreviations());
    EXPECT_EQ(groups[0]->items()[1], groups[1]->items()[0]);
    const auto greetings = importedFile("greetings.textexpander");
    const SnippetGroup& group = *greetings.value().groups[0];
    EXPECT_EQ(group.expandAfter(), ExpandAfter::Whitespace);
    EXPECT_EQ(group.items()[0]->caseSensitivity(), CaseSensitivity::IgnoreCaseAndAdapt);
    EXPECT_EQ(group.items()[3]->contentType(), ContentType::ShellScript);
    EXPECT_EQ(group.items()[4]->contentType(), ContentType{4});
    EXPECT_EQ(group.items()[6]->contentType(), ContentType::RichText);
    EXPECT_EQ(group.items()[8]->contentType(), ContentType::RichText);
    EXPECT_EQ(group.items()[9]->contentType(), ContentType::RichText);
    const auto clips = importedFile("clips.typeit4me");
    EXPECT_EQ(clips.value().groups[0]->items()[0]->contentType(), ContentType::RichText);
    EXPECT_EQ(importedFile("words.glossary").value().groups[0]->expandTrigger(), ExpandTrigger::DelimiterKept);
}

TEST(PropertyListImporters, SayWhatIsWrong) {
    const std::string start = R"(<?xml version="1.0"?><plist version="1.0">)";
    const struct {
        const char* file;
        std::string bytes;
        const char* error;
    } cases[] = {
        {"/x/a.textexpander", "no list", "/x/a.textexpander: "},
        {"/x/a.textexpander", start + "<dict><key>snippetsTE2</key><arr",
         "/x/a.textexpander: The XML property list is wrong at line 1"},
        {"/x/a.textexpander", start + "<dict/></plist>", "at snippetsTE2: there is none"},
        {"/x/a.textexpander", start + "<dict><key>snippetsTE2</key><array><true/></array></dict></plist>",
         "at snippetsTE2: nothing in it is a snippet"},
        {"/x/a.typeit4me", start + "<dict/></plist>", "at Clippings: there is none"},
        {"/x/a.plist", start + "<dict/></plist>", "no text replacements"},
        {"/x/a.plist", start + "<array><dict/></array></plist>", "nothing in its list is a replacement"},
        {"/x/a.autotyper", "<database>\n<object", "/x/a.autotyper: line 2: expected well-formed XML"},
        {"/x/a.autotyper", "<database/>", "no object of type TYPERABBREVIATION"},
        {"/x/a.glossary", start + "<dict/></plist>", "at $objects: there is none"},
        {"/x/a.glossary", start + "<dict><key>$objects</key><array/></dict></plist>", "no abbreviation"},
    };
    for (const auto& one : cases) {
        EXPECT_THAT(importFile(one.file, one.bytes).error().message, HasSubstr(one.error));
    }
    const auto cut = importFile("/x/a.autotyper", "<d><object type=\"TYPERABBREVIATION\"></object>\n<d");
    EXPECT_THAT(remarksOf(cut.value()), HasSubstr("nothing behind a fault is read: line 2"));
    const auto renamed = importFile("/x/a.plist", start + "<dict><key>Clippings</key><array/></dict></plist>");
    EXPECT_TRUE(renamed) << renamed.error().message;
}

}  // namespace
}  // namespace plume
