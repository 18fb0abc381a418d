#include "app/editor/GroupEditor.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <QAccessible>
#include <QCheckBox>
#include <QComboBox>
#include <QDialog>
#include <QLineEdit>
#include <QListView>
#include <QPointer>

#include "app/qt/Text.h"
#include "tests/app/editing/EditedMachine.h"
#include "tests/app/windows/WindowsSupport.h"

namespace plume {
namespace {

using test::find;
using ::testing::HasSubstr;
using Identifiers = std::vector<std::u16string>;

CharacterSet these(const std::u16string& characters) {
    return CharacterSet::withCharacters(characters);
}

class GroupEditorTest : public testing::Test, protected test::EditedMachine {
  protected:
    GroupEditorTest() {
        // Every field is there.
        group->setExpandAfterDelimiters(these(u" "));
        group->setExpandTrigger(ExpandTrigger::DelimiterKept);
        group->setDelimiters(these(u"\t"));
        group->availability() = {.availability = PLFunctionAvailability::OnlyListed,
                                 .applications = Identifiers{u"kitty", u"gedit"},
                                 .inputMethodsOption = PLFunctionAvailability::ExceptListed,
                                 .inputMethods = Identifiers{u"us"}};
        form.resize(form.fontMetrics().height() * 40, form.fontMetrics().height() * 60);
        form.show();
        test::activate(form);
        form.show(group);
    }

    QComboBox& choice(const char* name) { return find<QComboBox>(form, QString::fromUtf8(name)); }
    QLineEdit& line(const char* name) { return find<QLineEdit>(form, QString::fromUtf8(name)); }
    void click(const char* name) { find<QAbstractButton>(form, QString::fromUtf8(name)).click(); }
    void type(const char* name, const char* text) {
        line(name).setFocus();
        line(name).selectAll();
        QTest::keyClicks(&line(name), QString::fromUtf8(text));
    }
    void press(const char* list, Qt::Key key) {
        auto& view = find<QListView>(form, QString::fromUtf8(list));
        view.setCurrentIndex(view.model()->index(0, 0));
        QTest::keyClick(&view, key);
    }
    void undo() {
        editor.undo(done.back());
        done.pop_back();
        form.refresh();
    }
    void answerSheet(int choice, const char* button) {
        click("Reset the letter case of all snippets");
        const QPointer<QDialog> sheet = form.findChild<QDialog*>();
        ASSERT_TRUE(sheet);
        find<QComboBox>(*sheet, QStringLiteral("Case sensitivity of all snippets")).setCurrentIndex(choice);
        test::click(*sheet, QString::fromUtf8(button));
        test::processDeletions();
        EXPECT_FALSE(sheet);
    }

    std::shared_ptr<SnippetGroup> group = addGroup(u"Mail", {u"sig=Regards", u"hi=Hello"}, u";");
    std::shared_ptr<SnippetGroup> other = addGroup(u"Other", {});
    GroupEditor form{{.editor = editor,
                      .applications = {.runningPrograms = {},
                                       .nextFrontProgram = {},
                                       .installedPrograms =
                                           [] {
                                               return std::vector<InstalledProgram>{{u"kitty", u"Kitty", ""}};
                                           }},
                      .inputSources = [] {
                          return std::vector<std::pair<std::u16string, QString>>{{u"us", QStringLiteral("English")},
                                                                                 {u"de", QStringLiteral("German")}};
                      }}};
};

TEST_F(GroupEditorTest, EveryControlChangesItsSettingAndNothingElse) {
    using G = SnippetGroup;
    struct Row {
        std::function<void()> act;
        std::function<void(G&)> expected;
    };
    const std::vector<Row> rows{
        {[&] { type("Name", "Post"); }, [](G& g) { g.setName(u"Post"); }},
        {[&] { type("Prefix", "//"); }, [](G& g) { g.setAbbreviationPrefix(u"//"); }},
        {[&] { choice("Expands behind").setCurrentIndex(1); }, [](G& g) { g.setExpandAfter(ExpandAfter::Whitespace); }},
        {[&] { choice("Expands behind").setCurrentIndex(2); }, [](G& g) { g.setExpandAfter(ExpandAfter::Anything); }},
        {[&] { choice("Expands behind").setCurrentIndex(3); }, [](G& g) { g.setExpandAfter(ExpandAfter::Digits); }},
        {[&] { click("Delimiters before it: The usual ones"); }, [](G& g) { g.setExpandAfterDelimiters({}); }},
        {[&] { type("Delimiters before it: Others", "("); }, [](G& g) { g.setExpandAfterDelimiters(these(u" (")); }},
        {[&] { choice("Expands").setCurrentIndex(0); }, [](G& g) { g.setExpandTrigger(ExpandTrigger::Immediately); }},
        {[&] { choice("Expands").setCurrentIndex(2); },
         [](G& g) { g.setExpandTrigger(ExpandTrigger::DelimiterSwallowed); }},
        {[&] { choice("Expands").setCurrentIndex(3); }, [](G& g) { g.setExpandTrigger(ExpandTrigger::Never); }},
        {[&] { choice("Expands").setCurrentIndex(4); }, [](G& g) { g.setExpandTrigger(ExpandTrigger::HotKey); }},
        {[&] { click("Delimiters behind it: The usual ones"); }, [](G& g) { g.setDelimiters({}); }},
        {[&] { click("Delimiters behind it: Return"); }, [](G& g) { g.setDelimiters(these(u"\t\r")); }},
        {[&] { click("Offer as suggestions"); }, [](G& g) { g.setSuggestAbbreviations(false); }},
        {[&] { click("List in the menu"); }, [](G& g) { g.setShowInMenuBar(false); }},
        {[&] { click("Reset the formatting behind a formatted text"); }, [](G& g) { g.setResetFormatting(true); }},
        {[&] { choice("Letter case of new snippets").setCurrentIndex(2); },
         [](G& g) { g.setCaseSensitivity(CaseSensitivity::IgnoreCaseAndAdapt); }},
        {[&] { choice("Programs").setCurrentIndex(0); }, [](G& g) { g.availability().availability = 0; }},
        {[&] { choice("Programs").setCurrentIndex(1); }, [](G& g) { g.availability().availability = 1; }},
        {[&] { press("Enabled", Qt::Key_Delete); },
         [](G& g) { g.availability().applications = Identifiers{u"gedit"}; }},
        {[&] { choice("Keyboard layouts").setCurrentIndex(0); }, [](G& g) { g.availability().inputMethodsOption = 0; }},
        {[&] { choice("Keyboard layouts").setCurrentIndex(2); }, [](G& g) { g.availability().inputMethodsOption = 2; }},
        {[&] { press("Chosen keyboard layouts", Qt::Key_Space); },
         [](G& g) { g.availability().inputMethods = Identifiers{}; }},
    };
    const std::string first = bytes();
    for (std::size_t i = 0; i < rows.size(); ++i) {
        const auto expected = group->snapshot();
        rows[i].expected(*expected);
        rows[i].act();
        form.finish();
        ASSERT_EQ(done.size(), 1U) << "row " << i;
        EXPECT_TRUE(group->hasSameSettings(*expected)) << "row " << i;
        EXPECT_FALSE(group->hasSameSettings(*done.front().groups.front().before)) << "row " << i;
        undo();
        EXPECT_EQ(bytes(), first) << "row " << i;
        form.finish();
        EXPECT_TRUE(done.empty()) << "row " << i;
    }
}

TEST_F(GroupEditorTest, ShowsWhatWasChangedElsewhereAndTellsNothing) {
    group->setName(u"Renamed");
    group->setExpandAfter(ExpandAfter::Digits);
    group->setExpandTrigger(ExpandTrigger::HotKey);
    group->setShowInMenuBar(false);
    group->availability() = {};
    const std::string now = bytes();
    form.refresh();
    EXPECT_EQ(line("Name").text(), QStringLiteral("Renamed"));
    EXPECT_EQ(choice("Expands behind").currentIndex(), 3);
    EXPECT_EQ(choice("Expands").currentIndex(), 4);
    EXPECT_FALSE(find<QCheckBox>(form, QStringLiteral("List in the menu")).isChecked());
    EXPECT_EQ(choice("Programs").currentIndex(), 0);
    EXPECT_THAT(test::textOf(form), HasSubstr("Type ;sig right behind a number, then press the hot key that expands."));
    form.show(other);
    EXPECT_EQ(line("Name").text(), QStringLiteral("Other"));
    EXPECT_TRUE(find<QCheckBox>(form, QStringLiteral("List in the menu")).isChecked());
    form.show(nullptr);
    EXPECT_EQ(line("Name").text(), QString());
    EXPECT_FALSE(line("Name").isEnabled());
    EXPECT_EQ(bytes(), now);
    EXPECT_TRUE(done.empty());
}

TEST_F(GroupEditorTest, TheSentenceFollowsEveryChange) {
    const auto sentence = [this] { return test::textOf(form); };
    EXPECT_THAT(sentence(), HasSubstr("In Kitty and gedit only: type ;sig behind a space, then Tab. "
                                      "Not with the keyboard layout English."));
    choice("Expands").setCurrentIndex(0);
    EXPECT_THAT(sentence(), HasSubstr("only: type ;sig behind a space, and it expands at once."));
    type("Prefix", "//");
    QTest::keyClick(&line("Prefix"), Qt::Key_Return);
    EXPECT_THAT(sentence(), HasSubstr("type //sig behind"));
    choice("Keyboard layouts").setCurrentIndex(0);
    EXPECT_THAT(sentence(), Not(HasSubstr("keyboard layout English")));
}

TEST_F(GroupEditorTest, KeepsWhatIsTypedWhenTheLineIsLeftOnReturnAndAfterAPause) {
    type("Name", "A");
    EXPECT_TRUE(done.empty());
    QTest::keyClick(&line("Name"), Qt::Key_Return);
    EXPECT_EQ(group->name(), u"A");
    type("Name", "B");
    QTest::keyClick(&line("Name"), Qt::Key_Tab);
    EXPECT_EQ(group->name(), u"B");
    type("Name", "C");
    EXPECT_TRUE(QTest::qWaitFor([this] { return group->name() == u"C"; }));
    type("Name", "D");
    form.show(other);
    EXPECT_EQ(group->name(), u"D");
    EXPECT_EQ(other->name(), u"Other");
    EXPECT_EQ(done.size(), 4U);
}

TEST_F(GroupEditorTest, ARefreshLeavesWhatIsBeingTypedUnlessThatVeryFieldWasChanged) {
    type("Name", "Typed");
    group->setShowInMenuBar(false);
    form.refresh();
    EXPECT_EQ(line("Name").text(), QStringLiteral("Typed"));
    group->setName(u"Newer");
    form.refresh();
    EXPECT_EQ(line("Name").text(), QStringLiteral("Newer"));
    form.finish();
    EXPECT_TRUE(done.empty());
}

TEST_F(GroupEditorTest, ChangesNothingOfAGroupThatIsGone) {
    type("Name", "Typed");
    auto& groups = machine.manager->snippetGroups();
    groups.erase(groups.begin());
    form.show(other);
    EXPECT_EQ(group->name(), u"Mail");
    EXPECT_EQ(line("Name").text(), QStringLiteral("Other"));
    EXPECT_TRUE(done.empty());
}

TEST_F(GroupEditorTest, KeepsValuesThatItDoesNotKnow) {
    group->setExpandAfter(ExpandAfter{7});
    group->setExpandTrigger(ExpandTrigger{9});
    group->setCaseSensitivity(CaseSensitivity{-2});
    group->availability().availability = 5;
    group->availability().inputMethodsOption = 6;
    group->setName(u"two\nlines");
    const std::string first = bytes();
    form.refresh();
    form.finish();
    EXPECT_EQ(choice("Expands behind").currentText(), QStringLiteral("Other (7)"));
    EXPECT_EQ(choice("Expands").currentText(), QStringLiteral("Other (9)"));
    EXPECT_EQ(choice("Letter case of new snippets").currentText(), QStringLiteral("Other (-2)"));
    EXPECT_EQ(choice("Programs").currentText(), QStringLiteral("Other (5)"));
    EXPECT_EQ(choice("Keyboard layouts").currentText(), QStringLiteral("Other (6)"));
    choice("Expands").setCurrentIndex(5);
    EXPECT_TRUE(done.empty());
    EXPECT_EQ(bytes(), first);
    choice("Expands").setCurrentIndex(1);
    EXPECT_EQ(choice("Expands").count(), 5);
    undo();
    EXPECT_EQ(choice("Expands").currentText(), QStringLiteral("Other (9)"));
    EXPECT_EQ(bytes(), first);
}

TEST_F(GroupEditorTest, ResetsTheCaseOfAllSnippetsSoThatItCanBeUndone) {
    const std::string first = bytes();
    answerSheet(1, "Cancel");
    EXPECT_TRUE(done.empty());
    answerSheet(1, "Reset");
    for (const auto& snippet : group->items()) EXPECT_EQ(snippet->caseSensitivity(), CaseSensitivity::IgnoreCase);
    EXPECT_EQ(group->caseSensitivity(), CaseSensitivity::CaseSensitive);
    ASSERT_EQ(done.size(), 1U);
    undo();
    EXPECT_EQ(bytes(), first);
    form.show(other);
    EXPECT_FALSE(find<QAbstractButton>(form, QStringLiteral("Reset the letter case of all snippets")).isEnabled());
}

TEST_F(GroupEditorTest, WhateverTakesTheKeyboardHasAName) {
    for (QWidget* each : form.findChildren<QWidget*>()) {
        if (each->focusPolicy() == Qt::NoFocus || !each->isVisible() || each->focusProxy()) continue;
        const QAccessibleInterface* told = QAccessible::queryAccessibleInterface(each);
        EXPECT_FALSE(told->text(QAccessible::Name).isEmpty()) << each->metaObject()->className();
    }
}

TEST_F(GroupEditorTest, Pictures) {
    test::takePicture(form, QStringLiteral("GroupEditor"));
    click("Reset the letter case of all snippets");
    const QPointer<QDialog> sheet = form.findChild<QDialog*>();
    test::takePicture(*sheet, QStringLiteral("CaseReset"));
    sheet->close();
    form.show(other);
    test::takePicture(form, QStringLiteral("GroupEditorPlain"));
}

}  // namespace
}  // namespace plume
