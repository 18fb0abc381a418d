// Rich text that went through LibreOffice and back.

#include <gtest/gtest.h>

#include <fstream>
#include <iterator>
#include <ostream>
#include <string>

#include "Foundation/Strings.h"
#include "Foundation/text/HTMLExport.h"
#include "Foundation/text/RTFD.h"

namespace plume {
namespace {

std::string contentsOf(const std::string& name) {
    std::ifstream file("tests/Foundation/text/data/libreoffice-" + name + ".rtf", std::ios::binary);
    EXPECT_TRUE(file) << name;
    return {std::istreambuf_iterator<char>(file), {}};
}

std::string lookOf(const TextAttributes& look) {
    std::string names;
    const auto add = [&](bool has, const char* name) {
        names += has ? std::string(names.empty() ? "" : " ") + name : "";
    };
    add(look.font && look.font->bold, "bold");
    add(look.font && look.font->italic, "italic");
    add(look.underlineStyle != 0, "underlined");
    add(look.strikethroughStyle != 0, "struck");
    add(look.superscript > 0, "raised");
    add(look.foregroundColor && look.foregroundColor->red == 1, "red");
    add(look.backgroundColor && look.backgroundColor->blue == 0 && look.backgroundColor->red == 1, "on yellow");
    const TextAlignment alignment = look.paragraphStyle ? look.paragraphStyle->alignment : TextAlignment::Natural;
    add(alignment == TextAlignment::Center, "centred");
    add(alignment == TextAlignment::Right, "right");
    add(alignment == TextAlignment::Justified, "justified");
    if (look.link) names += "-> " + toUtf8(*look.link);
    if (look.paragraphStyle && !look.paragraphStyle->textLists.empty()) {
        add(true, toUtf8(look.paragraphStyle->textLists.front().markerFormat).c_str());
    }
    return names;
}

// "text<look>text…", neighbours that look the same to a reader joined.
std::string shown(const AttributedString& text) {
    std::string all;
    std::string last;
    std::size_t position = 0;
    for (const auto& run : text.runs()) {
        const std::string look = run.attributes ? lookOf(*run.attributes) : "";
        if (position > 0 && look != last) all += "<" + last + ">";
        all += toUtf8(text.string().substr(position, run.length));
        last = look;
        position += run.length;
    }
    return all + "<" + last + ">";
}

struct LibreOfficeCase {
    const char* name;
    const char* expected;
};

std::ostream& operator<<(std::ostream& stream, const LibreOfficeCase& libreOfficeCase) {
    return stream << libreOfficeCase.name;
}

class RTFFromLibreOffice : public testing::TestWithParam<LibreOfficeCase> {};

TEST_P(RTFFromLibreOffice, ReadsTheSame) {
    const auto text = attributedStringFromRTF(contentsOf(GetParam().name));
    ASSERT_TRUE(text);
    EXPECT_EQ(shown(text.value()), GetParam().expected);
}

INSTANTIATE_TEST_SUITE_P(
    All, RTFFromLibreOffice,
    testing::Values(
        LibreOfficeCase{"alignment", "left\n<>centred\n<centred>right\n<right>justified\n<justified>"},
        LibreOfficeCase{"colours", "red<red> and <>on yellow<on yellow>\n<>"},
        LibreOfficeCase{
            "html-lists",
            "before\n<>\t\u2022\tone\n\t\u2022\ttwo\n<{disc}>\t1.\tfirst\n\t2.\tsecond\n<{decimal}.>after\n<>"},
        LibreOfficeCase{"links", "see <>the page<-> https://example.org/?a=1&b=2>.\n<>"},
        LibreOfficeCase{
            "lists",
            "before\n<>\t\u2022\tone\n\t\u2022\ttwo\n<{disc}>\t1.\tfirst\n\t2.\tsecond\n<{decimal}.>after\n<>"},
        LibreOfficeCase{"styles",
                        "plain <>bold <bold>italic <italic>both <bold italic>under<underlined> struck "
                        "<struck>2<raised>\n<>"},
        LibreOfficeCase{"unicode",
                        "na\u00efve \u00dcn\u00efc\u00f6d\u00e9 \u2014 \u65e5\u672c\u8a9e \u3010\u3011 \U0001f600"
                        "\ttab {brace} \\ end\nsecond paragraph\n<>"}));

TEST(RTFFromLibreOfficeLists, KeepNoMarkersOfTheirOwnInHTML) {
    const auto text = attributedStringFromRTF(contentsOf("lists"));
    ASSERT_TRUE(text);
    const std::string html = htmlFromAttributedString(text.value(), defaultExcludedTags());
    EXPECT_EQ(html.find("\u2022"), std::string::npos) << html;
    EXPECT_EQ(html.find("1."), std::string::npos) << html;
}

TEST(RTFListMarkers, StandBetweenTabs) {
    const auto textOf = [](const char* rtf) { return toUtf8(attributedStringFromRTF(rtf).value().string()); };
    EXPECT_EQ(textOf("{\\rtf1{\\listtext\\tab 1.\\tab}a}"), "\t1.\ta");
    EXPECT_EQ(textOf("{\\rtf1{\\listtext  1.\\tab}a}"), "\t1.\ta");
    EXPECT_EQ(textOf("{\\rtf1{\\listtext{\\b 1.}\\tab}a}"), "\t1.\ta");
    EXPECT_EQ(textOf("{\\rtf1{\\listtext}a b}"), "a b");
}

}  // namespace
}  // namespace plume
