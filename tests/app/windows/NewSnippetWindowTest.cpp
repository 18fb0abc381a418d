#include "app/windows/NewSnippetWindow.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <QComboBox>
#include <QLineEdit>
#include <QMessageBox>
#include <QPointer>
#include <QWheelEvent>

#include "app/qt/Text.h"
#include "tests/app/windows/WindowsSupport.h"
#include "tests/library/LibraryMachine.h"

namespace plume {
namespace {

using namespace test;
using ::testing::ElementsAre;
using ::testing::HasSubstr;

class NewSnippetWindowTest : public ::testing::Test {
  protected:
    void SetUp() override { machine.load(); }
    void TearDown() override { delete window; }
    void open(const std::u16string& content = u"") {
        window = new NewSnippetWindow(*machine.manager, content, machine.settings);
        bringToFront(*window);
        activate(*window);
    }
    QLineEdit& line(const char* name) { return find<QLineEdit>(*window, QString::fromUtf8(name)); }
    QComboBox& groups() { return find<QComboBox>(*window, QStringLiteral("Group:")); }
    QPlainTextEdit& text() { return find<QPlainTextEdit>(*window, QStringLiteral("Text:")); }

    SharedWorld world;
    Machine machine{world};
    QPointer<NewSnippetWindow> window;
};

TEST_F(NewSnippetWindowTest, AddsASnippetToTheChosenGroup) {
    machine.add(u"a");
    machine.manager->generateSnippetGroupSamples(u"Mail", {});
    open(u"Dear\u00A0all,\nhello");
    groups().setCurrentText(QStringLiteral("Mail"));
    EXPECT_EQ(window->focusWidget(), &line("Abbreviation:"));
    QTest::keyClicks(&line("Abbreviation:"), QStringLiteral("dear"));
    QTest::keyClicks(&line("Label:"), QStringLiteral("Greeting"));
    takePicture(*window, QStringLiteral("NewSnippet"));
    const auto version = machine.manager->library().versionUUIDString;
    QTest::keyClick(&text(), Qt::Key_Return, Qt::ControlModifier);
    EXPECT_THAT(machine.library(), ElementsAre("Mine: a=text", "Mail: dear=Dear\u00A0all,\nhello"));
    EXPECT_EQ(machine.manager->snippetGroups().at(1)->items().at(0)->label(), u"Greeting");
    EXPECT_NE(machine.manager->library().versionUUIDString, version);  // the change was told
    EXPECT_FALSE(window && window->isVisible());
}

TEST_F(NewSnippetWindowTest, IntoAnEmptyLibraryMakesAGroup) {
    open(u"text \U0001F600");
    EXPECT_EQ(line("Name of group:").text(), QStringLiteral("My Snippets"));
    EXPECT_THAT(textOf(*window), HasSubstr("Without an abbreviation"));
    takePicture(*window, QStringLiteral("NewSnippetInNewGroup"));
    line("Name of group:").setText(QStringLiteral("  "));
    click(*window, QStringLiteral("Add Snippet"));
    EXPECT_THAT(machine.library(), ElementsAre("My Snippets: =text \U0001F600"));
}

TEST_F(NewSnippetWindowTest, WarnsOfAnAbbreviationThatIsThere) {
    machine.add(u"sig");
    open();
    QTest::keyClicks(&line("Abbreviation:"), QStringLiteral("sig"));
    EXPECT_THAT(textOf(*window), HasSubstr("already. Both will be kept.\n"));
    groups().setCurrentText(QStringLiteral("New Group…"));
    EXPECT_THAT(textOf(*window), Not(HasSubstr("already")));
    QTest::keyClicks(&line("Abbreviation:"), QStringLiteral("n"));
    groups().setCurrentIndex(0);
    EXPECT_THAT(textOf(*window), Not(HasSubstr("already")));
    QTest::keyClick(&line("Abbreviation:"), Qt::Key_Backspace);
    click(*window, QStringLiteral("Add Snippet"));
    EXPECT_THAT(machine.library(), ElementsAre("Mine: sig=text sig="));
}

TEST_F(NewSnippetWindowTest, OutlivesTheGroupsThatItShows) {
    machine.add(u"a");
    open(u"text");
    auto others = machine.manager->snippetGroups();
    machine.manager->snippetGroups().clear();
    line("Abbreviation:").setText(QStringLiteral("b"));
    click(*window, QStringLiteral("Add Snippet"));
    EXPECT_THAT(machine.library(), ElementsAre("Mine: b=text"));
}

TEST_F(NewSnippetWindowTest, AsksBeforeWhatWasTypedIsLost) {
    open(u"draft\r\nwith\u00A0odd \u2028lines");
    window->close();
    EXPECT_FALSE(window->isVisible());
    processDeletions();
    open();
    QTest::keyClicks(&text(), QStringLiteral("typed"));
    QTest::keyClick(window, Qt::Key_Escape);
    ASSERT_TRUE(window->isVisible());
    click(*window->findChild<QMessageBox*>(), QStringLiteral("Cancel"));
    EXPECT_TRUE(window->isVisible());
    processDeletions();
    activate(*window);
    QTest::keyClick(window, Qt::Key_W, Qt::ControlModifier);
    ASSERT_TRUE(window->findChild<QMessageBox*>());
    click(*window->findChild<QMessageBox*>(), QStringLiteral("Throw Away"));
    EXPECT_FALSE(window && window->isVisible());
    EXPECT_THAT(machine.library(), ElementsAre());
}

TEST_F(NewSnippetWindowTest, TabLeavesTheTextAndTheWheelLeavesTheGroup) {
    machine.add(u"a");
    open(std::u16string(200'000, u'x'));
    text().setFocus();
    QTest::keyClick(&text(), Qt::Key_Tab);
    EXPECT_NE(window->focusWidget(), &text());
    const QPointF centre = groups().rect().center();
    QWheelEvent wheel(centre, groups().mapToGlobal(centre), {}, {0, -120}, Qt::NoButton, Qt::NoModifier,
                      Qt::NoScrollPhase, false);
    QCoreApplication::sendEvent(&groups(), &wheel);
    EXPECT_EQ(groups().currentIndex(), 0);
}

}  // namespace
}  // namespace plume
