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
    void open(const std::u16string& text = u"") { open(SnippetDraft{.content = text}); }
    void edit(const std::shared_ptr<Snippet>& snippet) { open(SnippetDraft{.content = {}, .edited = snippet}); }
    void open(const SnippetDraft& draft) {
        window = new NewSnippetWindow(*machine.manager, draft, machine.settings);
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

TEST_F(NewSnippetWindowTest, ChangesASnippetThatIsThere) {
    const auto first = machine.add(u"first", u"text\u00A0one\u2028x");
    machine.add(u"other", u"text");
    first->setLabel(u"Label");
    edit(first);
    EXPECT_EQ(window->windowTitle(), QStringLiteral("Edit Snippet"));
    EXPECT_EQ(line("Label:").text(), QStringLiteral("Label"));
    EXPECT_FALSE(groups().isEnabled());
    EXPECT_THAT(textOf(*window), Not(HasSubstr("already"))) << "the abbreviation is its own";
    takePicture(*window, QStringLiteral("EditSnippet"));
    window->close();
    processDeletions();
    EXPECT_FALSE(window) << "nothing was changed: nothing is asked";
    EXPECT_EQ(first->plainTextContent(), u"text\u00A0one\u2028x");

    edit(first);
    line("Abbreviation:").setText(QStringLiteral("other"));
    EXPECT_THAT(textOf(*window), HasSubstr("already"));
    line("Abbreviation:").setText(QStringLiteral("new"));
    line("Label:").clear();
    click(*window, QStringLiteral("Save Changes"));
    EXPECT_THAT(machine.library(), ElementsAre("Mine: new=text\u00A0one\u2028x other=text"));
    EXPECT_EQ(first->label(), u"");

    processDeletions();
    edit(first);
    text().setPlainText(QStringLiteral("changed"));
    QTest::keyClick(window, Qt::Key_Escape);
    ASSERT_TRUE(window->isVisible());
    click(*window->findChild<QMessageBox*>(), QStringLiteral("Throw Away"));
    EXPECT_EQ(first->plainTextContent(), u"text\u00A0one\u2028x");
}

TEST_F(NewSnippetWindowTest, LeavesFormattedTextAndScriptsWhatTheyAre) {
    TextAttributes bold;
    bold.font = FontAttribute{u"Sans", 12, true, false};
    const AttributedString formatted(u"bold", std::make_shared<const TextAttributes>(bold));
    const auto rich = machine.add(u"rich");
    rich->setRichTextContent(formatted);
    rich->setContentType(ContentType::RichText);
    edit(rich);
    EXPECT_TRUE(text().isReadOnly());
    line("Label:").setText(QStringLiteral("Named"));
    click(*window, QStringLiteral("Save Changes"));
    EXPECT_EQ(rich->richTextContent(), formatted);
    EXPECT_EQ(rich->label(), u"Named");
    processDeletions();

    const auto script = machine.add(u"run", u"date");
    script->setContentType(ContentType::ShellScript);
    edit(script);
    text().setPlainText(QStringLiteral("date --iso"));
    click(*window, QStringLiteral("Save Changes"));
    EXPECT_EQ(script->contentType(), ContentType::ShellScript);
    EXPECT_EQ(script->plainTextContent(), u"date --iso");
}

TEST_F(NewSnippetWindowTest, ChangesWhatADownloadHasPutIntoItsPlace) {
    const auto shown = machine.add(u"sig", u"text");
    edit(shown);
    auto& group = *machine.manager->snippetGroups().front();
    const auto newer = std::make_shared<Snippet>(*shown->uuid());
    newer->setAbbreviation(u"sig");
    newer->setPlainTextContent(u"text of another machine");
    group.removeItem(shown);
    group.addItem(newer);
    line("Label:").setText(QStringLiteral("Mine"));
    line("Abbreviation:").setText(QStringLiteral("s"));
    line("Abbreviation:").setText(QStringLiteral("sig"));
    EXPECT_THAT(textOf(*window), Not(HasSubstr("already")));
    click(*window, QStringLiteral("Save Changes"));
    EXPECT_THAT(machine.library(), ElementsAre("Mine: sig=text of another machine"));
    EXPECT_EQ(newer->label(), u"Mine");

    processDeletions();
    edit(newer);
    machine.manager->snippetGroups().clear();
    text().setPlainText(QStringLiteral("kept"));
    click(*window, QStringLiteral("Save Changes"));
    EXPECT_THAT(machine.library(), ElementsAre("Mine: sig=kept")) << "it comes back with its changes";
}

}  // namespace
}  // namespace plume
