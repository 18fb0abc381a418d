#include "app/windows/RestoreWindow.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <QFileDialog>
#include <QLineEdit>
#include <QListView>
#include <QMessageBox>
#include <QPointer>
#include <QPushButton>

#include "tests/app/windows/WindowsSupport.h"
#include "tests/library/LibraryMachine.h"
#include "tests/support/TemporaryFolder.h"

namespace plume {
namespace {

using namespace test;
using ::testing::ElementsAre;
using ::testing::HasSubstr;

class RestoreWindowTest : public ::testing::Test {
  protected:
    void SetUp() override {
        machine.load();
        machine.add(u"now");
    }
    void TearDown() override {
        delete window;
        while (auto* message = shownWindow<QMessageBox>()) delete message;
    }
    void open() {
        window = new RestoreDataWindowController(*machine.manager, world.files, machine.settings);
        bringToFront(*window);
    }
    // A backup in which the library is another one.
    void makeBackup(const std::string& name) {
        Machine other(world, "other");
        other.load();
        other.add(u"before");
        ASSERT_TRUE(world.files.createFolder("/one/Backups"));
        ASSERT_TRUE(other.manager->backupToFile("/one/Backups/" + name));
    }
    QListView& list() { return find<QListView>(*window, QStringLiteral("Backups, newest first")); }
    std::vector<std::string> rows() {
        std::vector<std::string> all;
        for (int row = 0; row < list().model()->rowCount(); ++row) {
            all.push_back(list().model()->index(row, 0).data().toString().toStdString());
        }
        return all;
    }
    QMessageBox& question() { return *window->findChild<QMessageBox*>(); }

    SharedWorld world;
    Machine machine{world};
    QPointer<RestoreDataWindowController> window;
};

TEST_F(RestoreWindowTest, ListsBackupsByTheirTimeNewestFirst) {
    const QLocale usual;
    QLocale::setDefault(QLocale(QLocale::English, QLocale::UnitedStates));
    makeBackup("Plume Backup 2026-01-30 09-00-00.plume");
    makeBackup("Plume Backup 2026-12-24 18-30-05.plume");
    makeBackup("Plume Backup 2026-13-99 18-30-05.plume");
    makeBackup("before \u7F16 <b>.plume");  // written on 2026-01-31
    open();
    EXPECT_THAT(rows(), ElementsAre("Plume Backup 2026-13-99 18-30-05.plume", "Thursday, December 24, 2026, 18:30:05",
                                    "before \u7F16 <b>.plume", "Friday, January 30, 2026, 09:00:00"));
    QLocale::setDefault(usual);
}

TEST_F(RestoreWindowTest, LooksWell) {
    for (int day = 10; day < 20; ++day) makeBackup("Plume Backup 2026-11-" + std::to_string(day) + " 18-30-05.plume");
    open();
    EXPECT_EQ(rows().size(), 10U);
    takePicture(*window, QStringLiteral("Restore"));
}

TEST_F(RestoreWindowTest, ReplacesTheLibraryByTheBackupOnceThatIsAgreed) {
    makeBackup("Plume Backup 2026-01-30 09-00-00.plume");
    open();
    const auto now = machine.library();
    click(*window, QStringLiteral("Restore Backup"));
    EXPECT_THAT(textOf(question()), HasSubstr("Your 1 snippet is replaced"));
    takePicture(question(), QStringLiteral("RestoreQuestion"));
    QTest::keyClick(&question(), Qt::Key_Return);  // the careful answer
    EXPECT_EQ(machine.library(), now);
    processDeletions();
    click(*window, QStringLiteral("Restore Backup"));
    click(question(), QStringLiteral("Replace My Snippets"));
    EXPECT_THAT(machine.library(), ElementsAre("Mine: before=text"));
    EXPECT_FALSE(window && window->isVisible());
    const std::string told = textOf(*shownWindow<QMessageBox>());
    EXPECT_THAT(told, HasSubstr("Your snippets were restored\n"));
    EXPECT_THAT(told, HasSubstr("/one/Backups/Plume Backup 2026-01-31 10-00-00.plume"));
    EXPECT_EQ(machine.libraryIn("/one/Backups/Plume Backup 2026-01-31 10-00-00.plume"), now);
}

TEST_F(RestoreWindowTest, TellsOfABackupThatIsGoneOrCannotBeRead) {
    makeBackup("a.plume");
    ASSERT_TRUE(world.files.write("/one/Backups/a.plume", "not a library"));
    open();
    QTest::keyClick(&list(), Qt::Key_Return);
    click(question(), QStringLiteral("Replace My Snippets"));
    EXPECT_THAT(textOf(*window->findChildren<QMessageBox*>().back()), HasSubstr("Error when restoring backup\n/one"));
    for (auto* message : window->findChildren<QMessageBox*>()) delete message;

    world.files.vanish("/one/Backups/a.plume");
    click(*window, QStringLiteral("Restore Backup"));
    EXPECT_THAT(textOf(question()),
                HasSubstr("Error when restoring backup\nThe selected backup file does not exist.\n"));
    click(question(), QStringLiteral("OK"));
    EXPECT_TRUE(window->isVisible());
    EXPECT_THAT(machine.library(), ElementsAre("Mine: now=text"));
}

TEST_F(RestoreWindowTest, NothingIsReplacedWhenTheSafetyBackupCannotBeWritten) {
    makeBackup("a.plume");
    open();
    world.files.setFreeBytes(0);
    click(*window, QStringLiteral("Restore Backup"));
    click(question(), QStringLiteral("Replace My Snippets"));
    EXPECT_THAT(textOf(*window->findChildren<QMessageBox*>().back()), HasSubstr("nothing was replaced"));
    EXPECT_THAT(machine.library(), ElementsAre("Mine: now=text"));
}

TEST_F(RestoreWindowTest, WithoutABackupAFileCanBeChosen) {
    open();
    EXPECT_FALSE(find<QPushButton>(*window, QStringLiteral("Restore Backup")).isEnabled());
    EXPECT_THAT(textOf(*window), HasSubstr("There is no backup in /one/Backups yet.\n"));
    click(*window, QStringLiteral("Choose File…"));
    auto& panel = *window->findChild<QFileDialog*>();
    EXPECT_EQ(panel.windowTitle(), QStringLiteral("Select a .plume file to restore"));
    EXPECT_EQ(panel.fileMode(), QFileDialog::ExistingFile);
    EXPECT_EQ(panel.nameFilters().size(), 1);
    panel.hide();
    makeBackup("elsewhere.plume");
    Q_EMIT panel.fileSelected(QStringLiteral("/one/Backups/elsewhere.plume"));
    click(question(), QStringLiteral("Replace My Snippets"));
    EXPECT_THAT(machine.library(), ElementsAre("Mine: before=text"));
}

TEST_F(RestoreWindowTest, ShowsThousandsOfBackups) {
    ASSERT_TRUE(world.files.createFolder("/one/Backups"));
    for (int i = 0; i < 3000; ++i) {
        ASSERT_TRUE(world.files.write("/one/Backups/" + std::to_string(i) + ".plume", "x"));
    }
    open();
    EXPECT_EQ(rows().size(), 3000U);
}

}  // namespace
}  // namespace plume
