#include "Foundation/text/HTMLExport.h"

#include <gtest/gtest.h>

namespace plume {
namespace {

SharedAttributes look(const std::function<void(TextAttributes&)>& set) {
    TextAttributes attributes;
    set(attributes);
    return std::make_shared<const TextAttributes>(attributes);
}

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
    const auto bold = look([](TextAttributes& a) { a.font = FontAttribute{u"", 0, true, true}; });
    const auto font = look([](TextAttributes& a) { a.font = FontAttribute{u"Times'; x:y", 10.5, false, false}; });
    const auto red = look([](TextAttributes& a) {
        a.foregroundColor = ColorAttribute{1, 0, 0.5, 1};
        a.underlineStyle = 1;
    });
    const auto link = look([](TextAttributes& a) {
        a.link = u"https://example.org/?a=\"b\"&c";
        a.underlineStyle = 1;
    });
    const auto centred = look([](TextAttributes& a) {
        a.paragraphStyle = ParagraphStyle{};
        a.paragraphStyle->alignment = TextAlignment::Center;
    });
    const auto item = look([](TextAttributes& a) {
        a.paragraphStyle = ParagraphStyle{};
        a.paragraphStyle->textLists = {{u"{disc}", 1}};
    });
    const auto numbered = look([](TextAttributes& a) {
        a.paragraphStyle = ParagraphStyle{};
        a.paragraphStyle->textLists = {{u"{disc}", 1}, {u"{decimal}.", 1}};
    });
    const auto image = look([](TextAttributes& a) {
        a.attachment = std::make_shared<TextAttachment>(TextAttachment{u"i.png", "\x89PNG", u""});
    });
    const ExportCase cases[] = {
        {"empty", AttributedString(), ""},
        {"plain", AttributedString(u"a & <b>"), "<p>a &amp; &lt;b&gt;</p>"},
        {"not ASCII", AttributedString(u"\u00e9\U0001f600"), "<p>\xc3\xa9\xf0\x9f\x98\x80</p>"},
        {"paragraphs", AttributedString(u"a\n\nb\n"), "<p>a</p><p><br></p><p>b</p>"},
        {"line ends", AttributedString(u"a\r\nb\u2029c\u2028d"), "<p>a</p><p>b</p><p>c<br>d</p>"},
        {"no paragraphs", AttributedString(u"a\nb"), "a<br>b", false},
        {"no paragraphs, break at the end", AttributedString(u"a\n\nb\n"), "a<br><br>b<br>", false},
        {"spaces", AttributedString(u" a  b "), "<p>&nbsp;a &nbsp;b </p>"},
        {"tab", AttributedString(u"a\tb"), "<p>a<span style=\"white-space:pre\">\t</span>b</p>"},
        {"bold", joined({AttributedString(u"a"), AttributedString(u"b", bold)}), "<p>a<b><i>b</i></b></p>"},
        {"font", AttributedString(u"a", font),
         "<p><span style=\"font-family:'Times x:y';font-size:10.5pt;\">a</span></p>"},
        {"colour", AttributedString(u"a", red), "<p><span style=\"color:#ff0080;\"><u>a</u></span></p>"},
        {"link", AttributedString(u"a", link), "<p><a href=\"https://example.org/?a=&quot;b&quot;&amp;c\">a</a></p>"},
        {"centred", AttributedString(u"a", centred), "<p style=\"text-align:center;\">a</p>"},
        {"list",
         joined({AttributedString(u"x\n"), AttributedString(u"\t\u2022\ta\n", item),
                 AttributedString(u"\t1.\tb\n", numbered), AttributedString(u"y")}),
         "<p>x</p><ul><li>a</li><ol><li>b</li></ol></ul><p>y</p>"},
        {"image", AttributedString(u"\xfffc", image),
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
