#include "Foundation/text/HTMLImport.h"

#include <gtest/gtest.h>

#include "Foundation/text/HTMLExport.h"
#include "Foundation/text/MarkdownImport.h"
#include "tests/Foundation/text/RTFTestSupport.h"

namespace plume {
namespace {

std::string textOf(const std::string& html) {
    return toUtf8(attributedStringFromHTML(html).string());
}

TEST(HTMLImport, ReadsLinesAsBrowsersShowThem) {
    const std::pair<std::string, std::string> cases[] = {
        {"", ""},
        {"plain", "plain"},
        {" a \n b ", "a b"},
        {"<p>a</p>\n<p>b</p>", "a\nb"},
        {"a<br>b<br><br>c", "a\nb\n\nc"},
        {"<p>a</p><p><br></p><p>b<br></p><p>c</p>", "a\n\nb\nc"},
        {"<div>a<div>b</div>c</div>d", "a\nb\nc\nd"},
        {"a <b> b</b> c", "a b c"},
        {"a &nbsp;b", "a  b"},
        {"&lt;&amp;&eacute;&#128512;", "<&\xc3\xa9\xf0\x9f\x98\x80"},
        {"<ul><li>a<li><p>b</p><p>c</p></ul>d",
         "\t\xe2\x80\xa2\ta\n\t\xe2\x80\xa2\tb\xe2\x80\xa8"
         "c\nd"},
        {"<ol start=3><li>a</li><li>b<ul><li>c</li></ul></li></ol>", "\t3.\ta\n\t4.\tb\n\t\xe2\x80\xa2\tc"},
        {"<pre>\n a\n  b\n\nc\n</pre>d", " a\n  b\n\nc\nd"},
        {"<table><tr><td>a<td>b<tr><th>c</table>", "a\tb\nc"},
        {"<script>x</script><style>y</style><!-- z --><title>t</title>a<p hidden>b", "a"},
        {"<img src=\"http://example.org/a.png\" alt=\"smile\">", "smile"},
        {"<li><input type=checkbox checked> do", "\t\xe2\x80\xa2\t\xe2\x98\x91 do"},
        {"a\xff<b", "a\xef\xbf\xbd"},
        {"<!DOCTYPE x [<!ENTITY e SYSTEM \"file:///etc/passwd\">]>a&e;b", "]>a&e;b"},
        {"<meta charset=latin1>\xc3\xa9", "\xc3\xa9"},
    };
    for (const auto& [html, text] : cases) EXPECT_EQ(textOf(html), text) << html;
}

TEST(HTMLImport, ReadsWhatTextLooksLike) {
    const std::pair<std::string, std::string> cases[] = {
        {"<strong>a", "bold"},
        {"<span style='FONT-WEIGHT: 700 !important; font-style:italic'>a", "bold italic"},
        {"<b><span style='font-weight:normal'>a", ""},
        {"<ins><del>a", "underlined struck"},
        {"<sup>a", "raised"},
        {"<font color='#f00'>a", "red"},
        {"<span style='color:rgb(100%,0,0);background:yellow'>a", "red on yellow"},
        {"<a href='https://example.org'>a", "-> https://example.org"},
        {"<p align=center>a", "centred"},
        {"<p style='text-align:right'>a", "right"},
    };
    for (const auto& [html, look] : cases) {
        EXPECT_EQ(lookOf(attributesAt(attributedStringFromHTML(html), 0)), look) << html;
    }
    const auto font = attributesAt(attributedStringFromHTML("<p style='font:x;font-family:\"Times New Roman\", "
                                                            "serif;font-size:20px'>a"),
                                   0)
                          .font;
    ASSERT_TRUE(font);
    EXPECT_EQ(*font, (FontAttribute{u"Times New Roman", 15, false, false}));
}

TEST(HTMLImport, ReadsBackWhatIsExported) {
    const char* const cases[] = {
        "<p>a &amp; <b>b</b></p>",
        "<p>a</p><p><br></p><p>&nbsp;b &nbsp;c</p>",
        "<p style=\"text-align:center;margin-left:20pt;text-indent:10pt;\">a<b><i> b</i></b></p>",
        "<p><span style=\"font-family:'Times';font-size:10.5pt;color:#ff0080;background-color:#00ff00;\">a</span>b</p>",
        "<p><a href=\"https://example.org/?a=&quot;b&quot;&amp;c\">a</a><u>u</u><s>s</s><sub>x</sub></p>",
        "<p>x</p><ul><li>a</li><ul><li>b</li><li>c<br>d</li></ul></ul><p>y</p>",
        "<p><img src=\"data:image/png;base64,iVBORw==\" alt=\"i.png\"></p>",
        "<p>a<span style=\"white-space:pre\">\t</span>b</p>",
    };
    for (const std::string html : cases) {
        const AttributedString text = attributedStringFromHTML(html);
        const std::string written = htmlFromAttributedString(text, defaultExcludedTags());
        EXPECT_EQ(written, html);
        EXPECT_EQ(attributedStringFromHTML(written), text) << html;
    }
}

TEST(HTMLImport, EndsWhereThereIsTooMuch) {
    std::string deep;
    for (int i = 0; i < 5000; ++i) deep += "<b>";
    EXPECT_EQ(textOf("a" + deep + "b"), "a");
    std::string many;
    for (int i = 0; i < 300'000; ++i) many += "<i>x</i>";
    EXPECT_EQ(textOf(many).size(), 200'000U);
}

TEST(MarkdownImport, ReadsWhatPeopleWrite) {
    const AttributedString text = attributedStringFromMarkdown(
        "# T\n\nHello **bold** and\n*it* `x`\n\n- [x] one\n- two\n\n```\nc  d\n```\n<u>raw</u> "
        "[l](https://example.org)");
    EXPECT_EQ(toUtf8(text.string()),
              "T\nHello bold and it x\n\t\xe2\x80\xa2\t\xe2\x98\x91 one\n\t\xe2\x80\xa2\ttwo\n"
              "c  d\nraw l");
    EXPECT_EQ(lookOf(attributesAt(text, 8)), "bold");
}

}  // namespace
}  // namespace plume
