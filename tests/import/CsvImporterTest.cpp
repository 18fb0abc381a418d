#include "tests/import/ImportSupport.h"

namespace plume {
namespace {

using test::remarksOf;
using test::shown;
using testing::HasSubstr;

TEST(CsvImporter, MakesASnippetOfEachRecord) {
    const struct {
        const char* about;
        std::string bytes;
        std::string shown;
        std::string remark;
    } cases[] = {
        {"three columns", "a,b,c\nd,e,f\n", "a|b|c\nd|e|f\n", ""},
        {"missing columns are empty", "a\nb,c\n", "a||\nb|c|\n", ""},
        {"further columns are told of", "a,b,c,d\n", "a|b|c\n", "1 record has more than three columns"},
        {"quotes", "a,\"b,\"\"c\"\"\nd\",e", "a|b,\"c\"\nd|e\n", ""},
        {"quotes behind backslashes", "a,\"say \\\"b\\\", c\"\nd,\"e\\\\\"\n", "a|say \"b\", c|\nd|e\\\\|\n", ""},
        {"a backslash at the end of a field", "a,\"C:\\\"\nb,c\n", "a|C:\\|\nb|c|\n", ""},
        {"semicolons", "a;b, c\r\nd;e\r\n", "a|b, c|\nd|e|\n", ""},
        {"tabs", "a\tb\tc\n", "a|b|c\n", ""},
        {"semicolons that start abbreviations", ";a,b\n;c,d;e\n", ";a|b|\n;c|d;e|\n", ""},
        {"UTF-8 with its mark", "\xEF\xBB\xBF\"a\",ä", "a|ä|\n", ""},
        {"UTF-16, little end first", std::string("\xFF\xFE\x61\0,\0\xE4\0", 8), "a|ä|\n", ""},
        {"UTF-16, big end first", std::string("\xFE\xFF\0\x61\0,\0\xE4", 8), "a|ä|\n", ""},
        {"UTF-16 without its mark", std::string("a\0,\0b\0", 6), "a|b|\n", ""},
        {"Mac OS Roman", "a,\x8A\xA5", "a|ä•|\n", ""},
        {"what stands before a fault is kept", "a,b,c\nd,x\"y,z\ne,f,g\n", "a|b|c\nd|x|\n", "line 2: a double quote"},
    };
    for (const auto& one : cases) {
        const auto library = importFile("/x/Words.Csv", one.bytes);
        ASSERT_TRUE(library) << one.about << ": " << library.error().message;
        EXPECT_EQ(shown(library.value()), "[Words]\n" + one.shown) << one.about;
        EXPECT_THAT(remarksOf(library.value()), HasSubstr(one.remark)) << one.about;
        EXPECT_EQ(library.value().remarks.empty(), one.remark.empty()) << one.about;
    }
}

TEST(CsvImporter, WithoutARecordIsAnError) {
    const struct {
        std::string bytes;
        const char* error;
    } cases[] = {
        {"", "/x/words.csv: the file is empty"},
        {"\na,b", "/x/words.csv: line 1: no snippet could be read; expected abbreviation,text,label"},
        {"\xEF\xBB\xBF", "line 1: no snippet"},
        {std::string("a,b\nc\0,d\n", 9), "line 2: a NUL character"},
    };
    for (const auto& one : cases) {
        const auto library = importFile("/x/words.csv", one.bytes);
        ASSERT_FALSE(library) << one.error;
        EXPECT_THAT(library.error().message, HasSubstr(one.error));
    }
}

TEST(CsvImporter, ConvertsPlaceholdersOfTextExpanderWhenAsked) {
    const std::string text = "a,at %1I:%M %p %|\nb,%key:end%\n";
    const auto asked = importFile("/x/words.csv", text, {.textExpanderPlaceholders = true});
    EXPECT_EQ(shown(asked.value()), "[words]\na|at 【time:\"h:mm a\"】 【|】|\nb|%key:end%|\n");
    EXPECT_EQ(remarksOf(asked.value()), "\"b\": the key end is not known and stays as text\n");
    const auto plain = importFile("/x/words.csv", text);
    EXPECT_EQ(shown(plain.value()), "[words]\na|at %1I:%M %p %||\nb|%key:end%|\n");
    EXPECT_THAT(remarksOf(plain.value()), HasSubstr("1 snippet seems to hold placeholders of TextExpander"));
}

TEST(Importers, AreChosenByTheEnding) {
    EXPECT_THAT(importFile("/x/words.doc", "a").error().message, HasSubstr("/x/words.doc: no library has this ending"));
    const auto library =
        importFile("/x/a.JSON", R"([{"name": "b", "items": [{"abbreviation": "c", "content": "d"}]}])");
    ASSERT_TRUE(library) << library.error().message;
    EXPECT_EQ(shown(library.value()), "[b]\nc|d|nil\n");
    EXPECT_THAT(importFile("/x/a.json", "[{]").error().message, HasSubstr("/x/a.json: this is no JSON"));
}

}  // namespace
}  // namespace plume
