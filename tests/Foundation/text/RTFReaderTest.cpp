#include <array>
#include <optional>
#include <ostream>
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

std::string textOf(std::string_view rtf) {
    return toUtf8(read(rtf).string());
}

// ---- Text ----

struct TextCase {
    const char* name;
    std::string rtf;
    std::string text;
};

std::ostream& operator<<(std::ostream& stream, const TextCase& textCase) {
    return stream << textCase.name;
}

class RTFText : public testing::TestWithParam<TextCase> {};

TEST_P(RTFText, Reads) {
    EXPECT_EQ(textOf(GetParam().rtf), GetParam().text);
}

INSTANTIATE_TEST_SUITE_P(
    Characters, RTFText,
    testing::Values(TextCase{"paragraphs", "{\\rtf1 a\\par b\\\nc\\\r\nd}", "a\nb\nc\nd"},
                    TextCase{"source lines are not text", "{\\rtf1 a\nb\r\nc}", "abc"},
                    TextCase{"escaped characters", "{\\rtf1 \\{\\}\\\\}", "{}\\"},
                    TextCase{"one space ends a word", "{\\rtf1\\b  a\\b0  b}", " a b"},
                    TextCase{"special characters",
                             "{\\rtf1\\emdash\\endash\\bullet\\lquote\\rquote\\ldblquote\\rdblquote\\tab\\line x}",
                             "\u2014\u2013\u2022\u2018\u2019\u201C\u201D\t\u2028x"},
                    TextCase{"symbols", "{\\rtf1 a\\~b\\_c\\-d}", "a\u00A0b\u2011c\u00ADd"},
                    TextCase{"cells and rows", "{\\rtf1 a\\cell b\\cell\\row c}", "a\tb\t\nc"},
                    TextCase{"hidden text", "{\\rtf1 a{\\v b}c\\v d\\v0 e}", "ace"},
                    TextCase{"after the end", "{\\rtf1 a}b{c}", "a"}));

INSTANTIATE_TEST_SUITE_P(
    Unicode, RTFText,
    testing::Values(TextCase{"one fallback character", "{\\rtf1\\u8364 ?a\\u8364xb}", "\u20ACa\u20ACb"},
                    TextCase{"hexadecimal fallback", "{\\rtf1\\u8364\\'80a}", "\u20ACa"},
                    TextCase{"no fallback", "{\\rtf1\\uc0\\u8364 a\\u8364\\u8364b}", "\u20ACa\u20AC\u20ACb"},
                    TextCase{"several fallback characters", "{\\rtf1\\uc3\\u8364 ?\\'3f?a}", "\u20ACa"},
                    TextCase{"fallback belongs to the group", "{\\rtf1{\\uc0\\u8364 a}\\u8364?b}", "\u20ACa\u20ACb"},
                    TextCase{"fallback ends with its group", "{\\rtf1{\\u8364}a}", "\u20ACa"},
                    TextCase{"formatting is no fallback", "{\\rtf1\\u8364\\b a}", "\u20ACa"},
                    TextCase{"symbol as fallback", "{\\rtf1\\u8211\\endash a}", "\u2013a"},
                    TextCase{"negative numbers", "{\\rtf1\\uc0\\u-3913 }", "\uF0B7"},
                    TextCase{"surrogates", "{\\rtf1\\uc0\\u-10179 \\u-8704 \\u55357 \\u56832 }",
                             "\U0001F600\U0001F600"},
                    TextCase{"beyond 16 bits", "{\\rtf1\\uc0\\u128512 }", "\U0001F600"},
                    TextCase{"no such character", "{\\rtf1\\uc0 a\\u9999999999 b\\u c}", "abc"}));

INSTANTIATE_TEST_SUITE_P(
    CodePages, RTFText,
    testing::Values(
        TextCase{"Latin by default", "{\\rtf1 \\'93\\'e9\\'94}", "\u201C\u00E9\u201D"},
        TextCase{"raw bytes", "{\\rtf1 caf\xE9!}", "caf\u00E9!"},
        TextCase{"Mac Roman", "{\\rtf1\\mac \\'8e\\'a5}", "\u00E9\u2022"},
        TextCase{"Cyrillic document", "{\\rtf1\\ansi\\ansicpg1251 \\'cf\\'f0}", "\u041F\u0440"},
        TextCase{"Arabic font", "{\\rtf1\\ansi{\\fonttbl{\\f0 A;}{\\f1\\fcharset178 B;}}\\f0\\'e9\\f1\\'e3\\'d1}",
                 "\u00E9\u0645\u0631"},
        TextCase{"font of a group", "{\\rtf1{\\fonttbl{\\f1\\fcharset204 B;}}{\\f1\\'cf}\\'cf}", "\u041F\u00CF"},
        TextCase{"two bytes a character", "{\\rtf1{\\fonttbl{\\f1\\fcharset128 B;}}\\f1\\'82\\'a0\\'83A b}",
                 "\u3042\u30A2 b"},
        TextCase{"two bytes, one raw, over a line", "{\\rtf1\\ansicpg932 \\'82\n\xA0!}", "\u3042!"},
        TextCase{"half a character", "{\\rtf1\\ansicpg936 a\\'b0\\b b}", "a\uFFFDb"},
        TextCase{"bullet of a symbol font", "{\\rtf1{\\fonttbl{\\f3\\fcharset2 Symbol;}}{\\f3\\'b7}\\'b7}",
                 "\u2022\u00B7"},
        TextCase{"unknown page", "{\\rtf1\\ansicpg4711 \\'e9}", "\u00E9"},
        TextCase{"no hexadecimal digits", "{\\rtf1 a\\'zzb}", "azzb"}));

INSTANTIATE_TEST_SUITE_P(
    Destinations, RTFText,
    testing::Values(
        TextCase{"unknown ones are skipped", "{\\rtf1 a{\\*\\unknown b{c}\\'e9\\u8364 d}e}", "ae"},
        TextCase{"nothing comes out of a skipped one",
                 "{\\rtf1 a{\\*\\x {\\fonttbl\\f0 b}{\\field{\\*\\fldinst c}{d}}}e}", "ae"},
        TextCase{"unknown words are not", "{\\rtf1 a{\\unknown b}c}", "abc"},
        TextCase{
            "tables at the head",
            "{\\rtf1{\\fonttbl\\f0\\fswiss Helvetica;}{\\colortbl;\\red1\\green2\\blue3;}{\\stylesheet{\\s0 Normal;}}"
            "{\\info{\\title T}}{\\header h}a}",
            "a"},
        TextCase{"pictures", "{\\rtf1 a{\\pict\\pngblip 89504e}b{\\*\\shppict{\\pict 00}}c}", "abc"},
        TextCase{"binary data", "{\\rtf1 a\\bin4 }{\\bb}", "ab"},
        TextCase{"binary data past the end", "{\\rtf1 a\\bin99999999 b}", "a"},
        TextCase{"negative binary data", "{\\rtf1 a\\bin-5 b}", "ab"},
        TextCase{"markers of lists stay", "{\\rtf1{\\listtext\\tab\\u8226?\\tab}One}", "\t\u2022\tOne"},
        TextCase{"other fields show their result", "{\\rtf1{\\field{\\*\\fldinst PAGE}{\\fldrslt 7}}}", "7"},
        TextCase{"attachment without its file", "{\\rtf1 a{{\\NeXTGraphic x.png \\width20 }\\'ac}b}", "ab"}));

INSTANTIATE_TEST_SUITE_P(CutShort, RTFText,
                         testing::Values(TextCase{"no end", "{\\rtf1 a{\\b b", "ab"},
                                         TextCase{"half a number", "{\\rtf1 a\\u82", "a"},
                                         TextCase{"half a word", "{\\rtf1 a\\par", "a"},
                                         TextCase{"minus without number", "{\\rtf1 a\\u-", "a"},
                                         TextCase{"half a byte", "{\\rtf1 a\\'e", "a"},
                                         TextCase{"backslash", "{\\rtf1 a\\", "a"},
                                         TextCase{"signature only", "{\\rtf", ""}));

TEST(RTFReader, RefusesWhatDoesNotStartAsRTF) {
    for (const std::string_view bytes : {"", "plain", " {\\rtf1 a}", "{\\html}"}) {
        const auto text = attributedStringFromRTF(bytes);
        ASSERT_FALSE(text) << bytes;
        EXPECT_THAT(text.error().message, HasSubstr("{\\rtf"));
    }
}

// ---- Formats ----

TEST(RTFReader, FormatsEndWithTheirGroup) {
    const AttributedString text = read("{\\rtf1{\\fonttbl\\f0\\fswiss\\fcharset0 Gill Sans;}\\f0\\fs25 a{\\b\\i b}c}");
    EXPECT_EQ(attributesAt(text, 0).font, (FontAttribute{u"Gill Sans", 12.5, false, false}));
    EXPECT_EQ(attributesAt(text, 1).font, (FontAttribute{u"Gill Sans", 12.5, true, true}));
    EXPECT_EQ(attributesAt(text, 2), attributesAt(text, 0));
}

TEST(RTFReader, PlainTextHasNoAttributes) {
    EXPECT_EQ(read("{\\rtf1 a\\b\\ul\\qc b\\plain\\pard c}").attributesAt(2), nullptr);
}

TEST(RTFReader, PlainGoesBackToTheDefaultFont) {
    const AttributedString text =
        read("{\\rtf1\\deff1{\\fonttbl{\\f0 A;}{\\f1{\\*\\falt No} B;}}\\f0\\fs40\\b a\\plain b}");
    EXPECT_EQ(attributesAt(text, 1).font, (FontAttribute{u"B", 12, false, false}));
}

TEST(RTFReader, FaceInTheNameOfAFontIsAFace) {
    const AttributedString text =
        read("{\\rtf1{\\fonttbl\\f0 Helvetica-BoldOblique;\\f1 Courier-Bold;}\\f0 a\\f1\\i b}");
    EXPECT_EQ(attributesAt(text, 0).font, (FontAttribute{u"Helvetica", 12, true, true}));
    EXPECT_EQ(attributesAt(text, 1).font, (FontAttribute{u"Courier", 12, true, true}));
}

TEST(RTFReader, LinesAndHeightsSwitchOnAndOff) {
    const AttributedString text = read(
        "{\\rtf1\\ul a\\ulnone\\uldb b\\ul0\\strike c\\strike0\\striked1 d\\striked0\\super e\\sub f\\nosupersub\\up7 "
        "g\\dn h}");
    EXPECT_EQ(attributesAt(text, 0).underlineStyle, 1);
    EXPECT_EQ(attributesAt(text, 1).underlineStyle, 9);
    EXPECT_EQ(attributesAt(text, 2).underlineStyle, 0);
    EXPECT_EQ(attributesAt(text, 2).strikethroughStyle, 1);
    EXPECT_EQ(attributesAt(text, 3).strikethroughStyle, 9);
    EXPECT_EQ(attributesAt(text, 4).superscript, 1);
    EXPECT_EQ(attributesAt(text, 5).superscript, -1);
    EXPECT_EQ(attributesAt(text, 6).superscript, 0);
    EXPECT_EQ(attributesAt(text, 6).baselineOffset, 3.5);
    EXPECT_EQ(attributesAt(text, 7).baselineOffset, -3);
}

TEST(RTFReader, ColorsComeFromTheTables) {
    const AttributedString text = read(
        "{\\rtf1{\\colortbl;\\red255\\green0\\blue51;\\red0\\green0\\blue0;\\red9\\green9\\blue9;}"
        "{\\*\\expandedcolortbl;;\\cssrgb\\c50000\\c0\\c100000\\c25000;\\csgray\\c20000;}"
        "\\cf1 a\\cf2\\cb3 b\\cf0\\cb0\\highlight1 c\\highlight0\\cf99 d\\cf-1 e}");
    EXPECT_EQ(attributesAt(text, 0).foregroundColor, (ColorAttribute{1, 0, 0.2, 1}));
    EXPECT_EQ(attributesAt(text, 1).foregroundColor, (ColorAttribute{0.5, 0, 1, 0.25}));
    EXPECT_EQ(attributesAt(text, 1).backgroundColor, (ColorAttribute{0.2, 0.2, 0.2, 1}));
    EXPECT_EQ(attributesAt(text, 2).foregroundColor, std::nullopt);
    EXPECT_EQ(attributesAt(text, 2).backgroundColor, (ColorAttribute{1, 0, 0.2, 1}));
    EXPECT_EQ(text.attributesAt(3), nullptr);
    EXPECT_EQ(text.attributesAt(4), nullptr);
}

TEST(RTFReader, ParagraphTakesTheStyleThatHoldsAtItsEnd) {
    const AttributedString text = read("{\\rtf1 a\\b b\\qc\\par\\pard c\\par{\\pard\\qr d\\par}e}");
    for (const std::size_t index : {0u, 1u, 2u}) {
        EXPECT_EQ(attributesAt(text, index).paragraphStyle->alignment, TextAlignment::Center) << index;
    }
    EXPECT_FALSE(attributesAt(text, 3).paragraphStyle);
    EXPECT_EQ(attributesAt(text, 5).paragraphStyle->alignment, TextAlignment::Right);
    EXPECT_FALSE(attributesAt(text, 7).paragraphStyle);
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

TEST(RTFReader, ListsComeFromTheListTables) {
    const AttributedString text = read(
        "{\\rtf1{\\*\\listtable{\\list{\\listlevel\\levelnfc23{\\*\\levelmarker \\{circle\\}}{\\leveltext\\'01x;}}"
        "{\\listlevel\\levelnfc2\\levelstartat4{\\leveltext\\'02\\'01.;}}\\listid7}}"
        "{\\*\\listoverridetable{\\listoverride\\listid7\\ls3}}"
        "\\pard\\ls3\\ilvl0 a\\par\\ilvl1 b\\par\\pard\\ls4 c}");
    const std::vector<TextList> outer = {{u"{circle}", 1}};
    const std::vector<TextList> inner = {{u"{circle}", 1}, {u"{lower-roman}.", 4}};
    EXPECT_EQ(text.string(), u"a\nb\nc");
    EXPECT_EQ(attributesAt(text, 0).paragraphStyle->textLists, outer);
    EXPECT_EQ(attributesAt(text, 2).paragraphStyle->textLists, inner);
    EXPECT_FALSE(attributesAt(text, 4).paragraphStyle);
}

struct LinkCase {
    const char* instruction;
    std::u16string link;
    std::optional<std::u16string> toolTip;
};

TEST(RTFReader, LinksComeFromFields) {
    const std::array cases = {
        LinkCase{"HYPERLINK \"http://a.b/?c=d e\"", u"http://a.b/?c=d e", {}},
        LinkCase{" hyperlink http://a.b ", u"http://a.b", {}},
        LinkCase{"{\\b HYPERLINK \"http://a\\'e9\" \\\\o \"a \\\\\"tip\\\\\"\" }", u"http://a\u00E9", u"a \"tip\""},
        LinkCase{"HYPERLINK \\\\n \\\\t \"_top\" \"x\" \\\\l \"part\"", u"x#part", {}},
        LinkCase{"HYPERLINK \\\\l \"part\"", u"#part", {}},
        LinkCase{"HYPERLINK \"C:\\\\\\\\d\"", u"C:\\d", {}},
    };
    for (const LinkCase& link : cases) {
        const AttributedString text =
            read("{\\rtf1 a{\\field{\\*\\fldinst" + std::string(link.instruction[0] == '{' ? "" : " ") +
                 link.instruction + "}{\\fldrslt{\\plain b}}}c}");
        ASSERT_EQ(text.string(), u"abc") << link.instruction;
        EXPECT_EQ(attributesAt(text, 1).link, link.link) << link.instruction;
        EXPECT_EQ(attributesAt(text, 1).toolTip, link.toolTip) << link.instruction;
        EXPECT_EQ(text.attributesAt(2), nullptr) << link.instruction;
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
