#include "app/form/FormLines.h"

#include <gtest/gtest.h>

#include "tests/app/form/FormSupport.h"

namespace plume {
namespace {

using test::Letter;

// Lines as one can read them: fields in brackets, scripts in braces.
std::u16string readable(const SnippetExpandedContent& content) {
    std::u16string text;
    for (const FormLine& line : formLines(content)) {
        for (const FormPiece& piece : line) {
            if (piece.kind == FormPiece::Kind::Field) {
                text += u'[' + fromQString(QString::number(piece.field)) + u']';
            } else if (piece.kind == FormPiece::Kind::Script) {
                text += u'{' + piece.text + u'}';
            } else {
                text += piece.text;
            }
        }
        text += u'|';
    }
    return text;
}

TEST(FormLines, HaveFieldsAndScriptsWhereTheyStand) {
    struct Example {
        const char* what;
        Letter letter;
        std::u16string lines;
    };
    const Example examples[] = {
        {"between texts", Letter().text(u"a ").field(u"x").text(u" b"), u"a [0] b|"},
        {"at the edges, and together", Letter().field(u"x").field(u"y").text(u"a").field(u"z"), u"[0][1]a[2]|"},
        {"any line break", Letter().text(u"a\nb\r\nc\rd\u2028e\n"), u"a|b|c|d|e||"},
        {"empty lines", Letter().text(u"a\n\n").field(u"x"), u"a||[0]|"},
        {"a script by its name", Letter().text(u"a ").script(u"date", u"date\n-u").text(u" b"), u"a {date} b|"},
        {"an optional script by its box", Letter().script(u"date", u"date", true).text(u"b"), u"[0]b|"},
        {"two scripts, one with a box", Letter().script(u"a", u"1", true).script(u"b", u"2"), u"[0]{b}|"},
    };
    for (const auto& [what, letter, lines] : examples) EXPECT_EQ(readable(letter.content()), lines) << what;
}

TEST(FormLines, PutAFieldInAScriptBehindItsName) {
    SnippetExpandedContent content = Letter().text(u"a ").script(u"s", u"echo x").text(u" b").content();
    auto field = std::make_shared<SnippetFieldVariable>();
    field->location = 5;
    content.variables.push_back(field);
    EXPECT_EQ(readable(content), u"a {s}[0] b|");
}

TEST(FormLines, KeepWhatTextLooksLike) {
    auto bold = std::make_shared<TextAttributes>();
    bold->underlineStyle = 1;
    AttributedString text(u"plain ");
    text.append(u"under\nlined", bold);
    text.append(u" end");
    const auto lines = formLines(SnippetExpandedContent(text));
    ASSERT_EQ(lines.size(), 2U);
    ASSERT_EQ(lines[0].size(), 2U);
    EXPECT_EQ(lines[0][0].attributes, nullptr);
    EXPECT_EQ(lines[0][1].text, u"under");
    ASSERT_NE(lines[1][0].attributes, nullptr);
    EXPECT_EQ(lines[1][0].attributes->underlineStyle, 1);
    EXPECT_EQ(lines[1][1].text, u" end");
}

TEST(FormLines, OfALongTextAreThoseNearItsFields) {
    Letter letter;
    for (int line = 0; line < 1000; ++line) letter.text(u"line " + fromQString(QString::number(line)) + u"\n");
    letter.field(u"x").text(u"\n");
    for (int line = 1000; line < 2000; ++line) letter.text(u"line " + fromQString(QString::number(line)) + u"\n");
    EXPECT_EQ(readable(letter.content()),
              u"…|line 996|line 997|line 998|line 999|[0]|line 1000|line 1001|line 1002|line 1003|…|");
}

// Every character is a pair of units, which a cut at a fixed unit would tear.
TEST(FormLines, OfALongLineShowBothSidesOfAField) {
    std::u16string filler;
    for (int count = 0; count < 200'000; ++count) filler += u"\U0001F600";
    for (const std::u16string shift : {u"", u"x"}) {
        const auto line = formLines(Letter().text(shift + filler).field(u"x").text(filler + shift).content()).at(0);
        std::size_t units = 0;
        for (const FormPiece& piece : line) {
            units += piece.text.size();
            EXPECT_TRUE(toQString(piece.text).isValidUtf16());
        }
        EXPECT_LT(units, 2000U);
        ASSERT_EQ(line.size(), 5U);
        EXPECT_EQ(line[0].kind, FormPiece::Kind::Omitted);
        EXPECT_EQ(line[2].kind, FormPiece::Kind::Field);
        EXPECT_EQ(line[4].kind, FormPiece::Kind::Omitted);
    }
}

}  // namespace
}  // namespace plume
