#include "app/editor/DelimitersEdit.h"

#include <gtest/gtest.h>

#include <QCheckBox>
#include <QLineEdit>
#include <QListView>

#include "Foundation/Strings.h"
#include "app/editor/InputSourcesEdit.h"
#include "engine/AutoText.h"
#include "tests/app/windows/WindowsSupport.h"

namespace plume {
namespace {

using test::find;

class DelimitersEditTest : public testing::Test {
  protected:
    DelimitersEditTest() {
        QObject::connect(&edit, &DelimitersEdit::changed, [this](const auto& delimiters) {
            told.push_back(delimiters ? toUtf8(textFromDelimiters(*delimiters)) : "the usual ones");
        });
        edit.show();
        test::activate(edit);
    }
    void choose(const std::u16string& characters) { edit.setDelimiters(CharacterSet::withCharacters(characters)); }
    void click(const char* name) { find<QCheckBox>(edit, QString::fromUtf8(name)).click(); }
    QLineEdit& others() { return find<QLineEdit>(edit, QStringLiteral("Behind: Others")); }
    void type(const char* text) {
        others().setFocus();
        others().selectAll();
        QTest::keyClick(&others(), Qt::Key_Delete);
        QTest::keyClicks(&others(), QString::fromUtf8(text));
        QTest::keyClick(&others(), Qt::Key_Return);
    }

    DelimitersEdit edit{QStringLiteral("Behind:")};
    std::vector<std::string> told;
};

TEST_F(DelimitersEditTest, BeginsOnesOwnWithTheUsualOnes) {
    EXPECT_FALSE(edit.delimiters());
    click("Behind: The usual ones");
    EXPECT_EQ(edit.delimiters(), AutoText::defaultDelimiters());
    click("Behind: Tab");
    EXPECT_EQ(edit.delimiters(), AutoText::defaultDelimiters().subtracting(CharacterSet::withCharacters(u"\t")));
    click("Behind: The usual ones");
    EXPECT_FALSE(edit.delimiters());
    EXPECT_EQ(told.size(), 3U);
    EXPECT_EQ(told.back(), "the usual ones");
}

TEST_F(DelimitersEditTest, TakesTheNamedOnesByBoxesAndOthersByALine) {
    choose(u" .");
    EXPECT_TRUE(told.empty());
    EXPECT_EQ(others().text(), QStringLiteral("."));
    click("Behind: Return");
    click("Behind: Enter");
    click("Behind: Space");
    type(";,;");
    type("tab U+000A U+00A0 ,");
    type("");
    const std::vector<std::string> expected{"Space Return .",   "Space Return Enter .",      "Return Enter .",
                                            "Return Enter , ;", "Tab Return Enter , U+00A0", "Tab Return Enter"};
    EXPECT_EQ(told, expected);
}

TEST_F(DelimitersEditTest, LeavesTheOrderOfWritingUntilTheLineIsLeft) {
    choose(u"");
    type("; ,");
    EXPECT_EQ(others().text(), QStringLiteral("; ,"));
    others().clearFocus();
    EXPECT_EQ(others().text(), QStringLiteral(", ;"));
    EXPECT_EQ(told, std::vector<std::string>{", ;"});
}

TEST_F(DelimitersEditTest, KeepsASetThatNobodyCanRead) {
    const CharacterSet letters = CharacterSet::letters();
    edit.setDelimiters(letters);
    EXPECT_TRUE(others().isReadOnly());
    click("Behind: Space");
    EXPECT_EQ(edit.delimiters(), letters.united(CharacterSet::withCharacters(u" ")));
    choose(u".");
    EXPECT_FALSE(others().isReadOnly());
}

// ---- Keyboard layouts ----

TEST(InputSourcesEdit, OffersThoseThatAreKnownAndKeepsThoseThatAreNot) {
    InputSourcesEdit edit;
    edit.setKnown({{u"us", QStringLiteral("English")}, {u"de", QString()}});
    edit.setSources(PLFunctionAvailability::ExceptListed, {u"gone", u"us"});
    std::vector<InputSourcesEdit::Identifiers> told;
    QObject::connect(&edit, &InputSourcesEdit::identifiersChanged, [&](const auto& now) { told.push_back(now); });
    edit.show();
    test::activate(edit);
    auto& view = find<QListView>(edit, QStringLiteral("Chosen keyboard layouts"));
    QStringList rows;
    for (int row = 0; row < view.model()->rowCount(); ++row) {
        const QModelIndex index = view.model()->index(row, 0);
        const bool isChecked = index.data(Qt::CheckStateRole) == Qt::Checked;
        rows.append(index.data().toString() + (isChecked ? QStringLiteral(" +") : QString()));
    }
    EXPECT_EQ(rows, (QStringList{"English +", "de", "gone +"}));

    QTest::keyClick(&view, Qt::Key_Space);
    QTest::keyClick(&view, Qt::Key_Down);
    QTest::keyClick(&view, Qt::Key_Space);
    auto& another = find<QLineEdit>(edit, QStringLiteral("Another layout"));
    another.setText(QStringLiteral("  fr "));
    test::click(edit, QStringLiteral("Add Layout"));
    another.setText(QStringLiteral("fr"));
    QTest::keyClick(&another, Qt::Key_Return);
    const std::vector<InputSourcesEdit::Identifiers> expected{{u"gone"}, {u"gone", u"de"}, {u"gone", u"de", u"fr"}};
    EXPECT_EQ(told, expected);
}

}  // namespace
}  // namespace plume
