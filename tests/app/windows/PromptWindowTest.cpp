// Windows that ask once, and are answered however they end.
#include "app/windows/PromptWindow.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <QPointer>
#include <QRadioButton>

#include "app/windows/FirstSyncWindow.h"
#include "tests/app/windows/WindowsSupport.h"

namespace plume {
namespace {

using namespace test;
using ::testing::HasSubstr;

class PromptWindowTest : public ::testing::Test {
  protected:
    ~PromptWindowTest() override { delete window; }
    void open() {
        window = new PromptWindow(
            {"Accessibility is off: Plume cannot see where you type."}, [this] { return found; }, [this] { ++closed; });
        bringToFront(*window);
    }

    Result<void> found = Error{"Still off: turn on “Screen Reader” in the settings."};
    int closed = 0;
    QPointer<PromptWindow> window;
};

TEST_F(PromptWindowTest, LooksAgainUntilAllIsWell) {
    open();
    EXPECT_THAT(textOf(*window), HasSubstr("Accessibility is off: Plume cannot see where you type.\n"));
    takePicture(*window, QStringLiteral("Prompt"));
    QTest::keyClick(window, Qt::Key_Return);
    EXPECT_THAT(textOf(*window), HasSubstr("Still off: turn on “Screen Reader” in the settings.\n"));
    EXPECT_THAT(textOf(*window), HasSubstr("Looked again at "));
    EXPECT_EQ(closed, 0);
    found = {};
    click(*window, QStringLiteral("Check Again"));
    EXPECT_THAT(textOf(*window), HasSubstr("All that was missing is there now.\n"));
    takePicture(*window, QStringLiteral("PromptWell"));
    EXPECT_TRUE(QTest::qWaitFor([this] { return closed == 1 && !window; }));
}

TEST_F(PromptWindowTest, TellsOnceThatItIsClosed) {
    found = {};
    for (const char* button : {"Continue Anyway", "Close", ""}) {
        closed = 0;
        open();
        if (button == std::string("Close")) click(*window, QStringLiteral("Check Again"));
        if (*button) {
            click(*window, QString::fromUtf8(button));
        } else {
            QTest::keyClick(window, Qt::Key_Escape);
        }
        EXPECT_EQ(closed, 1) << button;
        processDeletions();
        EXPECT_FALSE(window);
    }
    EXPECT_EQ(closed, 1);
}

class FirstSyncWindowTest : public ::testing::Test {
  protected:
    InitalSyncWindowController& open(const std::string& folder = "Shared") {
        processDeletions();
        auto* window = new InitalSyncWindowController(folder, [this](int code) { answers.push_back(code); });
        bringToFront(*window);
        return *window;
    }
    void TearDown() override { processDeletions(); }

    std::vector<int> answers;
};

TEST_F(FirstSyncWindowTest, AnswersOnceWithTheChosenRow) {
    click(open(), QStringLiteral("Use Folder’s Snippets"));
    auto& other = open();
    find<QRadioButton>(other, QStringLiteral("Replace the snippets in “Shared” by those of this computer")).click();
    QTest::keyClick(&other, Qt::Key_Return);
    click(open(), QStringLiteral("Cancel"));
    QTest::keyClick(&open(), Qt::Key_Escape);
    open().close();
    EXPECT_THAT(answers, ::testing::ElementsAre(1, 2, 0, 0, 0));
}

TEST_F(FirstSyncWindowTest, NamesTheFolderAsItIsCalled) {
    auto& window = open("/home/me/R&D %@ <b>/");
    EXPECT_EQ(window.objectName(), QStringLiteral("InitalSyncWindow"));
    EXPECT_THAT(textOf(window), HasSubstr("The folder “R&D %@ <b>” holds snippets already\n"));
    EXPECT_TRUE(
        find<QRadioButton>(window, QStringLiteral("Use the snippets in “RD %@ <b>” on this computer")).isChecked());
    EXPECT_THAT(textOf(window), HasSubstr("backup"));
    window.close();
    const auto& wide = open("/home/me/" + std::string(255, 'w'));
    EXPECT_LT(wide.minimumSizeHint().width(), 700);
    shownWindow<InitalSyncWindowController>()->close();
    takePicture(open("/home/me/Nextcloud/Snippets"), QStringLiteral("FirstSync"));
    shownWindow<InitalSyncWindowController>()->close();
}

}  // namespace
}  // namespace plume
