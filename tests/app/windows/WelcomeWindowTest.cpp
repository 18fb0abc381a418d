#include "app/windows/WelcomeWindow.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <QCheckBox>
#include <QMessageBox>
#include <QPointer>
#include <QPushButton>

#include "app/qt/Text.h"
#include "library/MemoryUserDefaults.h"
#include "tests/app/windows/WindowsSupport.h"

namespace plume {
namespace {

using namespace test;
using ::testing::HasSubstr;

class WelcomeWindowTest : public ::testing::Test {
  protected:
    WelcomeWindowTest() {
        services.trials = {
            {u";sig", u"Kind regards,\r\nAda\u00A0Lovelace"}, {u";date", u"23 November 2026"}, {u";lorem", longText()}};
        services.foundLibraries = {{u"espanso", "/home/me/.config/espanso"}, {u"AutoKey", "/home/me/.config/autokey"}};
        services.import = [this](const auto& /*library*/, auto told) { tellOutcome = told; };
        services.hasIcon = [this] { return hasIcon; };
        services.startsAtLogin = [this] { return starts; };
        services.setStartsAtLogin = [this](bool now) -> Result<void> {
            if (fault) return *fault;
            starts = now;
            return {};
        };
    }
    ~WelcomeWindowTest() override { delete window; }
    static std::u16string longText() {
        std::u16string text;
        for (int i = 0; i < 10; ++i) text += u"Lorem ipsum dolor sit amet, consectetur adipiscing elit. ";
        return text;
    }
    void open() {
        window = new WelcomeWindow(services, settings);
        bringToFront(*window);
    }
    int ticks() {
        int count = 0;
        for (const QLabel* label : window->findChildren<QLabel*>())
            count += label->accessibleName() == QStringLiteral("Done");
        return count;
    }

    WelcomeServices services;
    bool hasIcon = true;
    bool starts = false;
    std::optional<Error> fault;
    std::function<void(const Result<std::string>&)> tellOutcome;
    MemoryUserDefaults settings;
    QPointer<WelcomeWindow> window;
};

TEST_F(WelcomeWindowTest, TicksOffWhatHasAppearedInTheField) {
    open();
    auto& field = find<QPlainTextEdit>(*window, QStringLiteral("Type here:"));
    EXPECT_EQ(window->focusWidget(), &field);
    EXPECT_THAT(textOf(*window), HasSubstr("becomes “Kind regards, Ada"));
    field.insertPlainText(QStringLiteral(";sig"));
    EXPECT_EQ(ticks(), 0);
    field.setPlainText(QString::fromUtf8("Kind regards,\nAda\u00A0Lovelace"));
    EXPECT_EQ(ticks(), 1);
    takePicture(*window, QStringLiteral("Welcome"));
    field.setPlainText(QStringLiteral("23 November 2026"));
    EXPECT_EQ(ticks(), 2);  // those that were done stay so
    field.appendPlainText(toQString(longText()));
    EXPECT_THAT(textOf(*window), HasSubstr("That is all there is to it.\n"));
    QTest::keyClick(&field, Qt::Key_Tab);
    EXPECT_NE(window->focusWidget(), &field);
    click(*window, QStringLiteral("Get Started"));
    EXPECT_FALSE(window && window->isVisible());
}

TEST_F(WelcomeWindowTest, TellsOfTheSpaceThatAnAbbreviationNeeds) {
    services.trials = {{u"btw", u"by the way", true}, {u"fyi", u"for you", true}};
    open();
    EXPECT_THAT(textOf(*window), HasSubstr("and a space become “by the way”"));
    auto& field = find<QPlainTextEdit>(*window, QStringLiteral("Type here:"));
    field.setPlainText(QStringLiteral("btw "));
    EXPECT_EQ(ticks(), 0);
    field.setPlainText(QStringLiteral("by the way "));
    EXPECT_EQ(ticks(), 1);
    field.setPlainText(QStringLiteral("by the way for you"));  // the space was swallowed
    EXPECT_EQ(ticks(), 2);
}

TEST_F(WelcomeWindowTest, ImportsALibraryOnce) {
    open();
    auto& button = find<QPushButton>(*window, QStringLiteral("Import espanso"));
    button.click();
    EXPECT_FALSE(button.isEnabled());
    tellOutcome(Error{"match.yml, line 3: a text is missing"});
    EXPECT_THAT(textOf(*window), HasSubstr("match.yml, line 3: a text is missing\n"));
    EXPECT_TRUE(button.isEnabled());
    button.click();
    tellOutcome(std::string("12 snippets were imported."));
    EXPECT_THAT(textOf(*window), HasSubstr("12 snippets were imported.\n"));
    EXPECT_FALSE(button.isEnabled());
    takePicture(*window, QStringLiteral("WelcomeImported"));
    window->close();
    processDeletions();
    tellOutcome(std::string("too late"));
}

TEST_F(WelcomeWindowTest, SetsWhetherPlumeStartsAtLogin) {
    open();
    auto& box = find<QCheckBox>(*window, QStringLiteral("Start Plume when I log in"));
    EXPECT_FALSE(box.isChecked());
    box.click();
    EXPECT_TRUE(starts);
    fault = Error{"/home/me/.config/autostart: permission denied"};
    box.click();
    EXPECT_TRUE(box.isChecked());
    EXPECT_THAT(textOf(*window->findChild<QMessageBox*>()), HasSubstr("permission denied"));
}

TEST_F(WelcomeWindowTest, WithoutAnIconSaysHowPlumeIsReached) {
    open();
    EXPECT_THAT(textOf(*window), Not(HasSubstr("run “plume” again")));
    delete window;
    services = {.hasIcon = [this] { return hasIcon; }, .startsAtLogin = services.startsAtLogin};
    hasIcon = false;
    open();
    const auto tells = [this] { return textOf(*window).find("run “plume” again") != std::string::npos; };
    QTest::qWait(1500);
    EXPECT_FALSE(tells()) << "an icon often comes a moment after the window";
    EXPECT_TRUE(QTest::qWaitFor(tells, 3000));
    takePicture(*window, QStringLiteral("WelcomeShort"));
    hasIcon = true;
    EXPECT_TRUE(QTest::qWaitFor([&] { return !tells(); }, 3000));
}

}  // namespace
}  // namespace plume
