#include "app/form/UnsentTextWindow.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <QPushButton>
#include <memory>

#include "tests/app/windows/WindowsSupport.h"
#include "tests/support/Language.h"

namespace plume {
namespace {

using namespace test;
using ::testing::ElementsAre;
using ::testing::HasSubstr;
using ::testing::IsEmpty;

class UnsentTextWindowTest : public ::testing::Test {
  protected:
    void open(const std::u16string& text = u"Dear Ms Example,\n\nthank you for your order.") {
        done.clear();
        window = std::make_unique<UnsentTextWindow>(
            text,
            "The snippet was not sent: the window that it was for is gone, or "
            "does not take the keyboard.",
            UnsentTextWindow::Actions{[this] { done.emplace_back("copy"); }, [this] { end("try again"); },
                                      [this] { end("drop"); }});
        window->show();
        activate(*window);
    }
    void end(const char* what) {
        done.emplace_back(what);
        window.reset();
    }
    void press(Qt::Key key) {
        QTest::keyClick(window.get(), key);
        QCoreApplication::processEvents();
    }

    std::unique_ptr<UnsentTextWindow> window;
    std::vector<std::string> done;
};

TEST_F(UnsentTextWindowTest, ComesWithoutTakingTheKeyboard) {
    open();
    EXPECT_TRUE(window->testAttribute(Qt::WA_ShowWithoutActivating));
    EXPECT_TRUE(window->windowFlags().testFlag(Qt::WindowStaysOnTopHint));
    EXPECT_THAT(textOf(*window), HasSubstr("the window that it was for is gone"));
    EXPECT_THAT(find<QPlainTextEdit>(*window, QStringLiteral("The text")).toPlainText().toStdString(),
                HasSubstr("thank you for your order."));
    takePicture(*window, QStringLiteral("UnsentText"));
}

TEST_F(UnsentTextWindowTest, ShowsTheBeginningOfALongText) {
    open(std::u16string(1'000'000, u'x'));
    const QString shown = find<QPlainTextEdit>(*window, QStringLiteral("The text")).toPlainText();
    EXPECT_LT(shown.size(), 10'000);
    EXPECT_TRUE(shown.endsWith(QChar(u'…')));
}

TEST_F(UnsentTextWindowTest, StaysWhenTheTextIsCopied) {
    open();
    press(Qt::Key_Return);
    EXPECT_THAT(done, ElementsAre("copy"));
    EXPECT_THAT(textOf(*window), HasSubstr("Copied."));
    press(Qt::Key_Escape);
    EXPECT_THAT(done, ElementsAre("copy", "drop"));
}

TEST_F(UnsentTextWindowTest, AsksBeforeTheOnlyCopyIsLost) {
    for (const bool byKey : {true, false}) {
        open();
        const auto close = [&] { byKey ? press(Qt::Key_Escape) : (void)window->close(); };
        close();
        QCoreApplication::processEvents();
        ASSERT_TRUE(window && window->isVisible());
        EXPECT_THAT(done, IsEmpty());
        EXPECT_THAT(textOf(*window), HasSubstr("Discard the text?"));
        close();
        QCoreApplication::processEvents();
        EXPECT_THAT(done, ElementsAre("drop"));
    }
}

TEST_F(UnsentTextWindowTest, EndsOnceAndMayBeDestroyedThen) {
    for (const auto& [button, action] : {std::pair("Try Again", "try again"), std::pair("Discard", "drop")}) {
        open();
        auto& pressed = find<QAbstractButton>(*window, QString::fromLatin1(button));
        pressed.click();
        pressed.click();
        EXPECT_THAT(done, IsEmpty()) << "an action is not called from inside the window";
        QCoreApplication::processEvents();
        EXPECT_THAT(done, ElementsAre(action));
        EXPECT_FALSE(window);
    }
}

TEST_F(UnsentTextWindowTest, TellsNothingAfterItsEnd) {
    open();
    find<QAbstractButton>(*window, QStringLiteral("Discard")).click();
    find<QAbstractButton>(*window, QStringLiteral("Copy")).click();
    window.reset();
    QCoreApplication::processEvents();
    EXPECT_THAT(done, IsEmpty());
}

}  // namespace
}  // namespace plume
