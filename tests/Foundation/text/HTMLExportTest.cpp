#include "Foundation/text/HTMLExport.h"

#include <gtest/gtest.h>

#include "tests/Foundation/text/RTFTestSupport.h"

namespace plume {
namespace {

struct ExportCase {
    const char* about;
    AttributedString text;
    std::string html;
    bool paragraphs = true;
};

AttributedString joined(std::initializer_list<AttributedString> pieces) {
    AttributedString text;
    for (const auto& piece : pieces) text.append(piece);
    return text;
}

TEST(HTMLExport, WritesWhatTheTextLooksLike) {
    const auto list = [](const char16_t* text, std::vector<TextList> lists) {
        return attributed(text, [&](TextAttributes& a) { a.paragraphStyle.emplace().textLists = lists; });
    };
    const ExportCase cases[] = {
        {"empty", AttributedString(), ""},
        {"plain", AttributedString(u"a & <b>"), "<p>a &amp; &lt;b&gt;</p>"},
        {"not ASCII", AttributedString(u"\u00e9\U0001f600"), "<p>\xc3\xa9\xf0\x9f\x98\x80</p>"},
        {"paragraphs", AttributedString(u"a\n\nb\n"), "<p>a</p><p><br></p><p>b</p>"},
        {"line ends", AttributedString(u"a\r\nb\u2029c\u2028d"), "<p>a</p><p>b</p><p>c<br>d</p>"},
        {"no paragraphs", AttributedString(u"a\nb"), "a<br>b", false},
        {"no paragraphs, break at the end", AttributedString(u"a\n\nb\n"), "a<br><br>b<br>", false},
        {"what HTML cannot hold in a link", attributed(u"a", [](auto& a) { a.link = std::u16string(u"x:\r") + u'\0'; }),
         "<p><a href=\"x:&#13;\xef\xbf\xbd\">a</a></p>"},
        {"half a character before what HTML cannot hold",
         AttributedString(std::u16string(u"\xd800") + u'\0' + u"\xd800\u2028\xd800\u0001"),
         "<p>\xef\xbf\xbd\xef\xbf\xbd\xef\xbf\xbd<br>\xef\xbf\xbd</p>"},
        {"spaces", AttributedString(u" a  b \n c "), "<p>&nbsp;a &nbsp;b </p><p>&nbsp;c&nbsp;</p>"},
        {"tab", AttributedString(u"a\tb"), "<p>a<span style=\"white-space:pre\">\t</span>b</p>"},
        {"bold",
         joined({AttributedString(u"a"), attributed(u" b",
                                                    [](auto& a) {
                                                        a.font = FontAttribute{u"", 0, true, true};
                                                    })}),
         "<p>a<b><i> b</i></b></p>"},
        {"font",
         attributed(u"a",
                    [](auto& a) {
                        a.font = FontAttribute{u"Times'; x:y", 10.5, false, false};
                    }),
         "<p><span style=\"font-family:'Times x:y';font-size:10.5pt;\">a</span></p>"},
        {"colour",
         attributed(u"a",
                    [](auto& a) {
                        a.foregroundColor = ColorAttribute{1, 0, 0.5, 1};
                    }),
         "<p><span style=\"color:#ff0080;\">a</span></p>"},
        {"underline", attributed(u"a", [](auto& a) { a.underlineStyle = 1; }), "<p><u>a</u></p>"},
        {"link",
         attributed(u"a",
                    [](auto& a) {
                        a.link = u"https://example.org/?a=\"b\"&c";
                        a.underlineStyle = 1;
                    }),
         "<p><a href=\"https://example.org/?a=&quot;b&quot;&amp;c\">a</a></p>"},
        {"centred", attributed(u"a", [](auto& a) { a.paragraphStyle.emplace().alignment = TextAlignment::Center; }),
         "<p style=\"text-align:center;\">a</p>"},
        {"list",
         joined({AttributedString(u"x\n"), list(u"\t\u2022\ta\n", {{u"{disc}", 1}}),
                 list(u"\t1.\tb\n", {{u"{disc}", 1}, {u"{decimal}.", 1}}), AttributedString(u"y")}),
         "<p>x</p><ul><li>a</li><ol><li>b</li></ol></ul><p>y</p>"},
        {"image", attributed(u"\xfffc", [](auto& a) { a.attachment = attachment(u"i.png", "\x89PNG"); }),
         "<p><img src=\"data:image/png;base64,iVBORw==\" alt=\"i.png\"></p>"},
    };
    for (const ExportCase& c : cases) {
        auto excluded = defaultExcludedTags();
        if (!c.paragraphs) excluded.emplace_back("p");
        EXPECT_EQ(htmlFromAttributedString(c.text, excluded), c.html) << c.about;
    }
}

TEST(HTMLExport, WritesAWholeDocumentWhenAskedTo) {
    EXPECT_EQ(htmlFromAttributedString(AttributedString(u"a"), {}),
              "<?xml version=\"1.0\" encoding=\"UTF-8\"?><!DOCTYPE html><html><head><meta charset=\"utf-8\"></head>"
              "<body><p>a</p></body></html>");
}

}  // namespace
}  // namespace plume
