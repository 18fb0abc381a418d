// Each page's controls, and the settings behind them.
#include <gtest/gtest.h>

#include <QCheckBox>
#include <QComboBox>
#include <QDir>
#include <QGroupBox>
#include <QLabel>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QScopeGuard>
#include <QSpinBox>
#include <QTreeView>
#include <QWheelEvent>

#include "app/preferences/HotKeyRecorder.h"
#include "tests/app/preferences/PreferencesSupport.h"
#include "tests/support/TemporaryFolder.h"

namespace plume {
namespace {

using test::named;
using test::withText;

class PreferencesPagesTest : public test::PreferencesWindowTest {};

// ---- Controls and settings ----

struct Box {
    const char* page;
    const char* text;
    const char* key;
};

TEST_F(PreferencesPagesTest, BoxesChangeAndFollowTheirSettings) {
    for (const Box& each : {
             Box{"General", "Expand abbreviations", "IsEnabled"},
             {"General", "Show the icon in the panel", "ShowStatusIcon"},
             {"General", "Play a sound with every expansion", "PlayFeedbackSound"},
             {"Expansion", "Mixed case gives every word a capital", "SnippetAdaptToAbbreviationCaseOption"},
             {"Expansion", "A mouse click ends the abbreviation", "ListenMouseDownEvents"},
             {"Expansion", "Let programs tell which fields are for passwords", "LetProgramsTellPasswordFields"},
             {"Search", "Wildcards in quick search", "SnippetQuickSearchWildcardSearch"},
             {"Typing", "Paste texts instead of typing them", "UseClipboard"},
             {"Typing", "Paste long texts everywhere", "UseClipboardForLongText"},
             {"Typing", "Give back what was copied after a paste", "RestoreClipboard"},
             {"Correction", "Begin every sentence with a capital", "CapitalizeNewSentences"},
             {"Correction", "Correct two capitals at the start of a word", "CorrectDoubleCapitals"},
             {"Backups", "Keep the library in step with other computers", "SyncEnabled"},
             {"Backups", "Some settings go along", "SyncPreferences"},
         }) {
        SCOPED_TRACE(each.key);
        window().showPage(each.page);
        auto* box = withText<QCheckBox>(window(), each.text);
        ASSERT_TRUE(box);
        const bool before = settings.boolForKey(each.key);
        EXPECT_EQ(box->isChecked(), before);
        box->setFocus();
        QTest::keyClick(box, Qt::Key_Space);
        EXPECT_EQ(settings.boolForKey(each.key), !before);
        (void)settings.removeObject(each.key);
        EXPECT_EQ(box->isChecked(), before);
    }
    EXPECT_EQ(syncChanges, 2) << "only the user's own changes are told";
}

struct Choice {
    const char* page;
    const char* name;
    const char* key;
    QStringList choices;
    int first = 0;
};

TEST_F(PreferencesPagesTest, ChoicesKeepTheirCodes) {
    const QStringList programs{"In all programs", "In all programs except those below", "Only in the programs below"};
    for (const Choice& each : {
             Choice{"Search",
                    "Key held to pick with a digit:",
                    "SnippetSelectorKeyModifier",
                    {"None", "Shift", "Control", "Alt", "Super"}},
             {"Typing", "Paste:", "UseClipboardIn", programs},
             {"Correction", "Correct:", "AutoCorrectIn", programs},
             {"Correction",
              "Keyboard layouts:",
              "AutoCorrectInputMethodsOption",
              {"With all layouts", "With all layouts except those below", "Only with the layouts below"}},
             {"Backups",
              "Back up:",
              "AutoBackupInterval",
              {"Never", "Every hour", "Every day", "Every week", "Every 30 days"}},
         }) {
        SCOPED_TRACE(each.key);
        window().showPage(each.page);
        auto* box = named<QComboBox>(window(), each.name);
        ASSERT_TRUE(box);
        for (int i = box->count() - 1; i >= 0; --i) {
            EXPECT_EQ(box->itemText(i), each.choices.value(i));
            box->setCurrentIndex(i);
            EXPECT_EQ(settings.integerForKey(each.key), i);
            (void)settings.setObject(each.key, std::int64_t{0});
            (void)settings.setObject(each.key, std::int64_t{i});
            EXPECT_EQ(box->currentIndex(), i);
        }
        (void)settings.setObject(each.key, std::int64_t{77});
        EXPECT_NE(box->currentText(), each.choices.last());
        EXPECT_EQ(settings.integerForKey(each.key), 77) << "showing a value changes none";
    }
}

TEST_F(PreferencesPagesTest, NumbersAreKeptWhenTheyAreFinishedAndStayInTheirLimits) {
    window().showPage("Typing");
    auto* length = named<QSpinBox>(window(), "Long from:");
    ASSERT_TRUE(length);
    length->setFocus();
    length->selectAll();
    QTest::keyClicks(length, "50");
    EXPECT_EQ(settings.integerForKey("LongTextLength"), 100);
    QTest::keyClick(length, Qt::Key_Return);
    EXPECT_EQ(settings.integerForKey("LongTextLength"), 50);
    EXPECT_EQ(std::pair(length->minimum(), length->maximum()), std::pair(1, 127));
    (void)settings.setObject("LongTextLength", std::int64_t{5'000'000'000});
    EXPECT_EQ(length->text(), "127 characters");
    length->setValue(1);
    EXPECT_EQ(length->text(), "1 character");
    auto* delay = named<QDoubleSpinBox>(window(), "Give it back after:");
    ASSERT_TRUE(delay);
    EXPECT_EQ(delay->value(), 0.4);
    delay->setValue(1.25);
    EXPECT_EQ(settings.doubleForKey("RestoreClipboardDelay"), 1.25);
}

TEST_F(PreferencesPagesTest, TheWheelChangesNothingOnItsWay) {
    window().showPage("Typing");
    const auto turn = [](QWidget* over) {
        QWheelEvent event(QPointF(4, 4), over->mapToGlobal(QPointF(4, 4)), {}, {0, 120}, Qt::NoButton, Qt::NoModifier,
                          Qt::NoScrollPhase, false);
        QApplication::sendEvent(over, &event);
    };
    auto* length = named<QSpinBox>(window(), "Long from:");
    turn(length);
    turn(named<QComboBox>(window(), "Paste:"));
    EXPECT_TRUE(settings.ownKeys().empty());
    length->setFocus();
    turn(length);
    EXPECT_EQ(settings.integerForKey("LongTextLength"), 101);
}

TEST_F(PreferencesPagesTest, LinesAreKeptWhenTheFieldIsLeftAndWhenTheWindowGoes) {
    window().showPage("Correction");
    auto* lines = named<QPlainTextEdit>(window(), "No sentence ends with:");
    ASSERT_TRUE(lines);
    EXPECT_EQ(lines->toPlainText(), "etc.\ne.g.\ni.e.");
    lines->setFocus();
    lines->selectAll();
    QTest::keyClicks(lines, "bzw.");
    QTest::keyClick(lines, Qt::Key_Tab);
    EXPECT_EQ(settings.stringForKey("CapitalizationExcludedAbbreviations"), u"bzw.");

    (void)settings.setObject("AutoCorrectInputMethodsOption", std::int64_t{1});
    auto* layouts = named<QPlainTextEdit>(window(), "Layouts:");
    layouts->setPlainText(" us \n\nde(nodeadkeys)");
    delete window_;
    const auto kept = settings.stringArrayForKey("AutoCorrectInputMethods");
    EXPECT_EQ(kept, (std::vector<std::u16string>{u"us", u"de(nodeadkeys)"}));
}

TEST_F(PreferencesPagesTest, ASearchLooksInOneFieldAtLeast) {
    window().showPage("Search");
    const auto click = [&](const char* text) {
        QTest::mouseClick(withText<QCheckBox>(window(), text), Qt::LeftButton);
    };
    click("Abbreviations");
    EXPECT_EQ(settings.integerForKey("SnippetQuickSearchSearchBy") & 7, 6);
    EXPECT_EQ(settings.integerForKey("MainWindowSearchBy") & 7, 7);
    click("Contents");
    EXPECT_FALSE(withText<QCheckBox>(window(), "Labels")->isEnabled());
    EXPECT_EQ(settings.integerForKey("SnippetQuickSearchSearchBy") & 7, 4);
}

TEST_F(PreferencesPagesTest, UsesAreForgottenAndThatIsSeen) {
    window().showPage("Search");
    auto* button = withText<QPushButton>(window(), "Forget How Often Snippets Were Used");
    forgetAnswer = Error{"The disk is full."};
    QTest::mouseClick(button, Qt::LeftButton);
    EXPECT_TRUE(complaint().contains("The disk is full."));
    EXPECT_TRUE(button->isEnabled());
    forgetAnswer = {};
    QTest::mouseClick(button, Qt::LeftButton);
    EXPECT_EQ(complaint(), "");
    EXPECT_EQ(forgotten, 2);
    EXPECT_FALSE(button->isEnabled()) << "nothing is left to forget";
    window().showPage("General");
    window().showPage("Search");
    EXPECT_TRUE(button->isEnabled()) << "there may be something again";
}

TEST_F(PreferencesPagesTest, WhatCannotBeKeptIsToldAndTheControlGoesBack) {
    settings.isFull = true;
    auto* box = withText<QCheckBox>(window(), "Expand abbreviations");
    QTest::mouseClick(box, Qt::LeftButton, {}, QPoint(8, box->height() / 2));
    EXPECT_TRUE(box->isChecked());
    EXPECT_TRUE(complaint().contains("The disk is full."));
    startAtLoginAnswer = Error{"No folder."};
    auto* login = withText<QCheckBox>(window(), "Start Plume when I log in");
    QTest::mouseClick(login, Qt::LeftButton, {}, QPoint(8, login->height() / 2));
    EXPECT_FALSE(login->isChecked());
    EXPECT_TRUE(complaint().contains("No folder."));
    settings.isFull = false;
    QTest::mouseClick(box, Qt::LeftButton, {}, QPoint(8, box->height() / 2));
    EXPECT_FALSE(box->isChecked());
    EXPECT_EQ(complaint(), "");
}

TEST_F(PreferencesPagesTest, ASoundIsHeardWhenItIsChosenAndTried) {
    auto* sounds = named<QComboBox>(window(), "Sound");
    sounds->setFocus();
    QTest::keyClick(sounds, Qt::Key_Down);
    EXPECT_EQ(settings.stringForKey("FeedbackSound"), u"Pop");
    QTest::mouseClick(withText<QPushButton>(window(), "Test"), Qt::LeftButton);
    EXPECT_EQ(played, (std::vector<std::string>{"Pop", "Pop"}));
}

TEST_F(PreferencesPagesTest, DefaultsOfOnePageComeBackAfterAQuestion) {
    (void)settings.setObject("LongTextLength", std::int64_t{7});
    (void)settings.setObject("IsEnabled", false);
    window().showPage("Typing");
    auto* restore = withText<QPushButton>(window(), "Restore Defaults");
    QTest::mouseClick(restore, Qt::LeftButton);
    answer("Cancel");
    EXPECT_EQ(settings.integerForKey("LongTextLength"), 7);
    QTest::mouseClick(restore, Qt::LeftButton);
    answer("Restore Defaults");
    EXPECT_EQ(settings.integerForKey("LongTextLength"), 100);
    EXPECT_FALSE(settings.boolForKey("IsEnabled"));
    window().showPage("ImportExport");
    EXPECT_FALSE(restore->isVisible());
}

TEST_F(PreferencesPagesTest, HotKeysOfOnePageKnowOfEachOther) {
    window().showPage("HotKeys");
    const auto record = [&](const char* name, const GeneralHotKey& hotKey) {
        auto* recorder = named<HotKeyRecorder>(window(), name);
        QTest::keyClick(recorder->focusProxy(), Qt::Key_Space);
        pressed(hotKey);
    };
    const GeneralHotKey keys{KeyModifier::Control | KeyModifier::Option, KeyCode::K};
    record("Quick search", keys);
    EXPECT_EQ(settings.integerForKey("quickSearchHotKey"), keys.getValue());
    record("Undo the last expansion", keys);
    EXPECT_FALSE(settings.hasKey("UndoHotKey"));
    EXPECT_TRUE(withText<QLabel>(window(), "Ctrl+Alt+K is the hot key of “Quick search” already."));
    (void)settings.removeObject("quickSearchHotKey");
    EXPECT_FALSE(named<HotKeyRecorder>(window(), "Quick search")->hotKey());
}

// ---- Backups and sync ----

TEST_F(PreferencesPagesTest, FoldersAreChosenByTheirNames) {
    delete window_;
    const TemporaryFolder home;
    const QByteArray usualHome = qgetenv("HOME");
    const auto restored = qScopeGuard([&] { qputenv("HOME", usualHome); });
    qputenv("HOME", home.path().c_str());
    QDir(QString::fromStdString(home.path().string())).mkdir("Dropbox");
    open();
    window().showPage("Backups");
    auto* folder = named<QComboBox>(window(), "Folder of backups");
    ASSERT_TRUE(folder);
    ASSERT_EQ(folder->count(), 3);
    EXPECT_EQ(folder->currentText(), "Default Directory");
    const auto choose = [](QComboBox* box, int index) {
        box->setCurrentIndex(index);
        Q_EMIT box->activated(index);
    };
    choose(folder, folder->findText("Dropbox"));
    const std::u16string dropbox = fromUtf8((home.path() / "Dropbox").string());
    EXPECT_EQ(settings.stringForKey("BackupDirectory"), dropbox);
    choose(folder, folder->findText("Default Directory"));
    EXPECT_EQ(settings.stringForKey("BackupDirectory"), u"/one/Backups");
    EXPECT_EQ(folder->currentText(), "Default Directory");
    (void)settings.setObject("SyncDirectoryType", std::int64_t{3});
    auto* shared = named<QComboBox>(window(), "Shared folder");
    EXPECT_EQ(shared->findText("Default Directory"), -1);
    choose(shared, 0);
    EXPECT_EQ(settings.stringForKey("SyncDirectory"), dropbox);
    EXPECT_EQ(settings.integerForKey("SyncDirectoryType"), 0);
    EXPECT_EQ(syncChanges, 1);
}

TEST_F(PreferencesPagesTest, ABackupIsMadeAndCounted) {
    window().showPage("Backups");
    EXPECT_TRUE(withText<QLabel>(window(), "There is no backup in this folder yet."));
    auto* now = withText<QPushButton>(window(), "Back Up Now");
    QTest::mouseClick(now, Qt::LeftButton);
    EXPECT_EQ(machine.backupNames().size(), 1u);
    world.files.setFreeBytes(1);
    QTest::mouseClick(now, Qt::LeftButton);
    EXPECT_TRUE(complaint().startsWith("No backup was made."));
    QTest::mouseClick(withText<QPushButton>(window(), "Restore…"), Qt::LeftButton);
    EXPECT_EQ(commands, std::vector<std::string>{"restore"});
}

// ---- Programs, and settings by their names ----

TEST_F(PreferencesPagesTest, AProgramGetsARowOfOnesOwn) {
    window().showPage("Applications");
    auto* view = named<QTreeView>(window(), "Programs");
    ASSERT_TRUE(view);
    named<QLineEdit>(window(), "Filter programs")->setText("kitty");
    view->setCurrentIndex(view->model()->index(0, 0));
    QTest::mouseClick(withText<QPushButton>(window(), "Change as Mine"), Qt::LeftButton);
    EXPECT_EQ(settings.stringForKey("CustomApplicationSettings"), uR"({"kitty":{"family":"terminal"}})");
    auto* keys = window().findChild<QGroupBox*>()->findChildren<QComboBox*>().at(1);
    keys->lineEdit()->setText("nonsense");
    Q_EMIT keys->lineEdit()->editingFinished();
    EXPECT_EQ(settings.stringForKey("CustomApplicationSettings"), uR"({"kitty":{"family":"terminal"}})");
    EXPECT_TRUE(keys->currentText().isEmpty());
    QTest::mouseClick(withText<QPushButton>(window(), "Remove"), Qt::LeftButton);
    EXPECT_FALSE(settings.hasKey("CustomApplicationSettings"));
    (void)settings.setObject("CustomApplicationSettings", std::u16string(u"[broken"));
    EXPECT_FALSE(withText<QPushButton>(window(), "Add")->isEnabled());
    EXPECT_EQ(settings.stringForKey("CustomApplicationSettings"), u"[broken");
}

TEST_F(PreferencesPagesTest, EverySettingCanBeWrittenAsText) {
    window().showPage("Advanced");
    auto* view = named<QTreeView>(window(), "All settings");
    ASSERT_TRUE(view);
    EXPECT_EQ(view->model()->rowCount(), int(knownSettings().size()));
    named<QLineEdit>(window(), "Filter settings")->setText("UseClipboardApp");
    ASSERT_EQ(view->model()->rowCount(), 1);
    const QModelIndex value = view->model()->index(0, 1);
    EXPECT_TRUE(view->model()->setData(value, R"(["xterm"])"));
    EXPECT_EQ(settings.stringArrayForKey("UseClipboardApplications"), std::vector<std::u16string>{u"xterm"});
    EXPECT_FALSE(view->model()->setData(value, "12"));
    EXPECT_TRUE(complaint().contains("UseClipboardApplications"));
    view->setCurrentIndex(value);
    QTest::mouseClick(withText<QPushButton>(window(), "Use Default"), Qt::LeftButton);
    EXPECT_FALSE(settings.hasKey("UseClipboardApplications"));
    EXPECT_EQ(value.data().toString(), "");
    EXPECT_EQ(syncChanges, 0);
    named<QLineEdit>(window(), "Filter settings")->setText("SyncDirectoryType");
    EXPECT_TRUE(view->model()->setData(view->model()->index(0, 1), "1"));
    EXPECT_EQ(syncChanges, 1);
}

}  // namespace
}  // namespace plume
