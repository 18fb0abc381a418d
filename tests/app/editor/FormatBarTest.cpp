// The tool bar shows how the text at the caret looks, and changes the selection.
#include "app/editor/FormatBar.h"

#include <gtest/gtest.h>

#include <QAction>
#include <QBuffer>
#include <QComboBox>
#include <QImage>
#include <QInputDialog>
#include <QMenu>
#include <QTest>
#include <QToolButton>
#include <QVBoxLayout>
#include <functional>
#include <memory>
#include <stdexcept>
#include <string>

#include "app/editor/ContentEdit.h"
#include "tests/app/editor/RichTextSupport.h"

namespace plume {
namespace {

using namespace test;

class FormattedText {
  public:
    explicit FormattedText(const AttributedString& content) {
        auto* layout = new QVBoxLayout(&window);
        edit = new ContentEdit;
        bar = new FormatBar(*edit);
        layout->addWidget(bar);
        layout->addWidget(edit);
        edit->setContent(content, true);
        edit->selectAll();
        QObject::connect(edit, &ContentEdit::edited, [this] { ++edits; });
        window.resize(1000, 300);
        window.show();
        edit->setFocus();
        window.activateWindow();
        if (!QTest::qWaitForWindowActive(&window)) throw std::runtime_error("the window does not become active");
    }

    QToolButton& button(const QString& name) const {
        for (QToolButton* each : bar->findChildren<QToolButton*>()) {
            if (each->accessibleName() == name) return *each;
        }
        throw std::runtime_error("nothing is called " + name.toStdString());
    }
    void choose(const QString& menu, const QString& entry) const {
        for (QAction* each : button(menu).menu()->actions()) {
            if (each->text() == entry) return each->trigger();
        }
        throw std::runtime_error("nothing is called " + entry.toStdString());
    }
    QComboBox& box(const QString& name) const {
        for (QComboBox* each : bar->findChildren<QComboBox*>()) {
            if (each->accessibleName() == name) return *each;
        }
        throw std::runtime_error("nothing is called " + name.toStdString());
    }
    TextAttributes look() const {
        const SharedAttributes attributes = edit->content().attributesAt(0);
        return attributes ? *attributes : TextAttributes();
    }

    QWidget window;
    ContentEdit* edit;
    FormatBar* bar;
    int edits = 0;
};

TEST(FormatBar, EveryControlChangesItsPartOfTheLookInOneEdit) {
    struct Row {
        const char* name;
        std::function<void(const FormattedText& text)> use;
        std::function<void(TextAttributes& look)> expected;
    };
    const auto click = [](const char* name) {
        return [name](const FormattedText& text) { text.button(QString::fromLatin1(name)).click(); };
    };
    const auto press = [](Qt::Key key) {
        return [key](const FormattedText& text) { QTest::keyClick(text.edit, key, Qt::ControlModifier); };
    };
    const Row rows[] = {
        {"bold", click("Bold"), [](auto& look) { look.font->bold = false; }},
        {"Ctrl+B", press(Qt::Key_B), [](auto& look) { look.font->bold = false; }},
        {"italic", press(Qt::Key_I), [](auto& look) { look.font->italic = true; }},
        {"underline", press(Qt::Key_U), [](auto& look) { look.underlineStyle = 1; }},
        {"strike", click("Strikethrough"), [](auto& look) { look.strikethroughStyle = 1; }},
        {"color",
         [](const FormattedText& text) { text.choose(QStringLiteral("Background color"), QStringLiteral("Gray")); },
         [](auto& look) {
             look.backgroundColor = ColorAttribute{0.5, 0.5, 0.5, 1};
         }},
        {"no color",
         [](const FormattedText& text) { text.choose(QStringLiteral("Text color"), QStringLiteral("None")); },
         [](auto& look) { look.foregroundColor = std::nullopt; }},
        {"alignment",
         [](const FormattedText& text) { text.choose(QStringLiteral("Alignment"), QStringLiteral("Right")); },
         [](auto& look) {
             look.paragraphStyle = ParagraphStyle();
             look.paragraphStyle->alignment = TextAlignment::Right;
         }},
        {"size",
         [](const FormattedText& text) {
             QComboBox& size = text.box(QStringLiteral("Font size"));
             size.setEditText(QStringLiteral("13.5"));
             QTest::keyClick(&size, Qt::Key_Return);
         },
         [](auto& look) { look.font->size = 13.5; }},
        {"clear", click("Clear formatting"),
         [](auto& look) {
             look.font = std::nullopt;
             look.foregroundColor = std::nullopt;
         }},
    };
    TextAttributes before;
    before.font = FontAttribute{u"Gill Sans", 20, true, false};
    before.foregroundColor = ColorAttribute{1, 0, 0, 1};
    before.toolTip = u"kept";
    for (const Row& row : rows) {
        const FormattedText text(AttributedString(u"text \u3010|\u3011", looking(before)));
        row.use(text);
        TextAttributes expected = before;
        row.expected(expected);
        EXPECT_EQ(text.edit->content(), AttributedString(u"text \u3010|\u3011", looking(expected))) << row.name;
        EXPECT_EQ(text.edits, 1) << row.name;
    }
}

TEST(FormatBar, TheStateIsThatOfTheCaret) {
    AttributedString content(u"bold", boldLook());
    content.append(u"plain");
    const FormattedText text(content);
    QTextCursor cursor = text.edit->textCursor();
    cursor.setPosition(2);
    text.edit->setTextCursor(cursor);
    EXPECT_TRUE(text.button(QStringLiteral("Bold")).isChecked());
    cursor.setPosition(7);
    text.edit->setTextCursor(cursor);
    EXPECT_FALSE(text.button(QStringLiteral("Bold")).isChecked());
    text.button(QStringLiteral("Numbered list")).click();
    EXPECT_TRUE(text.button(QStringLiteral("Numbered list")).isChecked());
    EXPECT_EQ(text.edit->content().string(), u"\t1.\tboldplain");
}

TEST(FormatBar, ALinkIsAskedFor) {
    const FormattedText text(AttributedString(u"here"));
    text.button(QStringLiteral("Link…")).click();
    auto* dialog = text.bar->findChild<QInputDialog*>();
    ASSERT_NE(dialog, nullptr);
    dialog->setTextValue(QStringLiteral("https://example.org"));
    dialog->accept();
    EXPECT_EQ(text.look().link, u"https://example.org");
    EXPECT_EQ(text.edit->content().string(), u"here");
}

TEST(FormatBar, APictureTakesItsPlaceInTheTextAndKeepsItsBytes) {
    QImage picture(8, 8, QImage::Format_RGB32);
    picture.fill(Qt::red);
    QByteArray bytes;
    QBuffer buffer(&bytes);
    picture.save(&buffer, "PNG");
    const FormattedText text(AttributedString(u"here", boldLook()));
    text.bar->insertPicture(QStringLiteral("red.png"), bytes);
    EXPECT_EQ(text.edit->content().string(), u"\uFFFC");
    ASSERT_NE(text.look().attachment, nullptr);
    EXPECT_EQ(text.look().attachment->contents, bytes.toStdString());
    EXPECT_EQ(text.edits, 1);
}

}  // namespace
}  // namespace plume
