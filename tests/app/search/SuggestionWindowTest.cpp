#include "app/search/SuggestionWindow.h"

#include <gtest/gtest.h>

#include <QLabel>
#include <QListView>
#include <QWheelEvent>

#include "tests/app/search/SearchSupport.h"

namespace plume {
namespace {

using test::rowAt;

class SuggestionWindowTest : public testing::Test {
  protected:
    SuggestionWindowTest() {
        window.setEvents(
            {.clicked = [this](std::uint64_t page, std::size_t index) { clicks.emplace_back(page, index); },
             .scrolled = [this](int rows) { scrolled.push_back(rows); },
             .placed = [this](const Rectangle& frame) { frames.push_back(frame); }});
    }
    static SuggestionPage page(std::size_t first, std::size_t total, std::size_t selected, std::uint64_t number = 1) {
        SuggestionPage made{.number = number,
                            .rows = {},
                            .first = first,
                            .total = total,
                            .selected = selected,
                            .selectorKeyModifier = 3};
        for (std::size_t i = first; i < std::min(first + 10, total); ++i) {
            const auto digit = static_cast<char16_t>(i < 9 ? u'1' + i : i == 9 ? u'0' : 0);
            made.rows.push_back({u";sig" + fromUtf8(std::to_string(i)), 3, u"Farewell", u"Kind regards", digit});
        }
        return made;
    }
    void show(const SuggestionPage& shown) {
        window.show(shown, {CaretPlace::Kind::Caret, {{60, 60}, {0, 16}}});
        QCoreApplication::processEvents();
    }
    QListView& list() { return *window.findChild<QListView*>(); }
    QString count() const {
        const auto* label = window.findChild<QLabel*>();
        return label->isVisible() ? label->text() : QString();
    }
    void wheel(int angle) {
        QWidget& viewport = *list().viewport();
        const QPointF centre = viewport.rect().center();
        QWheelEvent event(centre, viewport.mapToGlobal(centre), {}, {0, angle}, Qt::NoButton, Qt::NoModifier,
                          Qt::NoScrollPhase, false);
        // Others than the user's are not handed on to the window, nor is what sendEvent() sends one of the user's.
        QSpontaneKeyEvent::setSpontaneous(&event);
        qApp->notify(&viewport, &event);
    }

    std::vector<std::pair<std::uint64_t, std::size_t>> clicks;
    std::vector<int> scrolled;
    std::vector<Rectangle> frames;
    SuggestionWindow window;
};

TEST_F(SuggestionWindowTest, StaysOutOfTheKeyboardsWay) {
    EXPECT_TRUE(window.windowFlags().testFlag(Qt::WindowDoesNotAcceptFocus));
    EXPECT_TRUE(window.testAttribute(Qt::WA_ShowWithoutActivating));
    EXPECT_EQ(window.windowType(), Qt::ToolTip);
    show(page(0, 23, 0));
    EXPECT_NE(QApplication::activeWindow(), &window);
    for (const QWidget* each : window.findChildren<QWidget*>()) EXPECT_EQ(each->focusPolicy(), Qt::NoFocus);
    EXPECT_EQ(list().accessibleName(), QStringLiteral("Suggested snippets"));
}

TEST_F(SuggestionWindowTest, ShowsAPageWithoutAnythingCutOff) {
    show(page(0, 23, 2));
    ASSERT_EQ(list().model()->rowCount(), 10);
    EXPECT_EQ(list().currentIndex().row(), 2);
    EXPECT_EQ(count(), QStringLiteral("1 to 10 of 23"));
    EXPECT_EQ(rowAt(*list().model(), 0).abbreviation.marks, (QList<Range>{{0, 3}}));
    EXPECT_EQ(rowAt(*list().model(), 9).shortcut, QStringLiteral("Alt+0"));
    EXPECT_EQ(list().model()->index(0, 0).data(Qt::AccessibleTextRole).toString(),
              QStringLiteral(";sig0, Farewell, Kind regards, Alt+1"));
    EXPECT_EQ(window.pos(), QPoint(60, 80));
    const QRect last = list().visualRect(list().model()->index(9, 0));
    EXPECT_TRUE(list().viewport()->rect().contains(last)) << "the last row is cut";
    EXPECT_EQ(list().viewport()->height(), last.bottom() + 1);

    show(page(0, 3, 0));
    EXPECT_EQ(count(), QString());
    EXPECT_EQ(list().viewport()->height(), list().visualRect(list().model()->index(2, 0)).bottom() + 1);
    EXPECT_EQ(frames.size(), 2U);
}

TEST_F(SuggestionWindowTest, TheSelectionMayBeOutOfSight) {
    show(page(0, 23, 0));
    window.update(page(13, 23, 0, 2));
    EXPECT_FALSE(list().currentIndex().isValid());
    EXPECT_TRUE(list().selectionModel()->selectedIndexes().isEmpty());
    EXPECT_EQ(count(), QStringLiteral("14 to 23 of 23"));
    EXPECT_EQ(rowAt(*list().model(), 0).shortcut, QString());
    window.update(page(13, 23, 22, 3));
    EXPECT_EQ(list().currentIndex().row(), 9);
}

TEST_F(SuggestionWindowTest, KeepsItsWidthWhileOneGoesThroughIt) {
    SuggestionPage wide = page(0, 40, 0);
    wide.rows[0].content = std::u16string(35, u'm');
    show(page(1, 40, 1));
    const int narrow = window.width();
    window.update(wide);
    const int width = window.width();
    EXPECT_GT(width, narrow);
    for (const std::size_t first : {1U, 5U, 9U, 30U}) {
        window.update(page(first, 40, first));
        EXPECT_EQ(window.width(), width) << first;
    }
    show(page(0, 40, 0));
    EXPECT_EQ(window.width(), narrow) << "another list";
    wide.rows[0].content = std::u16string(5000, u'm');
    show(wide);
    EXPECT_EQ(window.width(), 562);
}

TEST_F(SuggestionWindowTest, AClickIsOneOnThePageThatWasSeen) {
    show(page(5, 23, 5, 41));
    const QPoint third = list().visualRect(list().model()->index(2, 0)).center();
    QTest::mouseClick(list().viewport(), Qt::LeftButton, {}, third);
    EXPECT_EQ(clicks, (std::vector<std::pair<std::uint64_t, std::size_t>>{{41, 7}}));
    // What comes between pressing and letting go is not what was meant.
    QTest::mousePress(list().viewport(), Qt::LeftButton, {}, third);
    window.update(page(6, 23, 6, 42));
    QTest::mouseRelease(list().viewport(), Qt::LeftButton, {}, third);
    EXPECT_EQ(clicks.size(), 1U);
}

TEST_F(SuggestionWindowTest, TheWheelTellsWholeRows) {
    show(page(0, 40, 0));
    wheel(-120);
    EXPECT_EQ(scrolled, std::vector{3});
    for (int i = 0; i < 8; ++i) wheel(-15);
    EXPECT_EQ(scrolled, (std::vector{3, 1, 1, 1}));
    wheel(120);
    EXPECT_EQ(scrolled, (std::vector{3, 1, 1, 1, -3}));
    EXPECT_EQ(rowAt(*list().model(), 0).abbreviation.text, QStringLiteral(";sig0")) << "which rows come is told it";
}

TEST_F(SuggestionWindowTest, HiddenItTakesNoPage) {
    show(page(0, 3, 0));
    window.hide();
    window.update(page(0, 23, 0, 2));
    EXPECT_FALSE(window.isVisible());
    EXPECT_EQ(frames.size(), 1U);
}

TEST_F(SuggestionWindowTest, PictureOfAnExample) {
    SuggestionPage shown{.number = 1, .rows = {}, .first = 0, .total = 5, .selected = 1, .selectorKeyModifier = 3};
    shown.rows = {{u";addr", 3, u"Address", u"1 Sample Street", u'1'},
                  {u";adw", 3, u"Address at work", u"Sample and Sons\u2009…", u'2'},
                  {u";admin", 3, u"", u"Please ask our administrator for access.", u'3'},
                  {u";adv", 3, u"", u"in advance", u'4'},
                  {u";adj", 3, u"", u"adjective", u'5'}};
    show(shown);
    test::takePicture(window, QStringLiteral("SuggestionsExample"));
}

TEST_F(SuggestionWindowTest, Pictures) {
    SuggestionPage shown = page(0, 23, 1);
    shown.rows[2].label.clear();
    shown.rows[3].content = u"Dear Sir or Madam, thank you for your letter of last week, which I read\u2009…";
    shown.rows[4] = {u";שלום", 2, u"ברכה", u"שלום רב", u'5'};
    shown.rows[5].abbreviation = u";averyveryverylongabbreviationthatnobodywouldevertypeinfull";
    shown.rows[6] = {u"\U0001F600:smile", 2, u"", u"\U0001F600\U0001F44D\U0001F3FD", u'7'};
    show(shown);
    test::takePicture(window, QStringLiteral("Suggestions"));
    show(page(0, 2, 0));
    test::takePicture(window, QStringLiteral("SuggestionsFew"));
    const test::RightToLeft layout;
    show(shown);
    test::takePicture(window, QStringLiteral("Suggestions-rtl"));
}

}  // namespace
}  // namespace plume
