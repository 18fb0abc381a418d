#include "app/status/StatusMenu.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <QApplication>
#include <QDir>
#include <QScreen>
#include <QSet>
#include <QTest>
#include <algorithm>

#include "app/qt/ColorScheme.h"
#include "app/qt/Text.h"
#include "tests/app/status/MenuServices.h"
#include "tests/support/Language.h"

namespace plume {
namespace {

using testing::ElementsAre;

class StatusMenuTest : public testing::Test {
  protected:
    static void open(QMenu& menu) {
        menu.popup(QPoint(10, 10));
        ASSERT_TRUE(QTest::qWaitForWindowExposed(&menu));
    }

    // What a user reads, separators as "-".
    static std::vector<std::string> rows(const QMenu& menu) {
        std::vector<std::string> texts;
        for (const QAction* action : menu.actions()) {
            if (action->isVisible()) texts.push_back(action->isSeparator() ? "-" : read(action->text()));
        }
        return texts;
    }

    static std::string read(QString text) {
        text.replace(QLatin1String("&&"), QLatin1String("\n")).remove(QLatin1Char('&'));
        return text.replace(QLatin1Char('\n'), QLatin1Char('&')).toStdString();
    }

    static QAction* row(const QMenu& menu, const std::string& text) {
        for (QAction* action : menu.actions()) {
            if (read(action->text()) == text) return action;
        }
        ADD_FAILURE() << "No row " << text;
        return nullptr;
    }

    static QMenu& submenu(const QMenu& menu, const std::string& text) {
        QMenu& found = *row(menu, text)->menu();
        Q_EMIT found.aboutToShow();
        return found;
    }

    void choose(QMenu& menu, const std::string& text) {
        row(menu, text)->trigger();
        EXPECT_TRUE(services_.asked.empty() && services_.sent.empty()) << "before its turn";
        QTest::qWait(1);
    }

    MenuServices services_;
};

TEST_F(StatusMenuTest, RowsStandInOrder) {
    services_.addGroup(u"R&D");
    services_.addGroup(u"Hidden").setShowInMenuBar(false);
    services_.addGroup(u"");
    StatusMenu menu(services_.services(), MenuHome::Widget);
    open(menu);
    EXPECT_THAT(rows(menu),
                ElementsAre("Enabled", "-", "R&D", "Untitled group", "-", "New Snippet…", "New Snippet from Clipboard…",
                            "New Snippet from Selection…", "Search Snippets…", "Edit Snippets…", "-", "Preferences…",
                            "Help and Tools", "Library", "-", "Quit Plume"));
    EXPECT_THAT(rows(submenu(menu, "Help and Tools")),
                ElementsAre("Why Didn't It Expand?", "Reports", "Diagnostics…", "Welcome…", "About Plume"));
    EXPECT_THAT(rows(submenu(menu, "Library")), ElementsAre("Import…", "Export…", "Restore…"));
}

TEST_F(StatusMenuTest, WindowsThatDoNotExistHaveNoRows) {
    StatusMenuServices few = services_.services();
    few.searchSnippets = nullptr;
    few.showMacrosWindow = nullptr;
    StatusMenu menu(few, MenuHome::Widget);
    open(menu);
    EXPECT_THAT(rows(menu), ElementsAre("Enabled", "-", "New Snippet…", "New Snippet from Clipboard…",
                                        "New Snippet from Selection…", "-", "Preferences…", "Help and Tools", "Library",
                                        "-", "Quit Plume"));
}

TEST_F(StatusMenuTest, MnemonicsAreUniqueInEachMenu) {
    StatusMenu menu(services_.services(), MenuHome::Widget);
    menu.setStatus({.keyboardIsLost = true});
    for (const QMenu* one : {static_cast<QMenu*>(&menu), &submenu(menu, "Library"), &submenu(menu, "Help and Tools")}) {
        QSet<QString> seen;
        for (const QAction* action : one->actions()) {
            if (action->isSeparator() || !action->isVisible()) continue;
            const QString key = QKeySequence::mnemonic(action->text()).toString();
            EXPECT_FALSE(key.isEmpty() || seen.contains(key)) << action->text().toStdString();
            seen << key;
        }
    }
}

TEST_F(StatusMenuTest, EveryRowAsksForWhatItSays) {
    StatusMenu menu(services_.services(), MenuHome::Widget);
    for (QMenu* one : {static_cast<QMenu*>(&menu), &submenu(menu, "Help and Tools"), &submenu(menu, "Library")}) {
        for (QAction* action : one->actions()) {
            if (!action->menu()) action->trigger();
        }
    }
    EXPECT_TRUE(services_.asked.empty());
    QTest::qWait(1);
    EXPECT_THAT(services_.asked, ElementsAre("toggle", "keyboard", "new", "clipboard", "selection", "search", "edit",
                                             "preferences", "quit", "decisions", "reports", "diagnostics", "welcome",
                                             "about", "import", "export", "restore"));
}

TEST_F(StatusMenuTest, FollowsTheStatusWhileItIsOpen) {
    StatusMenu menu(services_.services(), MenuHome::Widget);
    open(menu);
    EXPECT_TRUE(row(menu, "Enabled")->isChecked());
    menu.setStatus({.isEnabled = false,
                    .secureInput = true,
                    .secureInputStatus = u"“A & B” has secure input.",
                    .keyboardIsLost = true});
    EXPECT_FALSE(row(menu, "Enabled")->isChecked());
    EXPECT_FALSE(row(menu, "“A & B” has secure input.")->isEnabled());
    EXPECT_TRUE(row(menu, "Listen to the Keyboard Again")->isVisible());
    menu.setStatus({});
    EXPECT_EQ(rows(menu).at(1), "-");
}

TEST_F(StatusMenuTest, TheCheckMarkTellsTheStatusEvenIfTogglingChangedNothing) {
    StatusMenu menu(services_.services(), MenuHome::Widget);
    choose(menu, "Enabled");
    EXPECT_THAT(services_.asked, ElementsAre("toggle"));
    EXPECT_TRUE(row(menu, "Enabled")->isChecked());
}

TEST_F(StatusMenuTest, AGroupIsFilledWhenItIsOpenedAndOnceInAnOpening) {
    SnippetGroup& group = services_.addGroup(u"Letters", 2);
    StatusMenu menu(services_.services(), MenuHome::Widget);
    open(menu);
    EXPECT_TRUE(row(menu, "Letters")->menu()->isEmpty());
    EXPECT_THAT(rows(submenu(menu, "Letters")), ElementsAre("s0 — content 0", "s1 — content 1"));
    group.items().front()->setAbbreviation(u"new");
    EXPECT_THAT(rows(submenu(menu, "Letters")), ElementsAre("s0 — content 0", "s1 — content 1"));
    menu.close();
    services_.addGroup(u"Later");
    open(menu);
    EXPECT_THAT(rows(submenu(menu, "Letters")), ElementsAre("new — content 0", "s1 — content 1"));
    EXPECT_EQ(rows(menu).at(3), "Later");
}

TEST_F(StatusMenuTest, AChosenSnippetIsSentWhenNoMenuIsOpenAnyMore) {
    services_.addGroup(u"First", 1);
    services_.addGroup(u"Letters", 3);
    StatusMenu menu(services_.services(), MenuHome::Widget);
    open(menu);
    choose(submenu(menu, "Letters"), "s1 — content 1");
    EXPECT_TRUE(services_.sent.empty());
    menu.close();
    ASSERT_TRUE(QTest::qWaitFor([this] { return !services_.sent.empty(); }));
    EXPECT_THAT(services_.sent, ElementsAre("s1"));
}

TEST_F(StatusMenuTest, ALargeGroupIsReachedByRanges) {
    services_.addGroup(u"Many", 41);
    services_.addGroup(u"Thousands", 100'000);
    StatusMenu menu(services_.services(), MenuHome::Widget);
    open(menu);
    menu.close();
    QMenu& many = submenu(menu, "Many");
    EXPECT_THAT(rows(many), ElementsAre("s0 … s19", "s20 … s40"));
    EXPECT_EQ(rows(submenu(many, "s20 … s40")).size(), 21U);

    QMenu* range = &submenu(menu, "Thousands");
    int levels = 1;
    for (; range->actions().constLast()->menu(); ++levels) {
        EXPECT_LE(range->actions().size(), 63);
        range = range->actions().constLast()->menu();
        Q_EMIT range->aboutToShow();
    }
    EXPECT_EQ(levels, 4);
    EXPECT_EQ(rows(*range).back(), "s99999 — content 99999");
    range->actions().constLast()->trigger();
    QTest::qWait(1);
    EXPECT_THAT(services_.sent, ElementsAre("s99999"));
}

TEST_F(StatusMenuTest, MoreGroupsThanTheScreenIsHighAreScrolled) {
    for (int i = 0; i < 1000; ++i) services_.addGroup(u"Letters");
    StatusMenu menu(services_.services(), MenuHome::Widget);
    open(menu);
    EXPECT_EQ(menu.size().boundedTo(menu.screen()->size()), menu.size());
}

TEST_F(StatusMenuTest, AGroupThatIsGoneLeavesAnEmptyMenu) {
    services_.addGroup(u"Letters", 3);
    StatusMenu menu(services_.services(), MenuHome::Widget);
    open(menu);
    services_.library.clear();
    EXPECT_THAT(rows(submenu(menu, "Letters")), ElementsAre());
}

TEST_F(StatusMenuTest, TheFontGrowsBySoManyPoints) {
    services_.addGroup(u"Many", 41);
    services_.fontSizeDelta = 4;
    StatusMenu menu(services_.services(), MenuHome::Widget);
    open(menu);
    const double usual = QApplication::font("QMenu").pointSizeF();
    EXPECT_DOUBLE_EQ(menu.font().pointSizeF(), usual + 4);
    EXPECT_DOUBLE_EQ(submenu(submenu(menu, "Many"), "s0 … s19").font().pointSizeF(), usual + 4);
    menu.close();
    services_.fontSizeDelta = -1000;
    open(menu);
    EXPECT_DOUBLE_EQ(row(menu, "Many")->menu()->font().pointSizeF(), 6);
}

TEST_F(StatusMenuTest, OnTheBusRowsStayWhatTheyAreWhileNothingChanges) {
    SnippetGroup& group = services_.addGroup(u"A_B", 2);
    StatusMenu menu(services_.services(), MenuHome::Bus);
    QAction* title = row(menu, "A_B");
    ASSERT_NE(title, nullptr) << "there before the panel tells that it opens the menu";
    QAction* first = submenu(menu, "A_B").actions().constFirst();
    Q_EMIT menu.aboutToShow();
    EXPECT_EQ(row(menu, "A_B"), title);
    EXPECT_EQ(submenu(menu, "A_B").actions().constFirst(), first);
    // Panels do not always tell of an opening: what is asked for is up to date all the same.
    group.items().back()->setAbbreviation(u"new");
    EXPECT_THAT(rows(submenu(menu, "A_B")), ElementsAre("s0 — content 0", "new — content 1"));
}

TEST_F(StatusMenuTest, SpeaksOtherLanguages) {
    const QString folder = qEnvironmentVariable("PLUME_PICTURES");
    services_.addGroup(u"");
    for (const char* language : {"en", "de", "fr"}) {
        SCOPED_TRACE(language);
        const test::SpokenLanguage spoken(language);
        StatusMenu menu(services_.services(), MenuHome::Widget);
        menu.setStatus({.keyboardIsLost = true});
        open(menu);
        test::Mnemonics letters;
        for (const QAction* action : menu.actions()) {
            letters.add(action->text());
            if (!action->menu()) continue;
            test::Mnemonics own;
            for (const QAction* row : action->menu()->actions()) own.add(row->text());
            if (!folder.isEmpty() && !action->menu()->isEmpty())
                action->menu()->grab().save(folder + "/menu-" + language + "-" + action->text().at(1) + ".png");
        }
        if (!folder.isEmpty()) menu.grab().save(folder + "/menu-" + language + ".png");
        const bool isGerman = language == std::string("de");
        const std::vector<std::string> texts = rows(menu);
        EXPECT_EQ(std::count(texts.begin(), texts.end(), "Plume beenden"), isGerman ? 1 : 0);
        EXPECT_EQ(std::count(texts.begin(), texts.end(), "Unbenannte Gruppe"), isGerman ? 1 : 0);
    }
}

TEST_F(StatusMenuTest, Picture) {
    const QString folder = qEnvironmentVariable("PLUME_PICTURES");
    if (folder.isEmpty()) return;
    services_.addGroup(u"Letters & Co", 60);
    services_.addGroup(u"Signatures", 12).setAbbreviationPrefix(u";");
    for (const bool dark : {false, true}) {
        setColorScheme(dark);
        StatusMenu menu(services_.services(), MenuHome::Widget);
        menu.setStatus({.secureInput = true,
                        .secureInputStatus = u"Secure input is on in “Passwords”: nothing expands there.",
                        .keyboardIsLost = true});
        open(menu);
        QMenu& signatures = submenu(menu, "Signatures");
        open(signatures);
        const QString kind = dark ? QStringLiteral("dark") : QStringLiteral("light");
        EXPECT_TRUE(menu.grab().save(QDir(folder).filePath(QStringLiteral("status-menu-%1.png").arg(kind))));
        EXPECT_TRUE(signatures.grab().save(QDir(folder).filePath(QStringLiteral("status-rows-%1.png").arg(kind))));
    }
    setColorScheme(false);
}

}  // namespace
}  // namespace plume
