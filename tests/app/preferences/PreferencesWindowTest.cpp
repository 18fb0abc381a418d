#include "app/preferences/PreferencesWindow.h"

#include <gtest/gtest.h>

#include <QAccessible>
#include <QCheckBox>
#include <QComboBox>
#include <QDoubleSpinBox>
#include <QElapsedTimer>
#include <QMenu>
#include <QPlainTextEdit>
#include <QScrollArea>
#include <QStackedWidget>
#include <map>
#include <set>

#include "app/preferences/HotKeyRecorder.h"
#include "app/qt/ColorScheme.h"
#include "tests/app/preferences/PreferencesSupport.h"
#include "tests/support/Language.h"

namespace plume {
namespace {

using test::letGo;
using test::named;
using test::Pages;
using test::PreferencesWindowTest;
using test::withText;

// ---- Search ----

TEST_F(PreferencesWindowTest, EverySettingOfAPersonIsFoundByItsName) {
    const std::set<std::string_view> others{"ShowDockIcon",           "FirstLaunch",       "ListenAtAnnotatedSession",
                                            "LastBackupTime",         "SyncDirectoryType", "SyncWithOSXSubstitutions",
                                            "SUEnableAutomaticChecks"};
    for (const KnownSetting& setting : knownSettings()) {
        if (others.contains(setting.name)) continue;
        search(std::string(setting.name).c_str());
        EXPECT_TRUE(hits()) << setting.name;
    }
    search("no such thing");
    EXPECT_FALSE(hits());
    EXPECT_TRUE(withText<QLabel>(window(), "Nothing was found."));
}

TEST_F(PreferencesWindowTest, AFoundSettingIsShownAndGetsTheKeyboard) {
    QTest::keyClick(&window(), Qt::Key_F, Qt::ControlModifier);
    auto* line = named<QLineEdit>(window(), "Search settings");
    ASSERT_TRUE(line->hasFocus());
    QTest::keyClicks(line, "clipboard DELAY");
    ASSERT_TRUE(hits());
    EXPECT_EQ(hits()->item(0)->text(), "Give it back after\nTyping and clipboard");
    QTest::keyClick(line, Qt::Key_Return);
    auto* delay = named<QDoubleSpinBox>(window(), "Give it back after:");
    ASSERT_TRUE(delay);
    EXPECT_TRUE(delay->hasFocus());
    EXPECT_FALSE(delay->visibleRegion().isEmpty());
    QTest::keyClick(&window(), Qt::Key_F, Qt::ControlModifier);
    QTest::keyClick(line, Qt::Key_Escape);
    EXPECT_TRUE(named<QListWidget>(window(), "Pages"));
}

// ---- The window itself ----

TEST_F(PreferencesWindowTest, ThePageSeenLastComesBack) {
    window().showPage("Backups");
    window().showPage("No such page");
    QTest::keyClick(&window(), Qt::Key_W, Qt::ControlModifier);
    letGo();
    ASSERT_FALSE(window_);
    open();
    EXPECT_EQ(named<QListWidget>(window(), "Pages")->currentItem()->text(), "Backups and sync");
}

TEST_F(PreferencesWindowTest, EveryControlHasANameAndItsOwnMnemonic) {
    for (const char* page : Pages) {
        window().showPage(page);
        EXPECT_LE(window().minimumSizeHint().width(), 1024) << page;
        EXPECT_LE(window().minimumSizeHint().height(), 700) << page;
        std::map<QString, QString> taken;
        for (auto* widget : window().findChildren<QWidget*>()) {
            if (!widget->isVisible()) continue;
            QString text = widget->property("text").toString();
            if (qobject_cast<QLineEdit*>(widget)) text.clear();
            const QKeySequence key = QKeySequence::mnemonic(text);
            if (!key.isEmpty()) {
                EXPECT_TRUE(taken.emplace(key.toString(), text).second)
                    << page << ": " << text.toStdString() << ", " << taken[key.toString()].toStdString();
            }
            const bool isControl = qobject_cast<QAbstractButton*>(widget) || qobject_cast<QComboBox*>(widget) ||
                                   qobject_cast<QAbstractSpinBox*>(widget) || qobject_cast<QPlainTextEdit*>(widget);
            if (!isControl || widget->focusPolicy() == Qt::NoFocus || widget->objectName().startsWith("qt_")) continue;
            QAccessibleInterface* seen = QAccessible::queryAccessibleInterface(widget);
            EXPECT_FALSE(seen->text(QAccessible::Name).isEmpty()) << page << ": " << widget->metaObject()->className();
        }
    }
}

TEST_F(PreferencesWindowTest, ItSpeaksOtherLanguages) {
    const QString folder = qEnvironmentVariable("PLUME_PICTURES");
    for (const QString language : {"de", "fr"}) {
        delete window_;
        const test::SpokenLanguage spoken(language);
        open();
        const bool isGerman = language == "de";
        EXPECT_TRUE(withText<QCheckBox>(window(), isGerman ? "Kürzel ersetzen" : "Développer les abréviations"));
        EXPECT_TRUE(named<QListWidget>(window(), isGerman ? "Seiten" : "Pages"));
        for (const char* page : Pages) {
            SCOPED_TRACE(language.toStdString() + ", " + page);
            window().showPage(page);
            QCoreApplication::processEvents();
            test::Mnemonics().addAll(window());
            EXPECT_LE(window().minimumSizeHint().width(), 1024);
            const auto* area =
                qobject_cast<QScrollArea*>(window().findChild<QStackedWidget*>("Content")->currentWidget());
            EXPECT_LE(area->widget()->minimumSizeHint().width(), area->viewport()->width());
            if (!folder.isEmpty()) window().grab().save(QStringLiteral("%1/%2-%3.png").arg(folder, page, language));
        }
    }
}

TEST_F(PreferencesWindowTest, ItOpensQuickly) {
    delete window_;
    QElapsedTimer timer;
    timer.start();
    open();
    RecordProperty("milliseconds", int(timer.elapsed()));
    // On an idle machine 150 are the most that there should be.
    EXPECT_LE(timer.elapsed(), 2000);
}

TEST_F(PreferencesWindowTest, LongTextsMakeItNoWider) {
    (void)settings.setObject("FeedbackSound", std::u16string(20'000, u'\u4E00'));
    (void)settings.setObject("BackupDirectory", std::u16string(20'000, u'x'));
    (void)settings.setObject("DoubleCapitalsCorrectionExclusion", std::u16string(50'000, u'\n'));
    (void)settings.setObject("UseClipboardApplications", PropertyList::Array(2'000, std::u16string(u"\U0001F600")));
    for (const char* page : Pages) {
        window().showPage(page);
        EXPECT_LE(window().minimumSizeHint().width(), 1024) << page;
        const auto* area = qobject_cast<QScrollArea*>(window().findChild<QStackedWidget*>("Content")->currentWidget());
        EXPECT_LE(area->widget()->minimumSizeHint().width(), 800) << page;
    }
}

TEST_F(PreferencesWindowTest, Pictures) {
    const QString folder = qEnvironmentVariable("PLUME_PICTURES");
    if (folder.isEmpty()) GTEST_SKIP() << "for people to look at: PLUME_PICTURES names no folder";
    (void)settings.setObject("UseClipboardIn", std::int64_t{2});
    (void)settings.setObject("UseClipboardApplications",
                             PropertyList::Array{std::u16string(u"kitty"), std::u16string(u"mychat")});
    (void)settings.setObject("quickSearchHotKey",
                             GeneralHotKey{KeyModifier::Control | KeyModifier::Option, KeyCode::K}.getValue());
    for (const bool isDark : {false, true}) {
        setColorScheme(isDark);
        for (const char* page : Pages) {
            window().showPage(page);
            QCoreApplication::processEvents();
            const QString size = qEnvironmentVariableIsSet("QT_SCALE_FACTOR") ? "-200" : "";
            window().grab().save(QStringLiteral("%1/%2%3%4.png").arg(folder, page, isDark ? "-dark" : "", size));
        }
    }
    setColorScheme(false);
    search("paste");
    QTest::keyClick(named<QLineEdit>(window(), "Search settings"), Qt::Key_Return);
    settings.isFull = true;
    QTest::mouseClick(withText<QCheckBox>(window(), "Paste texts instead of typing them"), Qt::LeftButton, {},
                      QPoint(8, 8));
    QCoreApplication::processEvents();
    window().grab().save(folder + "/Search-hits.png");
    settings.isFull = false;
    search("");
    window().showPage("HotKeys");
    QTest::keyClick(named<HotKeyRecorder>(window(), "Suggest abbreviations")->focusProxy(), Qt::Key_Space);
    pressed({{}, KeyCode::K});
    QCoreApplication::processEvents();
    window().grab().save(folder + "/HotKeys-recording.png");
    window().showPage("Applications");
    QTest::mouseClick(withText<QPushButton>(window(), "Change as Mine"), Qt::LeftButton);
    QCoreApplication::processEvents();
    window().grab().save(folder + "/Applications-own.png");
    withText<QPushButton>(window(), "Add")->menu()->actions().at(1)->trigger();
    QApplication::activeModalWidget()->grab().save(folder + "/Chooser.png");
    delete QApplication::activeModalWidget();
}

}  // namespace
}  // namespace plume
