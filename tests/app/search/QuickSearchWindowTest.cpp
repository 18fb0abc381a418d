#include "app/search/QuickSearchWindow.h"

#include <gtest/gtest.h>

#include <QAccessible>
#include <QClipboard>
#include <QLabel>
#include <QLineEdit>
#include <QListView>
#include <QMenu>
#include <QMimeData>
#include <QStackedWidget>
#include <QToolButton>

#include "library/KnownSettings.h"
#include "library/MemoryUserDefaults.h"
#include "tests/app/search/SearchSupport.h"

namespace plume {
namespace {

using test::addGroup;
using test::addSnippet;
using test::pressKey;

class QuickSearchWindowTest : public testing::Test {
  protected:
    QuickSearchWindowTest() {
        settings.registerDefaults(registeredSettings("/backups"));
        window.setEvents({.shown = [this](std::uint32_t) { told.emplace_back("shown"); },
                          .placed = [this](const Rectangle& frame) { frames.push_back(frame); },
                          .closed = [this] { told.emplace_back("closed"); },
                          .replaced = [this] { told.emplace_back("replaced"); },
                          .stayed = [this] { told.emplace_back("stayed"); }});
    }
    // Three that hold the letters, and three that are like them.
    void fill() {
        for (const char16_t* name : {u"alpha", u"alpine", u"alps"}) addSnippet(*mail, name, u"content of it");
    }
    void open(const std::u16string& query = u"", std::int64_t modifier = 3) {
        window.show({.place = {}, .query = query, .selectorKeyModifier = modifier});
        QCoreApplication::processEvents();
        told.clear();
    }
    QLineEdit& field() { return *window.findChild<QLineEdit*>(); }
    QListView& list() { return *window.findChild<QListView*>(); }
    QTextBrowser& preview() { return *window.findChild<QTextBrowser*>(); }
    QToolButton& options() { return *window.findChild<QToolButton*>(QString(), Qt::FindDirectChildrenOnly); }
    void key(int code, Qt::KeyboardModifiers modifiers = {}) {
        QTest::keyClick(&field(), static_cast<Qt::Key>(code), modifiers);
    }
    void type(const char* text) { field().setText(QString::fromUtf8(text)); }
    std::string rows() {
        std::string names;
        for (int row = 0; row < list().model()->rowCount(); ++row) {
            const SnippetRow shown = test::rowAt(*list().model(), row);
            names += (names.empty() ? "" : " ") + (shown.isDivider ? "--" : shown.abbreviation.text.toStdString());
        }
        return names;
    }
    std::string selected() { return list().currentIndex().data().toString().toStdString(); }
    std::string nothing() {
        auto* shown = qobject_cast<QLabel*>(window.findChild<QStackedWidget*>()->currentWidget());
        return shown ? shown->text().toStdString() : "";
    }

    SnippetGroups groups;
    const std::shared_ptr<SnippetGroup> mail = addGroup(groups, u"Mail");
    MemoryUserDefaults settings;
    std::vector<std::string> told;
    std::vector<Rectangle> frames;
    std::vector<std::shared_ptr<Snippet>> sent;
    std::vector<std::shared_ptr<Snippet>> edited;
    std::vector<std::shared_ptr<Snippet>> firstRows;
    std::function<void(const std::optional<std::u16string>&)> clipboardAnswer;
    QuickSearchWindow window{{.groups = [this]() -> const SnippetGroups& { return groups; },
                              .settings = settings,
                              .uses = nullptr,
                              .send = [this](const auto& snippet) { sent.push_back(snippet); },
                              .edit = [this](const auto& snippet) { edited.push_back(snippet); },
                              .setFirstRows = [this](const auto& snippets) { firstRows = snippets; },
                              .readClipboard = [this](auto answer) { clipboardAnswer = std::move(answer); }}};
};

// ---- Keys ----

TEST_F(QuickSearchWindowTest, KeysMoveOverTheDivider) {
    for (const char16_t* name : {u"signal", u"sigma", u"s_i_g_n"}) addSnippet(*mail, name, u"x");
    addSnippet(*mail, u"singal", u"x");
    open(u"signal");
    ASSERT_EQ(rows(), "signal -- singal");
    const struct {
        int key;
        const char* selected;
    } steps[] = {
        {Qt::Key_Up, "signal"},  {Qt::Key_Down, "singal"}, {Qt::Key_Down, "singal"},     {Qt::Key_Up, "signal"},
        {Qt::Key_End, "singal"}, {Qt::Key_Home, "signal"}, {Qt::Key_PageDown, "singal"}, {Qt::Key_PageUp, "signal"},
    };
    EXPECT_EQ(selected(), "signal");
    for (const auto& step : steps) {
        key(step.key);
        EXPECT_EQ(selected(), step.selected) << step.key;
    }
    type("singla");
    ASSERT_EQ(rows().substr(0, 3), "-- ");
    const std::string first = selected();
    EXPECT_NE(first, "Similar");
    for (const int back : {Qt::Key_Up, Qt::Key_PageUp, Qt::Key_Home}) {
        key(back);
        EXPECT_EQ(selected(), first) << "nothing is above the divider";
    }
}

TEST_F(QuickSearchWindowTest, PagesAreWhatIsInSight) {
    for (int i = 0; i < 60; ++i) addSnippet(*mail, u"name" + fromUtf8(std::to_string(i)), u"x");
    open(u"name");
    int last = 0;
    for (int page = 0; page < 10; ++page) {
        key(Qt::Key_PageDown);
        const int row = list().currentIndex().row();
        EXPECT_TRUE(list().viewport()->rect().contains(list().visualRect(list().currentIndex()))) << row;
        EXPECT_TRUE(row > last + 3 || row == 59) << row;
        last = row;
    }
    EXPECT_EQ(last, 59);
    type("name1");
    EXPECT_EQ(list().currentIndex().row(), 0) << "each key puts the selection on the first row";
}

TEST_F(QuickSearchWindowTest, ReturnSendsWhatIsSelected) {
    fill();
    for (const Qt::Key enter : {Qt::Key_Return, Qt::Key_Enter}) {
        open(u"alp");
        key(Qt::Key_Down);
        const auto chosen = selected();
        key(enter);
        ASSERT_FALSE(sent.empty());
        EXPECT_EQ(toUtf8(*sent.back()->abbreviation()), chosen);
        EXPECT_FALSE(window.isVisible());
        EXPECT_TRUE(told.empty()) << "the other side hears of it by what is sent";
    }
    open(u"nothing like it");
    key(Qt::Key_Return);
    EXPECT_EQ(sent.size(), 2U);
    EXPECT_TRUE(window.isVisible());
    EXPECT_EQ(told, std::vector<std::string>{"stayed"});
}

TEST_F(QuickSearchWindowTest, AClickSends) {
    fill();
    open(u"alp");
    QTest::mouseClick(list().viewport(), Qt::LeftButton, {}, list().visualRect(list().model()->index(2, 0)).center());
    ASSERT_EQ(sent.size(), 1U);
    EXPECT_FALSE(window.isVisible());
}

TEST_F(QuickSearchWindowTest, EscapeClearsAndThenCloses) {
    fill();
    open(u"alp");
    key(Qt::Key_Escape);
    EXPECT_EQ(field().text(), QString());
    EXPECT_EQ(rows(), "alps alpine alpha") << "as without a query";
    EXPECT_EQ(told, std::vector<std::string>{"stayed"});
    key(Qt::Key_Escape);
    EXPECT_FALSE(window.isVisible());
    EXPECT_EQ(told.back(), "closed");
    open(u"alp");
    key(Qt::Key_W, Qt::ControlModifier);
    EXPECT_EQ(told, std::vector<std::string>{"closed"});
}

TEST_F(QuickSearchWindowTest, ControlReturnCopiesWhatWouldBeSent) {
    QGuiApplication::clipboard()->setText(QStringLiteral("before"));
    addSnippet(*mail, u"quote", u"“【clipboard】”");
    open(u"quote");
    clipboardAnswer(u"copied earlier");
    key(Qt::Key_Return, Qt::ControlModifier);
    EXPECT_EQ(QGuiApplication::clipboard()->text(), QStringLiteral("“copied earlier”"));
    EXPECT_EQ(told, std::vector<std::string>{"closed"});
    EXPECT_TRUE(sent.empty());
    open(u"no such");
    key(Qt::Key_Return, Qt::ControlModifier);
    EXPECT_TRUE(window.isVisible());
    EXPECT_EQ(told, std::vector<std::string>{"stayed"});
}

TEST_F(QuickSearchWindowTest, ControlEEdits) {
    fill();
    open(u"alps");
    key(Qt::Key_E, Qt::ControlModifier);
    ASSERT_EQ(edited.size(), 1U);
    EXPECT_EQ(edited.front()->abbreviation(), u"alps");
    EXPECT_EQ(told, std::vector<std::string>{"replaced"}) << "the keyboard is for the editing now";
}

TEST_F(QuickSearchWindowTest, DigitsPickWithWhatIsHeldForIt) {
    for (int i = 0; i < 12; ++i) addSnippet(*mail, u"name" + fromUtf8(std::to_string(i)), u"x");
    constexpr Qt::KeyboardModifiers None = Qt::NoModifier;
    const struct {
        const char* what;
        std::int64_t setting;
        int key;
        Qt::KeyboardModifiers held;
        quint32 scanCode;
        int row;  // -1: none
    } cases[] = {
        {"1", 0, Qt::Key_1, None, 10, 0},
        {"0", 0, Qt::Key_0, None, 19, 9},
        {"2 of the keypad", 0, Qt::Key_2, Qt::KeypadModifier, 88, 1},
        {"a letter", 0, Qt::Key_A, None, 38, -1},
        {"Shift+1, an exclamation mark", 1, Qt::Key_Exclam, Qt::ShiftModifier, 10, 0},
        {"Shift+7, a slash", 1, Qt::Key_Slash, Qt::ShiftModifier, 16, 6},
        {"an exclamation mark of its own", 1, Qt::Key_Exclam, Qt::ShiftModifier, 61, -1},
        {"1 alone", 1, Qt::Key_1, None, 10, -1},
        {"Control+3", 2, Qt::Key_3, Qt::ControlModifier, 12, 2},
        {"Alt+0", 3, Qt::Key_0, Qt::AltModifier, 19, 9},
        {"Alt+Shift+1", 3, Qt::Key_Exclam, Qt::AltModifier | Qt::ShiftModifier, 10, -1},
        {"Super+4", 4, Qt::Key_4, Qt::MetaModifier, 13, 3},
        {"an unknown setting", 9, Qt::Key_1, None, 10, -1},
    };
    for (const auto& each : cases) {
        SCOPED_TRACE(each.what);
        sent.clear();
        open(u"name", each.setting);
        const auto expected = each.row < 0 ? nullptr : firstRows.at(static_cast<std::size_t>(each.row));
        pressKey(field(), each.key, each.held, each.scanCode, {});
        EXPECT_EQ(sent.empty() ? nullptr : sent.front(), expected);
        EXPECT_EQ(window.isVisible(), !expected);
    }
    open(u"name11", 0);
    const std::size_t found = firstRows.size();
    pressKey(field(), Qt::Key_9, None, 18, QStringLiteral("9"));
    EXPECT_LT(found, 9U);
    EXPECT_EQ(field().text(), QStringLiteral("9")) << "a digit that picks nothing is typed, over the selected query";
    EXPECT_EQ(told, std::vector<std::string>{"stayed"});
}

// What it says too often lets keys through that should wait; what it says too seldom keeps them back for a second.
TEST_F(QuickSearchWindowTest, TellsOfKeysThatMightHaveEndedTheSearch) {
    fill();
    const struct {
        const char* what;
        int key;
        Qt::KeyboardModifiers held;
        quint32 scanCode;
        bool tells;
    } cases[] = {
        {"a letter", Qt::Key_A, {}, 38, false},
        {"w", Qt::Key_W, {}, 25, false},
        {"Down", Qt::Key_Down, {}, 116, false},
        {"a digit", Qt::Key_5, {}, 14, true},
        {"a digit with Shift", Qt::Key_Percent, Qt::ShiftModifier, 14, true},
        {"Return that finds nothing", Qt::Key_Return, {}, 36, true},
        {"Control+E that finds nothing", Qt::Key_E, Qt::ControlModifier, 26, true},
        {"Escape that clears", Qt::Key_Escape, {}, 9, true},
    };
    for (const auto& each : cases) {
        open(u"no such thing");
        pressKey(field(), each.key, each.held, each.scanCode, {});
        EXPECT_EQ(told.size(), each.tells ? 1U : 0U) << each.what;
    }
}

TEST_F(QuickSearchWindowTest, AnswersKeysWhereverTheFocusIs) {
    fill();
    open(u"alp");
    QTest::keyClick(&options(), Qt::Key_1);
    EXPECT_EQ(told, std::vector<std::string>{"stayed"});
    QTest::keyClick(&options(), Qt::Key_Escape);
    QTest::keyClick(&options(), Qt::Key_Escape);
    EXPECT_FALSE(window.isVisible());
    EXPECT_EQ(told.back(), "closed");
    open(u"alp");
    options().menu()->popup({10, 10});
    QTest::keyClick(options().menu(), Qt::Key_Escape);
    EXPECT_FALSE(options().menu()->isVisible());
    EXPECT_TRUE(window.isVisible());
    EXPECT_EQ(told, std::vector<std::string>{"stayed"});
}

// ---- What is found ----

TEST_F(QuickSearchWindowTest, SaysWhenThereIsNothing) {
    open();
    EXPECT_EQ(nothing(), "You have no snippets yet.");
    fill();
    open();
    EXPECT_EQ(nothing(), "");
    EXPECT_EQ(rows(), "alps alpine alpha");
    EXPECT_EQ(firstRows.size(), 3U);
    type("no such thing");
    EXPECT_EQ(nothing(), "Nothing was found.");
    EXPECT_EQ(preview().toPlainText(), QString());
    EXPECT_TRUE(firstRows.empty());
}

TEST_F(QuickSearchWindowTest, TheMenuSaysWhereItLooks) {
    addSnippet(*mail, u"abb", u"the content", u"the label");
    open();
    QMenu& menu = *options().menu();
    const auto choose = [&](int action) {
        menu.popup({10, 10});
        menu.actions().at(action)->trigger();
        menu.hide();
    };
    const auto found = [&](const char* query) {
        type(query);
        return rows() == "abb";
    };
    EXPECT_TRUE(found("abb") && found("the content") && found("the label"));
    choose(1);
    EXPECT_FALSE(found("content"));
    choose(2);
    EXPECT_FALSE(found("the label"));
    EXPECT_TRUE(found("abb"));
    menu.popup({10, 10});
    EXPECT_TRUE(menu.actions().at(0)->isChecked());
    EXPECT_FALSE(menu.actions().at(0)->isEnabled()) << "the last field stays";
    menu.hide();
    EXPECT_EQ(settings.integerForKey("SnippetQuickSearchSearchBy") & 7, 1);
    choose(4);
    EXPECT_EQ(settings.integerForKey("SnippetQuickSearchWildcardSearch"), 1);
    choose(0);
    EXPECT_EQ(settings.integerForKey("SnippetQuickSearchSearchBy") & 7, 1) << "an action that is disabled";
}

// A click in the menu is none outside the window.
TEST_F(QuickSearchWindowTest, ItsFrameHoldsTheMenuWhileThatIsOpen) {
    open();
    QCoreApplication::processEvents();
    const Rectangle alone = frames.back();
    const double ratio = window.devicePixelRatioF();
    EXPECT_EQ(alone.size, (Size{window.width() * ratio, window.height() * ratio}));
    QMenu& menu = *options().menu();
    menu.popup(window.geometry().bottomLeft() - QPoint(30, 0));
    QCoreApplication::processEvents();
    EXPECT_EQ(frames.back().origin.x, menu.x() * ratio);
    EXPECT_EQ(frames.back().origin.y + frames.back().size.height, (menu.y() + menu.height()) * ratio);
    menu.hide();
    QCoreApplication::processEvents();
    EXPECT_EQ(frames.back(), alone);
}

// ---- How it will come out ----

TEST_F(QuickSearchWindowTest, ThePreviewRunsNothing) {
    addSnippet(*mail, u"run", u"touch /tmp/x", u"", ContentType::ShellScript);
    addSnippet(*mail, u"dear", u"Dear 【field:name】, it is 【snippet:run】, “【clipboard】”");
    auto rich = std::make_shared<Snippet>(u"rich", u"");
    TextAttributes bold;
    bold.font = FontAttribute{u"Sans", 12, true, false};
    rich->setRichTextContent(AttributedString(u"bold", std::make_shared<const TextAttributes>(bold)));
    rich->setContentType(ContentType::RichText);
    mail->addItem(rich);
    addSnippet(*mail, u"huge", std::u16string(300'000, u'x'));
    const auto remark = [this] {
        const auto* label = preview().parentWidget()->findChild<QLabel*>();
        return label->isVisible() ? label->text().toStdString() : "";
    };
    open(u"dear");
    EXPECT_EQ(preview().toPlainText(), QStringLiteral("Dear [name], it is [run], “”"));
    clipboardAnswer(u"C");
    EXPECT_EQ(preview().toPlainText(), QStringLiteral("Dear [name], it is [run], “C”"));
    EXPECT_EQ(remark(), "");
    type("run");
    EXPECT_EQ(preview().toPlainText(), QStringLiteral("touch /tmp/x"));
    EXPECT_EQ(remark(), "A script: what it prints is inserted.");
    type("rich");
    EXPECT_EQ(remark(), "");
    EXPECT_TRUE(preview().toHtml().contains(QStringLiteral("font-weight")));
    type("huge");
    EXPECT_EQ(preview().toPlainText().size(), 4001);
    key(Qt::Key_Return, Qt::ControlModifier);
    EXPECT_EQ(QGuiApplication::clipboard()->text().size(), 300'000);
    open(u"rich");
    key(Qt::Key_Return, Qt::ControlModifier);
    EXPECT_TRUE(QGuiApplication::clipboard()->mimeData()->hasHtml());
    EXPECT_EQ(QGuiApplication::clipboard()->text(), QStringLiteral("bold"));
}

// ---- Coming and going ----

TEST_F(QuickSearchWindowTest, KeepsNothingOnceItIsClosed) {
    addSnippet(*mail, u"quote", u"“【clipboard】”");
    open(u"quote");
    const auto lateAnswer = clipboardAnswer;
    window.close();
    EXPECT_TRUE(told.empty()) << "the other side closed it";
    lateAnswer(u"secret");
    EXPECT_EQ(field().text(), QString());
    EXPECT_EQ(rows(), "");
    EXPECT_EQ(preview().toPlainText(), QString());
    EXPECT_FALSE(field().isUndoAvailable());
    open(u"quote");
    EXPECT_EQ(preview().toPlainText(), QStringLiteral("“”"));
    lateAnswer(u"now");
    EXPECT_EQ(preview().toPlainText(), QStringLiteral("“now”"));
}

TEST_F(QuickSearchWindowTest, BeginsAnewEachTime) {
    fill();
    window.show({.place = CaretPlace{CaretPlace::Kind::Caret, {{60, 60}, {0, 16}}}, .query = u"alp"});
    EXPECT_EQ(told, std::vector<std::string>{"shown"});
    EXPECT_EQ(window.pos(), QPoint(60, 80));
    EXPECT_EQ(field().selectedText(), QStringLiteral("alp")) << "what is typed now takes its place";
    addSnippet(*mail, u"alpaca", u"new");
    open(u"");
    EXPECT_NE(window.pos(), QPoint(60, 80));
    EXPECT_EQ(field().text(), QString());
    EXPECT_EQ(list().model()->rowCount(), 4);
}

// The program that ends closes all of its windows first.
TEST_F(QuickSearchWindowTest, DoesNotKeepTheProgramFromEnding) {
    open();
    EXPECT_TRUE(window.QWidget::close());
    EXPECT_FALSE(window.isVisible());
    EXPECT_EQ(told, std::vector<std::string>{"closed"});
}

TEST_F(QuickSearchWindowTest, WhatTakesTheFocusHasAName) {
    open();
    for (QWidget* each : window.findChildren<QWidget*>()) {
        if (!each->isVisible() || each->focusPolicy() == Qt::NoFocus || each->objectName().startsWith("qt_")) continue;
        QAccessibleInterface* seen = QAccessible::queryAccessibleInterface(each);
        EXPECT_FALSE(seen->text(QAccessible::Name).isEmpty()) << each->metaObject()->className();
    }
    EXPECT_EQ(list().accessibleName(), QStringLiteral("Found snippets"));
    EXPECT_TRUE(window.isAncestorOf(window.focusWidget()));
}

TEST_F(QuickSearchWindowTest, PictureOfAnExample) {
    const auto work = addGroup(groups, u"Work", u";");
    addSnippet(*work, u"inv", u"Please find our invoice attached.\nIt is due within 30 days.\n\nKind regards\nJo Doe",
               u"Invoice to a customer");
    addSnippet(*work, u"rem", u"This is a reminder that our invoice is still open.\n\nKind regards", u"Reminder");
    addSnippet(*mail, u"paid", u"Thank you, your invoice was paid today.");
    addSnippet(*mail, u"invite", u"You are invited to our voice lessons.", u"Invitation");
    addSnippet(*work, u"in_voice", u"of a partner in Lyon");
    open(u"invoice");
    test::takePicture(window, QStringLiteral("QuickSearchExample"));
}

TEST_F(QuickSearchWindowTest, Pictures) {
    const auto work = addGroup(groups, u"A group for work with a rather long name", u";");
    addSnippet(*mail, u"sig", u"Kind regards\nAnn Example", u"Signature");
    addSnippet(*work, u"signoff", u"Yours faithfully,\nAnn Example\n\n【field:Company】",
               u"Formal signature for letters");
    addSnippet(*work, u"design", u"The design of signals in a long line that goes on and on until it does not fit");
    addSnippet(*mail, u"isgn", u"signed on 【date:yyyy-MM-dd】");
    addSnippet(*mail, u"run", u"date --iso | sed s/x/y/ # sign", u"", ContentType::ShellScript);
    addSnippet(*mail, u"חתימה", u"בברכה sign", u"חתימה");
    addSnippet(*mail, u"s_i_g_n", u"x");
    open(u"sign");
    test::takePicture(window, QStringLiteral("QuickSearch"));
    type("run");
    test::takePicture(window, QStringLiteral("QuickSearchScript"));
    type("nothing");
    test::takePicture(window, QStringLiteral("QuickSearchNothing"));
    options().menu()->popup({10, 10});
    test::takePicture(*options().menu(), QStringLiteral("QuickSearchMenu"));
    options().menu()->hide();
    const test::RightToLeft layout;
    open(u"sign");
    test::takePicture(window, QStringLiteral("QuickSearch-rtl"));
}

}  // namespace
}  // namespace plume
