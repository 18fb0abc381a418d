#include "app/windows/DecisionsWindow.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <QApplication>
#include <QLabel>
#include <QPointer>
#include <QPushButton>
#include <QTest>
#include <QTreeView>
#include <algorithm>
#include <set>
#include <stdexcept>

#include "app/qt/Text.h"
#include "app/windows/DecisionWords.h"
#include "library/MemoryUserDefaults.h"
#include "tests/app/windows/WindowsSupport.h"

namespace plume {
namespace {

using Outcome = MatchDecision::Outcome;
using test::takePicture;

MatchDecision sigDecision(Outcome outcome, std::u16string detail = {}) {
    return {currentDate(), outcome, u";sig", u"Signatures", u"xterm", std::move(detail)};
}

TEST(DecisionWords, AreSentencesThatSayWhatToDo) {
    struct Case {
        MatchDecision decision;
        const char* sentence;
        bool hasAdvice;
    };
    const Date now = currentDate();
    const Case cases[] = {
        {sigDecision(Outcome::WrongApplication),
         "“;sig” (group Signatures) did not expand: the group is not meant for xterm.", true},
        {sigDecision(Outcome::WrongTextBefore, u"digits"),
         "“;sig” (group Signatures) did not expand: no number stood before it.", true},
        {sigDecision(Outcome::Expanded), "“;sig” (group Signatures) was expanded in xterm.", false},
        {{now, Outcome::Expanded, u"%1%2", u"%2%1", u"%1"}, "“%1%2” (group %2%1) was expanded in %1.", false},
        {{now, Outcome::WrongCase, u"<b>a\nb</b>", u""},
         "“<b>a b</b>” did not expand: its capital and small letters were typed differently.",
         true},
        {{now, Outcome::SwitchedOff}, "Plume was switched off.", true},
        {{now, Outcome::SecureInputEnded}, "Plume could hear the keyboard again.", false},
    };
    for (const Case& one : cases) {
        const DecisionWords words = DecisionWords::of(one.decision);
        EXPECT_EQ(words.sentence.toStdString(), one.sentence);
        EXPECT_EQ(!words.advice.isEmpty(), one.hasAdvice) << one.sentence;
    }
}

TEST(DecisionWords, HaveOneForEveryOutcome) {
    for (int outcome = 0; outcome <= static_cast<int>(Outcome::SecureInputEnded); ++outcome) {
        const DecisionWords words = DecisionWords::of(sigDecision(static_cast<Outcome>(outcome)));
        EXPECT_FALSE(words.reason.isEmpty()) << outcome;
        EXPECT_TRUE(words.sentence.endsWith(QLatin1Char('.'))) << outcome;
    }
}

TEST(DecisionWords, CutNamesThatNoSentenceCanBear) {
    std::u16string astral;
    for (int i = 0; i < 50'000; ++i) astral += u"\U0001F600";
    const DecisionWords words = DecisionWords::of({currentDate(), Outcome::Failed, u"x" + astral, astral + u"\xd800"});
    EXPECT_LT(words.sentence.size(), 200);
    EXPECT_TRUE(words.sentence.isValidUtf16());
}

class DecisionsWindowTest : public testing::Test {
  protected:
    DecisionsWindowTest()
        : window(new DecisionsWindow({[this](auto told) {
                                          ++asked;
                                          told(known);
                                      },
                                      [this] { known.clear(); }},
                                     settings)) {}
    ~DecisionsWindowTest() override { delete window; }

    void show() {
        window->show();
        ASSERT_TRUE(QTest::qWaitForWindowActive(window));
    }
    QTreeView& list() { return *window->findChild<QTreeView*>(); }
    QPushButton& button(const char* text) {
        for (auto* found : window->findChildren<QPushButton*>()) {
            if (found->text().remove(QLatin1Char('&')) == QLatin1String(text)) return *found;
        }
        throw std::logic_error(text);
    }
    bool tells(const QString& text) {
        const auto labels = window->findChildren<QLabel*>();
        return std::ranges::any_of(labels,
                                   [&](QLabel* label) { return label->isVisible() && label->text().contains(text); });
    }
    // What a screen reader says of the row.
    QString spoken(int row) { return list().model()->index(row, 0).data(Qt::AccessibleTextRole).toString(); }

    std::vector<MatchDecision> known;
    int asked = 0;
    MemoryUserDefaults settings;
    QPointer<DecisionsWindow> window;
};

TEST_F(DecisionsWindowTest, ListsTheNewestFirstAndExplainsTheChosenOne) {
    known = {sigDecision(Outcome::Expanded), sigDecision(Outcome::WrongApplication)};
    show();
    EXPECT_EQ(window->windowTitle(), QStringLiteral("Why Didn't It Expand?"));
    ASSERT_EQ(list().model()->rowCount(), 2);
    EXPECT_TRUE(spoken(0).contains(QStringLiteral("“;sig” (group Signatures) did not expand: the group is not meant")));
    EXPECT_TRUE(spoken(0).contains(QStringLiteral("Change the list of programs")));
    EXPECT_TRUE(tells(QStringLiteral("not meant for xterm")));
    QTest::keyClick(&list(), Qt::Key_Down);
    EXPECT_TRUE(tells(QStringLiteral("was expanded in xterm")));
    EXPECT_FALSE(tells(QStringLiteral("not meant for xterm")));
}

TEST_F(DecisionsWindowTest, StaysAtTheChosenOneUnlessThatIsTheNewest) {
    known = {sigDecision(Outcome::Expanded), sigDecision(Outcome::WrongApplication)};
    show();
    known.push_back(sigDecision(Outcome::WrongCase));
    QTest::mouseClick(&button("Refresh"), Qt::LeftButton);
    EXPECT_EQ(list().currentIndex().row(), 0);
    EXPECT_TRUE(tells(QStringLiteral("capital and small")));
    QTest::keyClick(&list(), Qt::Key_Down);
    known.push_back(sigDecision(Outcome::Offered));
    QTest::keyClick(window, Qt::Key_F5);
    EXPECT_EQ(list().currentIndex().row(), 2);
    EXPECT_TRUE(tells(QStringLiteral("not meant for xterm")));
    known = {sigDecision(Outcome::Failed)};
    QTest::mouseClick(&button("Refresh"), Qt::LeftButton);
    EXPECT_EQ(list().currentIndex().row(), 0);
}

TEST_F(DecisionsWindowTest, AsksAgainWhenItComesToTheFront) {
    show();
    EXPECT_TRUE(tells(QStringLiteral("Nothing to tell yet")));
    EXPECT_FALSE(button("Forget These").isEnabled());
    known = {sigDecision(Outcome::WrongTrigger)};
    QWidget other;
    other.show();
    other.activateWindow();
    ASSERT_TRUE(QTest::qWaitForWindowActive(&other));
    window->activateWindow();
    ASSERT_TRUE(QTest::qWaitForWindowActive(window));
    EXPECT_EQ(list().model()->rowCount(), 1);
    EXPECT_FALSE(tells(QStringLiteral("Nothing to tell yet")));
}

TEST_F(DecisionsWindowTest, ForgetsWhenItIsTold) {
    known = {sigDecision(Outcome::WrongTrigger)};
    show();
    QTest::keyClick(window, Qt::Key_F, Qt::AltModifier);
    EXPECT_TRUE(QTest::qWaitFor([&] { return known.empty(); }));
    EXPECT_TRUE(tells(QStringLiteral("Nothing to tell yet")));
    EXPECT_FALSE(button("Forget These").isEnabled());
    EXPECT_TRUE(button("Refresh").hasFocus());
}

TEST_F(DecisionsWindowTest, IsReachedByTabAndGoneWhenItIsClosed) {
    known = {sigDecision(Outcome::WrongTrigger)};
    show();
    std::set<QWidget*> reached;
    for (int i = 0; i < 4; ++i) {
        reached.insert(QApplication::focusWidget());
        QTest::keyClick(QApplication::focusWidget(), Qt::Key_Tab);
    }
    EXPECT_EQ(reached.size(), 4U) << "list, explanation and two buttons";
    QTest::keyClick(window, Qt::Key_W, Qt::ControlModifier);
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    EXPECT_TRUE(window.isNull());
}

TEST(DecisionsWindow, BearsAnAnswerThatComesAfterItIsGone) {
    MemoryUserDefaults settings;
    std::vector<std::function<void(std::vector<MatchDecision>)>> waiting;
    const QPointer window = new DecisionsWindow({[&](auto told) { waiting.push_back(told); }, [] {}}, settings);
    window->show();
    ASSERT_TRUE(QTest::qWaitForWindowActive(window));
    QTest::keyClick(window, Qt::Key_Escape);
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    ASSERT_TRUE(window.isNull());
    ASSERT_FALSE(waiting.empty());
    for (const auto& told : waiting) told({sigDecision(Outcome::Expanded)});
}

TEST_F(DecisionsWindowTest, LooksWell) {
    show();
    takePicture(*window, QStringLiteral("Decisions-empty"));
    known = {{currentDate(), Outcome::Expanded, u"btw", u"Chat", u"Telegram"},
             {currentDate(), Outcome::WrongCase, u"Btw", u"Chat", u"Telegram"},
             {currentDate(), Outcome::WrongTextBefore, u"btw", u"Chat", u"Telegram", MatchDecision::AfterDelimiter},
             sigDecision(Outcome::Offered),
             {currentDate(), Outcome::SwitchedOff},
             {currentDate(), Outcome::SwitchedOn},
             sigDecision(Outcome::WrongApplication)};
    QTest::mouseClick(&button("Refresh"), Qt::LeftButton);
    takePicture(*window, QStringLiteral("Decisions"));
    const std::u16string name(3000, u'W');
    known = {{currentDate() - std::chrono::days(1), Outcome::WrongInputSource, name, name, name, {}},
             {currentDate(), Outcome::Expanded, u"تحية", u"عربي", u"org.gnome.Terminal", {}},
             {currentDate(), Outcome::SwitchedOff},
             {currentDate(), Outcome::SwitchedOn},
             sigDecision(Outcome::Offered),
             sigDecision(Outcome::WrongTextBefore, u"delimiter"),
             sigDecision(Outcome::WrongApplication)};
    QTest::mouseClick(&button("Refresh"), Qt::LeftButton);
    EXPECT_LE(window->minimumSizeHint().width(), 1024);
    EXPECT_LE(window->minimumSizeHint().height(), 700);
    list().setCurrentIndex(list().model()->index(6, 0));
    EXPECT_LE(window->minimumSizeHint().width(), 1024);
    takePicture(*window, QStringLiteral("Decisions-odd"));
}

}  // namespace
}  // namespace plume
