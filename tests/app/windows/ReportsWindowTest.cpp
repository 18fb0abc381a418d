#include "app/windows/ReportsWindow.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <QClipboard>
#include <QPointer>
#include <QPushButton>
#include <QTreeView>

#include "library/MemoryUserDefaults.h"
#include "tests/app/windows/WindowsSupport.h"

namespace plume {
namespace {

using namespace test;
using ::testing::ElementsAre;

class ReportsWindowTest : public ::testing::Test {
  protected:
    ~ReportsWindowTest() override { delete window; }
    void open() {
        window = new ReportsWindow(log, settings);
        bringToFront(*window);
    }
    QTreeView& list() { return find<QTreeView>(*window, QStringLiteral("Reports, newest first")); }
    std::vector<std::string> sentences() {
        std::vector<std::string> all;
        const auto& model = *list().model();
        for (int row = 0; row < model.rowCount(); ++row)
            all.push_back(model.index(row, 1).data().toString().toStdString());
        return all;
    }

    ScopedDateSource dates{[] { return Date(std::chrono::seconds(1'700'000'000)); }};
    ReportLog log;
    MemoryUserDefaults settings;
    QPointer<ReportsWindow> window;
};

TEST_F(ReportsWindowTest, ListsTheNewestFirstAndFollows) {
    log.add("old");
    open();
    log.add("new");
    log.add("old");
    EXPECT_THAT(sentences(), ElementsAre("old (2 times)", "new"));
    list().setCurrentIndex(list().model()->index(1, 0));
    log.add("newest");
    EXPECT_EQ(list().currentIndex().row(), 2);  // the same one
    click(*window, QStringLiteral("Clear"));
    EXPECT_TRUE(log.reports().empty());
    EXPECT_FALSE(find<QPushButton>(*window, QStringLiteral("Copy All")).isEnabled());
    EXPECT_EQ(textOf(*window), "Plume has had nothing to report.\n");
}

TEST_F(ReportsWindowTest, AnActionMayReportOrEmptyTheLog) {
    log.add("The backup failed.", {"Try Again", [this] { log.add("It failed again."); }});
    open();
    click(*window, QStringLiteral("Try Again"));
    EXPECT_THAT(sentences(), ElementsAre("It failed again.", "The backup failed."));
    log.add("Too much.", {"Forget All", [this] { log.clear(); }});
    list().setCurrentIndex(list().model()->index(0, 0));
    QTest::keyClick(&list(), Qt::Key_Return);
    EXPECT_EQ(textOf(*window), "Plume has had nothing to report.\n");
}

TEST_F(ReportsWindowTest, CopiesAllWithTheirTimes) {
    log.add("first \U0001F600");
    log.add("second");
    open();
    click(*window, QStringLiteral("Copy All"));
    const QStringList lines = QGuiApplication::clipboard()->text().split(QLatin1Char('\n'));
    ASSERT_EQ(lines.size(), 3);
    EXPECT_TRUE(lines[0].endsWith(QStringLiteral("\tsecond")));
    EXPECT_TRUE(lines[1].endsWith(QString::fromUtf8("\tfirst \U0001F600")));
}

TEST_F(ReportsWindowTest, LongSentencesAreWrappedAndAllIsReachedByTab) {
    log.add("Short.");
    const std::string text =
        "The folder that your snippets are synchronized with, \"/home/me/Shared Files/Snippets\", "
        "cannot be read: permission was denied. Your snippets are safe on this computer.";
    log.add(text, {"Open Sync Settings", [] {}});
    log.add("Abbreviations are not expanded while a password is typed.", {"Why?", [] {}});
    open();
    const auto& model = *list().model();
    EXPECT_GT(list().visualRect(model.index(1, 1)).height(), list().visualRect(model.index(2, 1)).height());
    takePicture(*window, QStringLiteral("Reports"));
    find<QPushButton>(*window, QStringLiteral("Open Sync Settings")).setFocus();
    log.add("Something else.");
    EXPECT_EQ(window->focusWidget()->property("number").toInt(), 2);  // that of the same report
}

}  // namespace
}  // namespace plume
