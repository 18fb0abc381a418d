// That windows come and go as they are asked for, and what the simplest of them show.
#include "app/windows/QtWindows.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <QClipboard>
#include <QFile>
#include <QFileDialog>
#include <QLineEdit>
#include <QMessageBox>
#include <QScreen>
#include <QTreeView>

#include "app/DiagnosticReport.h"
#include "app/windows/AboutWindow.h"
#include "app/windows/DiagnosticWindow.h"
#include "app/windows/NewSnippetWindow.h"
#include "import/Importers.h"
#include "tests/app/windows/WindowsSupport.h"
#include "tests/library/LibraryMachine.h"
#include "tests/support/TemporaryFolder.h"

namespace plume {
namespace {

using namespace test;
using ::testing::ElementsAre;
using ::testing::HasSubstr;

class QtWindowsTest : public ::testing::Test {
  protected:
    void SetUp() override { machine.load(); }
    void TearDown() override {
        processDeletions();
        while (auto* message = shownWindow<QMessageBox>()) delete message;
    }

    static QString path(const std::filesystem::path& path) { return QString::fromStdString(path.string()); }
    // As a user who has found the file in the panel.
    static void choose(QFileDialog& panel, const std::filesystem::path& file) {
        panel.setDirectory(path(file.parent_path()));
        find<QLineEdit>(panel, QStringLiteral("File name:")).setText(path(file.filename()));
        static_cast<QDialog&>(panel).accept();
        QCoreApplication::processEvents();
    }

    SharedWorld world;
    Machine machine{world};
    ReportLog reports;
    std::vector<std::string> asked;
    QtWindows windows{
        {.settings = machine.settings,
         .dataManager = *machine.manager,
         .files = world.files,
         .reports = reports,
         .version = QStringLiteral("0.1.0"),
         .welcome =
             [] { return WelcomeServices{.hasIcon = [] { return true; }, .startsAtLogin = [] { return true; }}; },
         .showMacros = [this](bool all) { asked.emplace_back(all ? "all macros" : "macros"); },
         .showSnippet = [this](const auto& snippet) { asked.push_back(toUtf8(snippet->abbreviation().value_or(u""))); },
         .showPreferences = [this](const std::string& page) { asked.push_back("page " + page); },
         .showDecisions = [this] { asked.emplace_back("decisions"); },
         .commitEdits = [this] { asked.emplace_back("commit"); }}};
};

TEST_F(QtWindowsTest, AnOpenWindowIsShownAgainAndAClosedOneIsGone) {
    EXPECT_FALSE(windows.hasVisibleWindow());
    windows.showAboutWindow();
    const QPointer<AboutWindow> first = shownWindow<AboutWindow>();
    ASSERT_TRUE(first);
    EXPECT_TRUE(windows.hasVisibleWindow());
    first->showMinimized();
    windows.showAboutWindow();
    EXPECT_EQ(shownWindow<AboutWindow>(), first);
    EXPECT_FALSE(first->isMinimized());
    first->showMinimized();
    windows.bringAllToFront();
    EXPECT_FALSE(first->isMinimized());
    activate(*first);
    QTest::keyClick(first, Qt::Key_W, Qt::ControlModifier);
    EXPECT_FALSE(windows.hasVisibleWindow());
    windows.showAboutWindow();
    EXPECT_NE(shownWindow<AboutWindow>(), first);
    processDeletions();
    EXPECT_FALSE(first);
    EXPECT_TRUE(machine.settings.hasKey("WindowPlace.About"));
    QTest::keyClick(shownWindow<AboutWindow>(), Qt::Key_Escape);
    EXPECT_FALSE(windows.hasVisibleWindow());
}

TEST_F(QtWindowsTest, EveryWindowOpensAndOnlyTheOneThatHoldsTextIsNotReused) {
    windows.showReportsWindow();
    windows.showWelcomeWindow();
    windows.showRestoreWindow();
    const auto count = [] {
        const auto all = QApplication::topLevelWidgets();
        return std::count_if(all.begin(), all.end(), [](const QWidget* each) { return each->isVisible(); });
    };
    for (int i = 0; i < 2; ++i) {
        windows.showReportsWindow();
        windows.showWelcomeWindow();
        windows.showRestoreWindow();
        EXPECT_EQ(count(), 3);
    }
    windows.showNewSnippetWindow({});
    windows.showNewSnippetWindow({});
    EXPECT_EQ(count(), 4);
    windows.showNewSnippetWindow(u"text");
    EXPECT_EQ(count(), 5);
}

TEST_F(QtWindowsTest, WindowsOfOthersAreAskedFor) {
    windows.showMacrosWindow(true);
    windows.showPreferencesWindow("Sync");
    windows.showDecisionsWindow();
    windows.commitEdits();
    EXPECT_THAT(asked, ElementsAre("all macros", "page Sync", "decisions", "commit"));
}

TEST_F(QtWindowsTest, AboutNamesVersionLicenseAndLibraries) {
    windows.showAboutWindow();
    auto& window = *shownWindow<AboutWindow>();
    EXPECT_THAT(textOf(window), HasSubstr("Version 0.1.0\n"));
    EXPECT_THAT(textOf(window), HasSubstr("file LICENSE"));
    const auto& list = find<QTreeView>(window, QStringLiteral("Libraries that Plume uses"));
    EXPECT_EQ(list.model()->rowCount(), 13);
    takePicture(window, QStringLiteral("About"));
}

TEST_F(QtWindowsTest, AWindowThatOpensFitsTheScreen) {
    QWidget window;
    window.setGeometry(0, -100, 5000, 5000);
    bringToFront(window);
    const QRect screen = window.screen()->availableGeometry();
    EXPECT_LT(window.width(), screen.width());
    EXPECT_LT(window.height(), screen.height());
    EXPECT_GE(window.y(), screen.y());
}

TEST_F(QtWindowsTest, ADiagnosticReportCanBeCopiedSavedAndReplaced) {
    windows.showDiagnosticWindow(u"old");
    windows.showDiagnosticWindow(u"Plume is <b>well</b>.\n\tPID: 1 \u7F16");
    auto& window = *shownWindow<DiagnosticWindow>();
    EXPECT_EQ(window.objectName(), QStringLiteral("DiagnosticWindow"));
    EXPECT_LT((window.frameGeometry().center() - window.screen()->availableGeometry().center()).manhattanLength(), 4);
    const QString report = find<QPlainTextEdit>(window, QStringLiteral("Report")).toPlainText();
    EXPECT_EQ(report.toStdString(), "Plume is <b>well</b>.\n\tPID: 1 \u7F16");
    click(window, QStringLiteral("Copy"));
    EXPECT_EQ(QGuiApplication::clipboard()->text(), report);
    const RunningApplication editor{
        .processIdentifier = 1, .bundleIdentifier = {}, .localizedName = u"Kate", .executableURL = {}};
    windows.showDiagnosticWindow(diagnosticReport({.version = u"1.0",
                                                   .systemVersion = u"Linux 6.8, X.Org 21.1",
                                                   .isEnabled = true,
                                                   .hasEventTap = true,
                                                   .foregroundProgram = editor,
                                                   .secureInputIsOn = true,
                                                   .secureInputApplication = u"KeePassXC"}));
    takePicture(window, QStringLiteral("Diagnostic"));
    window.setReport(report);

    const TemporaryFolder folder;
    click(window, QStringLiteral("Save…"));
    choose(*window.findChild<QFileDialog*>(), folder.path() / "report");
    QFile file(path(folder.path() / "report.txt"));
    ASSERT_TRUE(file.open(QIODevice::ReadOnly));
    EXPECT_EQ(QString::fromUtf8(file.readAll()), report);

    processDeletions();
    click(window, QStringLiteral("Save…"));
    auto& panel = *window.findChild<QFileDialog*>();
    panel.hide();
    Q_EMIT panel.fileSelected(path(folder.path() / "gone" / "report.txt"));
    EXPECT_THAT(textOf(*window.findChild<QMessageBox*>()), HasSubstr("The report was not saved\n"));
}

TEST_F(QtWindowsTest, AFileIsImportedRestoredOrLeftAloneAsTheUserSays) {
    using FileUse = ApplicationWindows::FileUse;
    std::vector<FileUse> answers;
    const auto openQuestion = [&]() -> QMessageBox& {
        processDeletions();
        windows.askForFileUse("/home/me/<b>.plume", [&](FileUse use) { answers.push_back(use); });
        return *shownWindow<QMessageBox>();
    };
    auto& box = openQuestion();
    EXPECT_EQ(box.windowTitle(), QStringLiteral("Restore / Import data from <b>.plume"));
    EXPECT_EQ(box.informativeText(),
              QStringLiteral("Restoring will replace all current snippets with snippets from the selected "
                             "file.\r\n\r\nImporting will add file's snippets to current snippets."));
    for (const QLabel* label : box.findChildren<QLabel*>()) EXPECT_EQ(label->textFormat(), Qt::PlainText);
    takePicture(box, QStringLiteral("FileUse"));
    QTest::keyClick(&box, Qt::Key_Return);
    click(openQuestion(), QStringLiteral("Restore"));
    click(openQuestion(), QStringLiteral("Cancel"));
    QTest::keyClick(&openQuestion(), Qt::Key_Escape);
    openQuestion().close();
    EXPECT_THAT(answers,
                ElementsAre(FileUse::Import, FileUse::Restore, FileUse::Nothing, FileUse::Nothing, FileUse::Nothing));
}

TEST_F(QtWindowsTest, APanelOffersAllThatCanBeImported) {
    const TemporaryFolder folder;
    QFile file(path(folder.path() / "old.TextExpander"));
    ASSERT_TRUE(file.open(QIODevice::WriteOnly));
    file.close();
    std::vector<std::filesystem::path> chosen;
    windows.askForFile([&](const std::filesystem::path& path) { chosen.push_back(path); });
    auto& panel = *shownWindow<QFileDialog>();
    for (const std::string& extension : importableExtensions()) {
        EXPECT_TRUE(panel.nameFilters().front().contains(QString::fromStdString("*." + extension))) << extension;
    }
    choose(panel, folder.path() / "old.TextExpander");
    EXPECT_THAT(chosen, ElementsAre(folder.path() / "old.TextExpander"));
    processDeletions();
    windows.askForFile([&](const std::filesystem::path& path) { chosen.push_back(path); });
    QTest::keyClick(shownWindow<QFileDialog>(), Qt::Key_Escape);
    EXPECT_EQ(chosen.size(), 1U);
}

TEST_F(QtWindowsTest, AnExportIsWrittenAsItsEndingSays) {
    const TemporaryFolder folder;
    std::vector<std::filesystem::path> chosen;
    const auto exportAs = [&](const char* name, int filter) {
        processDeletions();
        windows.askWhereToExport([&](const std::filesystem::path& path) { chosen.push_back(path); });
        auto& panel = *shownWindow<QFileDialog>();
        const QString kind = panel.nameFilters().value(filter);
        panel.selectNameFilter(kind);
        Q_EMIT panel.filterSelected(kind);
        choose(panel, folder.path() / name);
    };
    exportAs("mine", 0);
    exportAs("mine", 1);
    exportAs("mine.JSON", 2);
    EXPECT_THAT(chosen,
                ElementsAre(folder.path() / "mine.plume", folder.path() / "mine.csv", folder.path() / "mine.JSON"));
    exportAs("mine.txt", 0);
    EXPECT_EQ(chosen.size(), 3U);
    EXPECT_THAT(textOf(*shownWindow<QMessageBox>()), HasSubstr("The snippets were not exported\n"));
}

TEST_F(QtWindowsTest, AMessageIsPlainTextWithOneButton) {
    windows.tell(u"Imported <b>3</b> snippets", u"From /home/me/<i>.csv");
    auto& box = *shownWindow<QMessageBox>();
    EXPECT_THAT(textOf(box), HasSubstr("Imported <b>3</b> snippets\n"));
    for (const QLabel* label : box.findChildren<QLabel*>()) EXPECT_EQ(label->textFormat(), Qt::PlainText);
    EXPECT_EQ(box.buttons().size(), 1);
    takePicture(box, QStringLiteral("Message"));
    click(box, QStringLiteral("OK"));
    EXPECT_FALSE(windows.hasVisibleWindow());
}

}  // namespace
}  // namespace plume
