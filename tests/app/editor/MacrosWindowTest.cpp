#include "app/editor/MacrosWindowController.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <QAction>
#include <QClipboard>
#include <QLineEdit>
#include <QMenuBar>
#include <QMessageBox>
#include <QMimeData>
#include <QPointer>
#include <QTreeView>
#include <QUndoStack>

#include "app/editor/ContentEdit.h"
#include "app/editor/OutlineModel.h"
#include "app/editor/OutlineView.h"
#include "app/qt/Text.h"
#include "tests/app/windows/WindowsSupport.h"
#include "tests/library/LibraryMachine.h"
#include "tests/support/Language.h"

namespace plume {
namespace {

using namespace test;
using ::testing::ElementsAre;
using ::testing::HasSubstr;
using ::testing::IsEmpty;

class MacrosWindowTest : public ::testing::Test {
  protected:
    void SetUp() override {
        machine.load();
        machine.manager->snippetGroups().clear();
    }
    void TearDown() override { delete window; }
    std::shared_ptr<SnippetGroup> addGroup(const std::u16string& name, const std::vector<std::u16string>& snippets) {
        return machine.manager->generateSnippetGroupSamples(name, snippets);
    }
    void open() {
        ChipFormServices placeholders;
        placeholders.readClipboard = [](const auto& told) { told(u"from the clipboard"); };
        ScriptRunServices scripts{
            .loop = world.loop, .groups = {}, .readClipboard = {}, .inBackground = {}, .makeRunner = {}};
        window = new MacrosWindowController({.dataManager = *machine.manager,
                                             .settings = machine.settings,
                                             .files = world.files,
                                             .resources = "/resources",
                                             .placeholders = std::move(placeholders),
                                             .scripts = std::move(scripts),
                                             .programs = {},
                                             .inputSources = {},
                                             .askForFile = {},
                                             .inBackground = {},
                                             .setExpandsInOwnWindows = [this](bool expands) { expandsHere = expands; },
                                             .showPreferences = [] {},
                                             .quit = [] {}});
        window->show();
        activate(*window);
    }
    OutlineView& list() { return *window->findChild<OutlineView*>(); }
    OutlineModel& rows() { return static_cast<OutlineModel&>(*list().model()); }
    QLineEdit& line(const char* name) { return find<QLineEdit>(*window, QString::fromUtf8(name)); }
    ContentEdit& content() { return *window->findChild<ContentEdit*>(); }
    QLineEdit& filter() { return line("Search in the snippets"); }
    // By the beginning of its text, mnemonics left out.
    QAction& command(const char* text) {
        for (QAction* action : window->findChildren<QAction*>()) {
            if (withoutMnemonic(action->text()).startsWith(QString::fromUtf8(text))) return *action;
        }
        throw std::runtime_error(std::string("no command is called ") + text);
    }
    void choose(const char* text) {
        if (!command(text).isEnabled()) throw std::runtime_error(std::string("cannot be chosen: ") + text);
        command(text).trigger();
        QCoreApplication::processEvents();
    }
    std::vector<std::string> shownRows() {
        std::vector<std::string> shown;
        for (QModelIndex row = rows().index(0, 0); row.isValid(); row = list().indexBelow(row)) {
            shown.push_back((row.parent().isValid() ? "  " : "") + row.data().toString().toStdString());
        }
        return shown;
    }
    void type(QWidget& field, const char* text) { QTest::keyClicks(&field, QString::fromUtf8(text)); }

    SharedWorld world;
    Machine::Disk disk = std::make_shared<SimulatedLibraryStorage::Disk>();
    Machine machine{world, "one", disk};
    QPointer<MacrosWindowController> window;
    bool expandsHere = false;
};

TEST_F(MacrosWindowTest, WritesASnippetFromNothing) {
    open();
    EXPECT_THAT(textOf(*window), HasSubstr("There are no snippets yet."));
    takePicture(*window, QStringLiteral("EditorEmpty"));
    choose("New Snippet");
    EXPECT_EQ(window->focusWidget(), &line("Abbreviation:"));
    type(line("Abbreviation:"), "hi");
    type(line("Label:"), "Greeting");
    type(content(), "Hello\u00A0you");
    const auto version = machine.manager->library().versionUUIDString;
    EXPECT_TRUE(QTest::qWaitFor(
        [&] { return machine.library() == std::vector<std::string>{"My Snippets: hi=Hello\u00A0you"}; }, 2000));
    EXPECT_NE(machine.manager->library().versionUUIDString, version);
    EXPECT_EQ(machine.manager->snippetGroups().front()->items().front()->label(), u"Greeting");
    takePicture(*window, QStringLiteral("EditorSnippet"));
    while (command("Undo").text() != QStringLiteral("&Undo")) choose("Undo");
    EXPECT_THAT(machine.library(), IsEmpty());
}

TEST_F(MacrosWindowTest, WhatIsTypedIsThereBeforeAnythingElseIsDone) {
    const auto group = addGroup(u"Mail", {u"a", u"1", u"b", u"2"});
    open();
    window->edit(group->items()[0]);
    type(content(), "x");
    window->edit(group->items()[1]);
    EXPECT_THAT(machine.library(), ElementsAre("Mail: a=x1 b=2"));
    EXPECT_EQ(content().toPlainText(), QStringLiteral("2"));
    type(content(), "y");
    choose("Undo");
    EXPECT_THAT(machine.library(), ElementsAre("Mail: a=x1 b=2")) << "the letter was the last edit";
    choose("Undo");
    EXPECT_THAT(machine.library(), ElementsAre("Mail: a=1 b=2"));
    EXPECT_EQ(line("Abbreviation:").text(), QStringLiteral("a")) << "what was undone is shown";
    choose("Redo");
    EXPECT_THAT(machine.library(), ElementsAre("Mail: a=x1 b=2"));
    type(content(), "z");
    window->close();
    EXPECT_THAT(machine.library(), ElementsAre("Mail: a=zx1 b=2"));
}

TEST_F(MacrosWindowTest, TellsWhoHasAnAbbreviationWhileItIsTyped) {
    const auto mail = addGroup(u"Mail", {u"sig", u"Yours"});
    addGroup(u"Work", {u"x", u"1"});
    open();
    window->edit(machine.manager->snippetGroups()[1]->items()[0]);
    line("Abbreviation:").clear();
    EXPECT_THAT(textOf(*window), HasSubstr("Without an abbreviation"));
    type(line("Abbreviation:"), "sig");
    EXPECT_THAT(textOf(*window), HasSubstr("“Yours” in “Mail” has this abbreviation"));
    takePicture(*window, QStringLiteral("EditorConflict"));
    type(line("Abbreviation:"), "2");
    EXPECT_THAT(textOf(*window), HasSubstr("“sig” in “Mail” expands before"));
    window->commitEdits();
    EXPECT_THAT(shownRows(), ElementsAre("Mail", "Work", "  sig2"));
}

TEST_F(MacrosWindowTest, FiltersAndComesBack) {
    const auto mail = addGroup(u"Mail", {u"sig", u"Yours", u"ad", u"Street"});
    addGroup(u"Work", {u"y", u"Your turn"});
    open();
    window->edit(mail->items()[1]);
    type(filter(), "your");
    EXPECT_THAT(shownRows(), ElementsAre("Mail", "  sig", "Work", "  y"));
    EXPECT_THAT(textOf(*window), HasSubstr("2 snippets"));
    EXPECT_TRUE(list().selection().isEmpty()) << "what was selected is not shown";
    takePicture(*window, QStringLiteral("EditorFilter"));
    QTest::keyClick(&filter(), Qt::Key_Down);
    EXPECT_TRUE(list().hasFocus());
    EXPECT_EQ(content().toPlainText(), QStringLiteral("Yours"));
    EXPECT_THAT(textOf(*window), HasSubstr("1 of 2 snippets selected"));
    filter().setText(QStringLiteral("no such text"));
    EXPECT_THAT(textOf(*window), HasSubstr("Nothing was found."));
    takePicture(*window, QStringLiteral("EditorNothingFound"));
    QTest::keyClick(&filter(), Qt::Key_Escape);
    EXPECT_THAT(shownRows(), ElementsAre("Mail", "  sig", "  ad", "Work"));
    choose("Abbreviation");
    filter().setText(QStringLiteral("sig"));
    EXPECT_THAT(shownRows(), IsEmpty()) << "abbreviations are not searched";
    choose("Abbreviation");
    choose("Wildcards");
    filter().setText(QStringLiteral("s?g"));
    EXPECT_THAT(shownRows(), ElementsAre("Mail", "  sig"));
    window->edit(mail->items()[1]);
    EXPECT_TRUE(filter().text().isEmpty()) << "what is to be edited is shown";
    EXPECT_EQ(content().toPlainText(), QStringLiteral("Street"));
}

TEST_F(MacrosWindowTest, MovesCopiesAndDeletesRows) {
    const auto mail = addGroup(u"Mail", {u"a", u"1", u"b", u"2", u"c", u"3"});
    const auto work = addGroup(u"Work", {u"d", u"4"});
    open();
    list().setFocus();
    list().select({{}, {mail->items()[0], mail->items()[2]}});
    choose("Delete");
    EXPECT_THAT(machine.library(), ElementsAre("Mail: b=2", "Work: d=4"));
    choose("Undo");
    EXPECT_THAT(machine.library(), ElementsAre("Mail: a=1 b=2 c=3", "Work: d=4"));
    EXPECT_EQ(list().selection().snippets.size(), 2U) << "what came back is selected";

    const auto cut = mail->items()[1];
    list().select({{}, {cut}});
    choose("Cut");
    list().select({{}, {work->items()[0]}});
    choose("Paste");
    EXPECT_THAT(machine.library(), ElementsAre("Mail: a=1 c=3", "Work: d=4 b=2"));
    EXPECT_EQ(work->items()[1]->uuid(), cut->uuid());
    choose("Paste");
    EXPECT_THAT(machine.library(), ElementsAre("Mail: a=1 c=3", "Work: d=4 b=2 b=2"));
    EXPECT_NE(work->items()[2]->uuid(), cut->uuid());

    // Dragged: moved, and with Control copied.
    list().select({{}, {mail->items()[0]}});
    const auto dragged = [&] {
        return std::unique_ptr<QMimeData>(rows().mimeData(list().selectionModel()->selectedRows()));
    };
    rows().dropMimeData(dragged().get(), Qt::MoveAction, 1, 0, rows().indexOf(*work));
    EXPECT_THAT(machine.library(), ElementsAre("Mail: c=3", "Work: d=4 a=1 b=2 b=2"));
    rows().dropMimeData(dragged().get(), Qt::CopyAction, 0, 0, rows().indexOf(*mail));
    EXPECT_THAT(machine.library(), ElementsAre("Mail: a=1 c=3", "Work: d=4 a=1 b=2 b=2"));
    list().select({{work}, {}});
    rows().dropMimeData(dragged().get(), Qt::MoveAction, 0, 0, {});
    EXPECT_THAT(machine.library(), ElementsAre("Work: d=4 a=1 b=2 b=2", "Mail: a=1 c=3"));
    while (command("Undo").text() != QStringLiteral("&Undo")) choose("Undo");
    EXPECT_THAT(machine.library(), ElementsAre("Mail: a=1 b=2 c=3", "Work: d=4"));
}

TEST_F(MacrosWindowTest, RowsOfASpreadsheetBecomeSnippets) {
    const auto mail = addGroup(u"Mail", {u"a", u"1"});
    open();
    list().setFocus();
    list().select({{mail}, {}});
    QApplication::clipboard()->setText(QStringLiteral("x\tfirst\ny\t\"two\nlines\"\tLabel"));
    choose("Paste");
    EXPECT_THAT(machine.library(), ElementsAre("Mail: a=1 x=first y=two\nlines"));
    choose("Copy");
    EXPECT_EQ(QApplication::clipboard()->text(), QStringLiteral("x\tfirst\ny\t\"two\nlines\"\tLabel\n"));
    // In a field the same commands are the field's.
    window->edit(mail->items()[0]);
    content().setFocus();
    choose("Select All");
    choose("Cut");
    window->commitEdits();
    EXPECT_EQ(mail->items()[0]->plainTextContent(), u"");
    EXPECT_EQ(QApplication::clipboard()->text(), QStringLiteral("1"));
}

TEST_F(MacrosWindowTest, RenamesInTheList) {
    const auto mail = addGroup(u"Mail", {u"a", u"1"});
    open();
    window->edit(mail->items()[0]);
    list().setFocus();
    choose("Rename");
    auto* field = list().findChild<QLineEdit*>();
    ASSERT_TRUE(field);
    field->setText(QStringLiteral("new"));
    QTest::keyClick(field, Qt::Key_Return);
    QCoreApplication::processEvents();
    EXPECT_THAT(machine.library(), ElementsAre("Mail: new=1"));
    EXPECT_EQ(line("Abbreviation:").text(), QStringLiteral("new"));
    choose("New Group");
    field = list().findChild<QLineEdit*>();
    ASSERT_TRUE(field) << "a new group asks for its name";
    type(*field, "Work");
    QTest::keyClick(field, Qt::Key_Return);
    QCoreApplication::processEvents();
    EXPECT_THAT(machine.library(), ElementsAre("Mail: new=1", "Work:"));
    choose("New Snippet from Clipboard");
    EXPECT_THAT(machine.library(), ElementsAre("Mail: new=1", "Work: =from the clipboard"));
}

TEST_F(MacrosWindowTest, SortsAndDeletesDuplicates) {
    addGroup(u"Work", {u"b", u"1", u"a", u"2", u"b", u"1"});
    addGroup(u"Mail", {});
    open();
    choose("By Abbreviation");
    EXPECT_THAT(machine.library(), ElementsAre("Work: a=2 b=1 b=1", "Mail:"));
    choose("By Abbreviation");
    EXPECT_THAT(machine.library(), ElementsAre("Work: b=1 b=1 a=2", "Mail:"));
    choose("Sort Groups");
    EXPECT_THAT(machine.library(), ElementsAre("Mail:", "Work: b=1 b=1 a=2"));
    choose("Delete Duplicated");
    auto* question = window->findChild<QMessageBox*>();
    ASSERT_TRUE(question);
    EXPECT_EQ(question->text(), QStringLiteral("Are you sure you want to delete all (1) duplicated snippets?"));
    click(*question, QStringLiteral("Delete"));
    EXPECT_THAT(machine.library(), ElementsAre("Mail:", "Work: b=1 a=2"));
    choose("Undo");
    EXPECT_THAT(machine.library(), ElementsAre("Mail:", "Work: b=1 b=1 a=2"));
}

TEST_F(MacrosWindowTest, KeepsWhatIsEditedWhenAnotherLibraryComes) {
    const auto mail = addGroup(u"Mail", {u"a", u"1", u"b", u"2"});
    machine.manager->notifyDataChanged();
    ASSERT_TRUE(machine.manager->saveData());
    Machine other(world, "two", disk);
    other.load();
    open();
    window->edit(mail->items()[0]);
    type(content(), "typed ");
    other.manager->snippetGroups().front()->items()[0]->setLabel(u"theirs");
    other.manager->snippetGroups().front()->items()[1]->setPlainTextContent(u"theirs");
    other.manager->notifyDataChanged();
    world.loop.advance(1);
    EXPECT_THAT(machine.library(), ElementsAre("Mail: a=typed 1 b=theirs"));
    EXPECT_EQ(machine.manager->snippetGroups().front()->items()[0]->label(), u"theirs");
    EXPECT_THAT(textOf(*window), HasSubstr("What you were just editing was kept."));
    EXPECT_EQ(content().toPlainText(), QStringLiteral("typed 1"));
    takePicture(*window, QStringLiteral("EditorKeptEdit"));
    type(content(), "more ");
    window->commitEdits();
    EXPECT_THAT(machine.library(), ElementsAre("Mail: a=typed more 1 b=theirs"));

    // The other one deletes it meanwhile.
    world.loop.advance(1);
    type(content(), "and ");
    other.manager->snippetGroups().front()->removeItem(other.manager->snippetGroups().front()->items()[0]);
    other.manager->notifyDataChanged();
    world.loop.advance(1);
    EXPECT_THAT(machine.library(), ElementsAre("Mail: a=typed more and 1 b=theirs"));
}

TEST_F(MacrosWindowTest, GoesOnWithTheSameSnippetInALibraryOfOthers) {
    const auto mail = addGroup(u"Mail", {u"a", u"1", u"b", u"2"});
    machine.manager->notifyDataChanged();
    ASSERT_TRUE(machine.manager->saveData());
    Machine other(world, "two", disk);
    other.load();
    open();
    window->edit(mail->items()[1]);
    other.manager->snippetGroups().front()->items()[1]->setPlainTextContent(u"theirs");
    other.manager->notifyDataChanged();
    world.loop.advance(1);
    EXPECT_EQ(content().toPlainText(), QStringLiteral("theirs"));
    EXPECT_THAT(textOf(*window), HasSubstr("were changed elsewhere and are shown as they are now"));
    type(content(), "x");
    window->commitEdits();
    EXPECT_THAT(machine.library(), ElementsAre("Mail: a=1 b=xtheirs"));

    // What only adds groups leaves everything as it is.
    ASSERT_TRUE(
        world.files.write("/more.json", R"([{"name": "More", "items": [{"abbreviation": "m", "content": "3"}]}])"));
    ASSERT_TRUE(machine.manager->importDataFromFile("/more.json"));
    machine.manager->notifyDataChanged();
    EXPECT_TRUE(QTest::qWaitFor([&] { return shownRows().back() == "More"; }, 2000));
    choose("Undo");
    EXPECT_THAT(machine.library(), ElementsAre("Mail: a=1 b=theirs", "More: m=3"));
}

TEST_F(MacrosWindowTest, DoesNotUndoWhatOthersHaveMadeImpossible) {
    const auto mail = addGroup(u"Mail", {u"a", u"1", u"b", u"2"});
    open();
    list().setFocus();
    list().select({{}, {mail->items()[1]}});
    choose("Delete");
    mail->replaceItems({});
    machine.manager->notifyDataChanged();
    choose("Undo");
    EXPECT_THAT(machine.library(), ElementsAre("Mail:"));
    EXPECT_THAT(textOf(*window), HasSubstr("can no longer be undone"));
    EXPECT_TRUE(QTest::qWaitFor([&] { return shownRows() == std::vector<std::string>{"Mail"}; }, 2000));
}

TEST_F(MacrosWindowTest, GroupsStayOpenAndTheirSettingsAreShown) {
    const auto mail = addGroup(u"Mail", {u"a", u"1"});
    addGroup(u"Work", {u"b", u"2"});
    open();
    EXPECT_THAT(shownRows(), ElementsAre("Mail", "Work"));
    list().select({{mail}, {}});
    takePicture(*window, QStringLiteral("EditorGroup"));
    QTest::keyClick(&line("Name:"), Qt::Key_End);
    type(line("Name:"), " and more");
    list().expand(rows().indexOf(*mail));
    window->close();
    processDeletions();
    EXPECT_EQ(mail->name(), u"Mail and more");
    open();
    EXPECT_THAT(shownRows(), ElementsAre("Mail and more", "  a", "Work"));
}

// No letter stands twice in a menu, nor for the menus and what the page shows.
TEST_F(MacrosWindowTest, ItSpeaksOtherLanguages) {
    const auto mail = addGroup(u"Mail", {u"a", u"1"});
    mail->items()[0]->setContentType(ContentType::RichText);
    for (const QString language : {"en", "de", "fr"}) {
        SCOPED_TRACE(language.toStdString());
        const SpokenLanguage spoken(language);
        open();
        window->edit(mail->items()[0]);
        takePicture(*window, QStringLiteral("Editor-") + language);
        Mnemonics all;
        all.addAll(*window);
        for (const QAction* menu : window->menuBar()->actions()) all.add(menu->text());
        for (const auto* menu : window->findChildren<QMenu*>()) {
            if (menu->menuAction()->text().isEmpty()) continue;
            SCOPED_TRACE(menu->title().toStdString());
            Mnemonics ofMenu;
            for (const QAction* action : menu->actions()) ofMenu.add(action->text());
        }
        EXPECT_LE(window->minimumSizeHint().width(), 1024);
        delete window;
    }
}

TEST_F(MacrosWindowTest, ExpandsInItsFieldForTrialsAlone) {
    const auto mail = addGroup(u"Mail", {u"a", u"1"});
    open();
    window->edit(mail->items()[0]);
    auto& trial = find<QPlainTextEdit>(*window, QStringLiteral("Field to try abbreviations in"));
    trial.setFocus();
    EXPECT_TRUE(expandsHere);
    line("Abbreviation:").setFocus();
    EXPECT_FALSE(expandsHere);
    trial.setFocus();
    delete window;
    EXPECT_FALSE(expandsHere);
}

}  // namespace
}  // namespace plume
