#include "app/cli/CsvLibrary.h"

#include <gtest/gtest.h>

#include "Foundation/Strings.h"

namespace plume {
namespace {

// "abbreviation|content|label" for each snippet.
std::string shown(const SnippetGroup& group) {
    std::string text;
    for (const auto& snippet : group.items()) {
        text += toUtf8(snippet->abbreviation().value_or(u"nil")) + "|" +
                toUtf8(snippet->plainTextContent().value_or(u"nil")) + "|" + toUtf8(snippet->label().value_or(u"nil")) +
                "\n";
    }
    return text;
}

TEST(CsvLibrary, BecomesSnippets) {
    const struct {
        const char* about;
        std::string bytes;
        std::string shown;
    } cases[] = {
        {"three columns", "a,b,c\nd,e,f\n", "a|b|c\nd|e|f\n"},
        {"missing columns are empty", "a\nb,c\n", "a||\nb|c|\n"},
        {"further columns are left out", "a,b,c,d\n", "a|b|c\n"},
        {"quotes", "a,\"b,\"\"c\"\"\nd\",e", "a|b,\"c\"\nd|e\n"},
        {"UTF-8 with its mark",
         "\xEF\xBB\xBF"
         "a,ä",
         "a|ä|\n"},
        {"UTF-16, little end first",
         std::string("\xFF\xFE"
                     "a\0,\0\xE4\0",
                     8),
         "a|ä|\n"},
        {"Mac OS Roman", "a,\x8A\xA5", "a|ä•|\n"},
        {"what was read before a fault is kept", "a,b,c\nd,x\"y,z\ne,f,g\n", "a|b|c\nd|x|\n"},
    };
    for (const auto& one : cases) {
        const auto group = readCsvLibrary(one.bytes, u"words");
        ASSERT_TRUE(group) << one.about << ": " << group.error().message;
        EXPECT_EQ(shown(*group.value()), one.shown) << one.about;
        EXPECT_EQ(group.value()->name(), u"words");
    }
}

TEST(CsvLibrary, WithoutARecordIsAnError) {
    for (const std::string text : {"", "\na,b", "\xEF\xBB\xBF"}) {
        EXPECT_FALSE(readCsvLibrary(text, u"words")) << text;
    }
}

}  // namespace
}  // namespace plume
