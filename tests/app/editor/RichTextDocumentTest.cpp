// Attributed texts come out of documents as they went in, and what is typed in between is like what is around it.
#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <QTextBlock>
#include <QTextCursor>
#include <QTextDocument>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>

#include "Foundation/text/RTFD.h"
#include "app/editor/RichTextDocument.h"
#include "app/editor/TextFormats.h"
#include "content/SnippetEditContent.h"
#include "tests/app/editor/RichTextSupport.h"

namespace plume {
namespace {

using namespace test;

AttributedString thereAndBack(const AttributedString& content) {
    QTextDocument document;
    setDocument(document, content);
    return contentOf(document);
}

RC_GTEST_PROP(RichTextDocument, WhatIsShownReadsBackTheSame, ()) {
    const AttributedString content = anyContent();
    RC_ASSERT(thereAndBack(content) == content);
}

RC_GTEST_PROP(RichTextDocument, AnyPieceIsThatOfTheText, ()) {
    const AttributedString content(anyText());
    QTextDocument document;
    setDocument(document, content);
    const std::size_t units = *rc::gen::inRange<std::size_t>(0, content.length() + 1);
    if (units > 0 && units < content.length() && content.string().substr(units - 1, 2) == u"\r\n") return;
    const int cut = positionsFor(content, units);
    RC_ASSERT(contentBetween(document, 0, cut) == content.substring({0, units}));
    RC_ASSERT(contentBetween(document, cut, document.characterCount() - 1) ==
              content.substring({units, content.length() - units}));
}

TEST(RichTextDocument, TextsOfOtherProgramsReadBackTheSame) {
    int read = 0;
    for (const auto& file : std::filesystem::directory_iterator("tests/Foundation/text/data")) {
        if (file.path().extension() != ".rtf") continue;
        std::ifstream stream(file.path(), std::ios::binary);
        const std::string bytes{std::istreambuf_iterator<char>(stream), {}};
        const auto content = attributedStringFromRTF(bytes);
        ASSERT_TRUE(content.ok()) << file.path();
        EXPECT_EQ(thereAndBack(content.value()), content.value()) << file.path();
        ++read;
    }
    EXPECT_GT(read, 5);
}

TEST(RichTextDocument, PlaceholdersAreOneCharacterEachAndComeBackAsText) {
    AttributedString content(u"a\u3010date:short\u3011\u3010|\u3011\u3010|\u3011", boldLook());
    content.append(u" \u3010no chip\u3011 \u3010snippet:sig\u3011");
    QTextDocument document;
    setDocument(document, convertToSnippetEditContent(content));
    EXPECT_EQ(document.characterCount() - 1, 1 + 3 + 11 + 1);
    EXPECT_EQ(contentOf(document), content);
}

TEST(RichTextDocument, EqualChipsSideBySideStayTwo) {
    QTextDocument document;
    setDocument(document, convertToSnippetEditContent(AttributedString(u"\u3010|\u3011\u3010|\u3011")));
    int fragments = 0;
    for (auto each = document.begin().begin(); !each.atEnd(); ++each) ++fragments;
    EXPECT_EQ(fragments, 2);
}

TEST(RichTextDocument, WhatIsTypedLooksLikeWhatIsBeforeIt) {
    TextAttributes picture;
    picture.underlineStyle = 1;
    picture.attachment = std::make_shared<const TextAttachment>(TextAttachment{u"a.txt", "a", {}});
    AttributedString content(u"x", boldLook());
    content.append(u"\uFFFC", looking(picture));
    QTextDocument document;
    setDocument(document, content);
    QTextCursor cursor(&document);
    cursor.movePosition(QTextCursor::End);
    cursor.insertText(QStringLiteral("y\nz"));
    cursor.setPosition(1);
    cursor.insertText(QStringLiteral("w"));

    TextAttributes beside;
    beside.underlineStyle = 1;
    AttributedString expected(u"xw", boldLook());
    expected.append(u"\uFFFC", looking(picture));
    expected.append(u"y\nz", looking(beside));
    EXPECT_EQ(contentOf(document), expected);
}

TEST(RichTextDocument, JoinedParagraphsHaveTheStyleOfTheFirst) {
    const auto aligned = [](TextAlignment alignment) {
        TextAttributes attributes;
        attributes.paragraphStyle = ParagraphStyle();
        attributes.paragraphStyle->alignment = alignment;
        return looking(attributes);
    };
    AttributedString content(u"one\n", aligned(TextAlignment::Center));
    content.append(u"two", aligned(TextAlignment::Right));
    QTextDocument document;
    setDocument(document, content);
    QTextCursor cursor(&document);
    cursor.setPosition(4);
    cursor.deletePreviousChar();
    EXPECT_EQ(contentOf(document), AttributedString(u"onetwo", aligned(TextAlignment::Center)));
}

TEST(RichTextDocument, AForeignTextLeavesTheParagraphsAroundIt) {
    TextAttributes centred;
    centred.paragraphStyle = ParagraphStyle();
    centred.paragraphStyle->alignment = TextAlignment::Center;
    QTextDocument document;
    setDocument(document, AttributedString(u"ab", looking(centred)));
    QTextCursor cursor(&document);
    cursor.setPosition(1);
    insertForeignContent(cursor, AttributedString(u"1\n2\n3"));

    AttributedString expected(u"a1\n", looking(centred));
    expected.append(u"2\n");
    expected.append(u"3b", looking(centred));
    EXPECT_EQ(contentOf(document), expected);
}

}  // namespace
}  // namespace plume
