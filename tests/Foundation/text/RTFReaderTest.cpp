#include <optional>
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "Foundation/Strings.h"
#include "Foundation/text/RTFD.h"
#include "tests/Foundation/text/RTFTestSupport.h"

namespace plume {
namespace {

using testing::HasSubstr;

AttributedString read(std::string_view rtf) {
    auto text = attributedStringFromRTF(rtf);
    EXPECT_TRUE(text) << (text ? "" : text.error().message);
    return text ? text.value() : AttributedString();
}

// ---- Text ----

struct TextCase {
    const char* name;
    std::string rtf;
    std::string text;
};

void expectTexts(const std::vector<TextCase>& cases) {
    for (const TextCase& c : cases) EXPECT_EQ(toUtf8(read(c.rtf).string()), c.text) << c.name;
}

TEST(RTFText, Characters) {
    expectTexts(
        {{"paragraphs", "{\\rtf1 a\\par b\\\nc\\\r\nd}", "a\nb\nc\nd"},
         {"source lines are not text", "{\\rtf1 a\nb\r\nc}", "abc"},
         {"escaped characters", "{\\rtf1 \\{\\}\\\\}", "{}\\"},
         {"one space ends a word", "{\\rtf1\\b  a\\b0  b}", " a b"},
         {"special characters", "{\\rtf1\\emdash\\endash\\bullet\\lquote\\rquote\\ldblquote\\rdblquote\\tab\\line x}",
          "\u2014\u2013\u2022\u2018\u2019\u201C\u201D\t\u2028x"},
         {"symbols", "{\\rtf1 a\\~b\\_c\\-d}", "a\u00A0b\u2011c\u00ADd"},
         {"cells and rows", "{\\rtf1 a\\cell b\\cell\\row c}", "a\tb\t\nc"},
         {"hidden text", "{\\rtf1 a{\\v b}c\\v d\\v0 e}", "ace"},
         {"after the end", "{\\rtf1 a}b{c}", "a"}});
}

TEST(RTFText, Unicode) {
    expectTexts({{"one fallback character", "{\\rtf1\\u8364 ?a\\u8364xb}", "\u20ACa\u20ACb"},
                 {"hexadecimal fallback", "{\\rtf1\\u8364\\'80a}", "\u20ACa"},
                 {"no fallback", "{\\rtf1\\uc0\\u8364 a\\u8364\\u8364b}", "\u20ACa\u20AC\u20ACb"},
                 {"several fallback characters", "{\\rtf1\\uc3\\u8364 ?\\'3f?a}", "\u20ACa"},
                 {"fallback belongs to the group", "{\\rtf1{\\uc0\\u8364 a}\\u8364?b}", "\u20ACa\u20ACb"},
                 {"fallback ends with its group", "{\\rtf1{\\u8364}a}", "\u20ACa"},
                 {"formatting is no fallback", "{\\rtf1\\u8364\\b a}", "\u20ACa"},
                 {"symbol as fallback", "{\\rtf1\\u8211\\endash a}", "\u2013a"},
                 {"negative numbers", "{\\rtf1\\uc0\\u-3913 }", "\uF0B7"},
                 {"surrogates", "{\\rtf1\\uc0\\u-10179 \\u-8704 \\u55357 \\u56832 }", "\U0001F600\U0001F600"},
                 {"beyond 16 bits", "{\\rtf1\\uc0\\u128512 }", "\U0001F600"},
                 {"no such character", "{\\rtf1\\uc0 a\\u9999999999 b\\u c}", "abc"}});
}

TEST(RTFText, CodePages) {
    expectTexts(
        {{"Latin by default", "{\\rtf1 \\'93\\'e9\\'94}", "\u201C\u00E9\u201D"},
         {"raw bytes", "{\\rtf1 caf\xE9!}", "caf\u00E9!"},
         {"Mac Roman", "{\\rtf1\\mac \\'8e\\'a5}", "\u00E9\u2022"},
         {"Cyrillic document", "{\\rtf1\\ansi\\ansicpg1251 \\'cf\\'f0}", "\u041F\u0440"},
         {"Arabic font", "{\\rtf1\\ansi{\\fonttbl{\\f0 A;}{\\f1\\fcharset178 B;}}\\f0\\'e9\\f1\\'e3\\'d1}",
          "\u00E9\u0645\u0631"},
         {"font of a group", "{\\rtf1{\\fonttbl{\\f1\\fcharset204 B;}}{\\f1\\'cf}\\'cf}", "\u041F\u00CF"},
         {"two bytes a character", "{\\rtf1{\\fonttbl{\\f1\\fcharset128 B;}}\\f1\\'82\\'a0\\'83A b}", "\u3042\u30A2 b"},
         {"two bytes, one raw, over a line", "{\\rtf1\\ansicpg932 \\'82\n\xA0!}", "\u3042!"},
         {"half a character", "{\\rtf1\\ansicpg936 a\\'b0\\b b}", "a\uFFFDb"},
         {"bullet of a symbol font", "{\\rtf1{\\fonttbl{\\f3\\fcharset2 Symbol;}}{\\f3\\'b7}\\'b7}", "\u2022\u00B7"},
         {"unknown page", "{\\rtf1\\ansicpg4711 \\'e9}", "\u00E9"},
         {"no hexadecimal digits", "{\\rtf1 a\\'zzb}", "azzb"}});
}

TEST(RTFText, Destinations) {
    expectTexts(
        {{"unknown ones are skipped", "{\\rtf1 a{\\*\\unknown b{c}\\'e9\\u8364 d}e}", "ae"},
         {"nothing comes out of a skipped one", "{\\rtf1 a{\\*\\x {\\fonttbl\\f0 b}{\\field{\\*\\fldinst c}{d}}}e}",
          "ae"},
         {"unknown words are not", "{\\rtf1 a{\\unknown b}c}", "abc"},
         {"tables at the head",
          "{\\rtf1{\\fonttbl\\f0\\fswiss Helvetica;}{\\colortbl;\\red1\\green2\\blue3;}{\\stylesheet{\\s0 Normal;}}"
          "{\\info{\\title T}}{\\header h}a}",
          "a"},
         {"pictures", "{\\rtf1 a{\\pict\\pngblip 89504e}b{\\*\\shppict{\\pict 00}}c}", "abc"},
         {"binary data", "{\\rtf1 a\\bin4 }{\\bb}", "ab"},
         {"binary data past the end", "{\\rtf1 a\\bin99999999 b}", "a"},
         {"negative binary data", "{\\rtf1 a\\bin-5 b}", "ab"},
         {"markers of lists stay", "{\\rtf1{\\listtext\\tab\\u8226?\\tab}One}", "\t\u2022\tOne"},
         {"and stand between tabs", "{\\rtf1{\\listtext  1.\\tab}a}", "\t1.\ta"},
         {"in any look", "{\\rtf1{\\listtext{\\b 1.}\\tab}a}", "\t1.\ta"},
         {"empty marker", "{\\rtf1{\\listtext}a b}", "a b"},
         {"other fields show their result", "{\\rtf1{\\field{\\*\\fldinst PAGE}{\\fldrslt 7}}}", "7"},
         {"attachment without its file", "{\\rtf1 a{{\\NeXTGraphic x.png \\width20 }\\'ac}b}", "ab"}});
}

TEST(RTFText, CutShort) {
    expectTexts({{"no end", "{\\rtf1 a{\\b b", "ab"},
                 {"half a number", "{\\rtf1 a\\u82", "a"},
                 {"half a word", "{\\rtf1 a\\par", "a"},
                 {"minus without number", "{\\rtf1 a\\u-", "a"},
                 {"half a byte", "{\\rtf1 a\\'e", "a"},
                 {"backslash", "{\\rtf1 a\\", "a"},
                 {"signature only", "{\\rtf", ""}});
}

TEST(RTFReader, RefusesWhatDoesNotStartAsRTF) {
    for (const std::string_view bytes : {"", "plain", " {\\rtf1 a}", "{\\html}"}) {
        const auto text = attributedStringFromRTF(bytes);
        ASSERT_FALSE(text) << bytes;
        EXPECT_THAT(text.error().message, HasSubstr("{\\rtf"));
    }
}

// ---- Formats ----

TEST(RTFReader, FontsEndWithTheirGroupAndWithPlain) {
    const AttributedString text = read(
        "{\\rtf1\\deff1{\\fonttbl{\\f0 Gill Sans;}{\\f1{\\*\\falt No} B;}}\\f0\\fs25 a{\\b\\i b}c\\fs40\\b d\\plain "
        "e}");
    EXPECT_EQ(attributesAt(text, 0).font, (FontAttribute{u"Gill Sans", 12.5, false, false}));
    EXPECT_EQ(attributesAt(text, 1).font, (FontAttribute{u"Gill Sans", 12.5, true, true}));
    EXPECT_EQ(attributesAt(text, 2), attributesAt(text, 0));
    EXPECT_EQ(attributesAt(text, 4).font, (FontAttribute{u"B", 12, false, false}));
    EXPECT_EQ(read("{\\rtf1 a\\b\\ul\\qc b\\plain\\pard c}").attributesAt(2), nullptr);
}

TEST(RTFReader, FaceInTheNameOfAFontIsAFace) {
    const AttributedString text =
        read("{\\rtf1{\\fonttbl\\f0 Helvetica-BoldOblique;\\f1 Courier-Bold;}\\f0 a\\f1\\i b}");
    EXPECT_EQ(attributesAt(text, 0).font, (FontAttribute{u"Helvetica", 12, true, true}));
    EXPECT_EQ(attributesAt(text, 1).font, (FontAttribute{u"Courier", 12, true, true}));
}

TEST(RTFReader, TextLooksAsItsControlWordsSay) {
    const std::vector<TextCase> cases = {
        {"lines and heights",
         "{\\rtf1\\ul a\\ulnone\\uldb b\\ul0\\strike c\\strike0\\striked1 d\\striked0\\super e\\sub f\\nosupersub\\up7 "
         "g"
         "\\dn h}",
         "a<underlined>b<underlined twice>c<struck>d<struck twice>e<raised>f<lowered>g<shifted 35>h<shifted -30>"},
        {"colours",
         "{\\rtf1{\\colortbl;\\red255\\green0\\blue51;\\red0\\green0\\blue0;\\red9\\green9\\blue9;}"
         "{\\*\\expandedcolortbl;;\\cssrgb\\c50000\\c0\\c100000\\c25000;\\csgray\\c20000;}"
         "\\cf1 a\\cf2\\cb3 b\\cf0\\cb0\\highlight1 c\\highlight0\\cf99 d\\cf-1 e}",
         "a<100.0.20.100>b<50.0.100.25 on 20.20.20.100>c<on 100.0.20.100>de<>"},
        {"a paragraph takes the style that holds at its end",
         "{\\rtf1 a\\b b\\qc\\par\\pard c\\par{\\pard\\qr d\\par}e}",
         "a<centred>b\n<bold centred>c\n<bold>d\n<bold right>e<bold>"},
        {"lists",
         "{\\rtf1{\\*\\listtable{\\list{\\listlevel\\levelnfc23{\\*\\levelmarker \\{circle\\}}{\\leveltext\\'01x;}}"
         "{\\listlevel\\levelnfc2\\levelstartat4{\\leveltext\\'02\\'01.;}}{\\listlevel\\levelnfc255}\\listid7}}"
         "{\\*\\listoverridetable{\\listoverride\\listid7\\ls3}}"
         "\\pard\\ls3\\ilvl0 a\\par\\ilvl1 b\\par\\ilvl2 c\\par\\pard\\ls4 d}",
         "a\n<{circle}>b\n<{circle} {lower-roman}.4>c\n<{circle} {lower-roman}.4 >d<>"},
    };
    for (const TextCase& c : cases) EXPECT_EQ(shown(read(c.rtf)), c.text) << c.name;
}

TEST(RTFReader, ParagraphDistancesAreInPoints) {
    const AttributedString text =
        read("{\\rtf1\\pard\\tx560\\tx1120\\li400\\fi-200\\ri100\\sb20\\sa40\\sl360\\slmult1\\slleading60\\qj a}");
    ParagraphStyle style;
    style.alignment = TextAlignment::Justified;
    style.headIndent = 20;
    style.firstLineHeadIndent = 10;
    style.tailIndent = -5;
    style.paragraphSpacingBefore = 1;
    style.paragraphSpacing = 2;
    style.lineHeightMultiple = 1.5;
    style.lineSpacing = 3;
    style.tabStops = {28, 56};
    EXPECT_EQ(attributesAt(text, 0).paragraphStyle, style);
}

TEST(RTFReader, LinksComeFromFields) {
    const std::vector<std::pair<std::string, std::string>> cases = {
        {" HYPERLINK \"http://a.b/?c=d e\"", "-> http://a.b/?c=d e"},
        {"  hyperlink http://a.b ", "-> http://a.b"},
        {"{\\b HYPERLINK \"http://a\\'e9\" \\\\o \"a \\\\\"tip\\\\\"\" }", "-> http://a\u00E9 (a \"tip\")"},
        {" HYPERLINK \\\\n \\\\t \"_top\" \"x\" \\\\l \"part\"", "-> x#part"},
        {" HYPERLINK \\\\l \"part\"", "-> #part"},
        {" HYPERLINK \"C:\\\\\\\\d\"", "-> C:\\d"},
    };
    for (const auto& [instruction, look] : cases) {
        const std::string rtf = "{\\rtf1 a{\\field{\\*\\fldinst" + instruction + "}{\\fldrslt{\\plain b}}}c}";
        EXPECT_EQ(shown(read(rtf)), "a<>b<" + look + ">c<>");
    }
}

// ---- Bounds ----

TEST(RTFReader, TextOfGroupsBeyondAnyDepthIsKept) {
    const std::size_t depth = 2'000'000;
    std::string rtf = "{\\rtf1 ";
    for (std::size_t i = 0; i < depth; ++i) rtf += "{";
    rtf += "\\b deep";
    rtf.append(depth, '}');
    rtf += " flat}";
    const AttributedString text = read(rtf);
    EXPECT_EQ(text.string(), u"deep flat");
    EXPECT_EQ(text.attributesAt(5), nullptr);
}

TEST(RTFReader, NumbersStopAtTheirLimits) {
    const AttributedString text = read("{\\rtf1\\fs-4 a\\fs99999999999999999999 b\\li-99999999999\\fi99999999999 c}");
    EXPECT_EQ(attributesAt(text, 0).font->size, 12);
    EXPECT_EQ(attributesAt(text, 1).font->size, 10000);
    EXPECT_EQ(attributesAt(text, 2).paragraphStyle->headIndent, -50000);
    EXPECT_EQ(attributesAt(text, 2).paragraphStyle->firstLineHeadIndent, 0);
}

// Every change of format under a link repeats it: what is made of them must not grow with their product.
TEST(RTFReader, LongLinksUnderManyFormatsStayWithinMemory) {
    std::string rtf = "{\\rtf1{\\field{\\*\\fldinst HYPERLINK \"" + std::string(1'000'000, 'x') + "\"}{\\fldrslt ";
    for (int i = 1; i < 20'000; ++i) rtf += "\\fs" + std::to_string(i) + " a";
    const AttributedString text = read(rtf + "}}}");
    EXPECT_EQ(text.length(), 19'999u);
    EXPECT_EQ(attributesAt(text, 0).link->size(), 1'000'000u);
    EXPECT_EQ(text.attributesAt(text.length() - 1), nullptr);
}

}  // namespace
}  // namespace plume
