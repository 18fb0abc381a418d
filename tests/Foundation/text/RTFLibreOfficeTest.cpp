// Rich text that went through LibreOffice and back.

#include <gtest/gtest.h>

#include <fstream>
#include <iterator>
#include <string>

#include "Foundation/text/HTMLExport.h"
#include "Foundation/text/RTFD.h"
#include "tests/Foundation/text/RTFTestSupport.h"

namespace plume {
namespace {

std::string contentsOf(const std::string& name) {
    std::ifstream file("tests/Foundation/text/data/libreoffice-" + name + ".rtf", std::ios::binary);
    EXPECT_TRUE(file) << name;
    return {std::istreambuf_iterator<char>(file), {}};
}

TEST(RTFFromLibreOffice, ReadsTheSame) {
    const char* const lists =
        "before\n<>\t\u2022\tone\n\t\u2022\ttwo\n<{disc}>\t1.\tfirst\n\t2.\tsecond\n<{decimal}.>after\n<>";
    const struct {
        const char* name;
        const char* expected;
    } cases[] = {
        {"alignment", "left\n<>centred\n<centred>right\n<right>justified\n<justified>"},
        {"colours", "red<red> and <>on yellow<0.0.0.100 on yellow>\n<>"},
        {"html-lists", lists},
        {"links", "see <>the page<-> https://example.org/?a=1&b=2>.\n<>"},
        {"lists", lists},
        {"styles",
         "plain <>bold <bold>italic <italic>both <bold italic>under<underlined> struck <struck>2<raised>\n<>"},
        {"unicode",
         "na\u00efve \u00dcn\u00efc\u00f6d\u00e9 \u2014 \u65e5\u672c\u8a9e \u3010\u3011 \U0001f600\ttab {brace} \\ "
         "end\n"
         "second paragraph\n<>"},
    };
    for (const auto& [name, expected] : cases) {
        const auto text = attributedStringFromRTF(contentsOf(name));
        ASSERT_TRUE(text) << name;
        EXPECT_EQ(shown(text.value()), expected) << name;
    }
}

TEST(RTFFromLibreOffice, ListsKeepNoMarkersOfTheirOwnInHTML) {
    const AttributedString text = attributedStringFromRTF(contentsOf("lists")).value();
    const std::string html = htmlFromAttributedString(text, defaultExcludedTags());
    EXPECT_EQ(html.find("\u2022"), std::string::npos) << html;
    EXPECT_EQ(html.find("1."), std::string::npos) << html;
}

}  // namespace
}  // namespace plume
