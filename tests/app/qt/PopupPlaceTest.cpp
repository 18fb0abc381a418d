#include "app/qt/PopupPlace.h"

#include <gtest/gtest.h>

#include <QCursor>
#include <QGuiApplication>
#include <QScreen>
#include <QWidget>

#include "tests/app/search/SearchSupport.h"

namespace plume {
namespace {

using Kind = CaretPlace::Kind;

constexpr QSize Popup(200, 100);

class PopupPlaceTest : public testing::Test {
  protected:
    const QRect room = QGuiApplication::primaryScreen()->availableGeometry();
    const double ratio = QGuiApplication::primaryScreen()->devicePixelRatio();

    // The caret's place is given in Qt's pixels.
    QRect at(double x, double y, double width = 0, Kind kind = Kind::Caret, QSize size = Popup) const {
        return popupGeometry({kind, {{x * ratio, y * ratio}, {width * ratio, 16 * ratio}}}, size);
    }
};

TEST_F(PopupPlaceTest, IsBesideTheCaretAndInsideTheScreen) {
    const int right = room.right() + 1;
    const int bottom = room.bottom() + 1;
    EXPECT_EQ(at(50, 60), QRect(QPoint(50, 80), Popup));
    EXPECT_EQ(at(50, 60, 300, Kind::Field), QRect(QPoint(50, 80), Popup));
    EXPECT_EQ(at(50, bottom - 120), QRect(QPoint(50, bottom - 100), Popup)) << "it just fits";
    EXPECT_EQ(at(50, bottom - 119), QRect(QPoint(50, bottom - 119 - 104), Popup)) << "above";
    EXPECT_EQ(at(right - 10, 60), QRect(QPoint(right - 200, 80), Popup));
    EXPECT_EQ(at(right - 1, bottom - 1), QRect(QPoint(right - 200, bottom - 105), Popup));
    EXPECT_EQ(at(0, 0), QRect(QPoint(0, 20), Popup));
    // Neither side has room for it.
    EXPECT_EQ(at(50, bottom / 2.0, 0, Kind::Caret, {200, room.height() - 10}).bottom(), room.bottom());
    EXPECT_EQ(at(50, 60, 0, Kind::Caret, {9000, 9000}), room);
}

TEST_F(PopupPlaceTest, RunsTheOtherWayWhereLanguagesDo) {
    const test::RightToLeft layout;
    EXPECT_EQ(at(300, 60), QRect(QPoint(100, 80), Popup));
    EXPECT_EQ(at(300, 60, 100, Kind::Field), QRect(QPoint(200, 80), Popup));
    EXPECT_EQ(at(20, 60).left(), room.left());
    EXPECT_EQ(cornerGeometry(Popup), QRect(QPoint(room.left() + 12, room.top() + 12), Popup));
}

TEST_F(PopupPlaceTest, IsAtThePointerWhereNobodyKnowsThePlace) {
    QCursor::setPos(120, 130);
    EXPECT_EQ(popupGeometry({}, Popup), QRect(QPoint(120, 134), Popup));
    EXPECT_EQ(popupGeometry({Kind::Caret, {{-9000, 90000}, {0, 16}}}, Popup), QRect(QPoint(120, 134), Popup))
        << "on no screen";
}

TEST_F(PopupPlaceTest, IsInTheCorner) {
    EXPECT_EQ(cornerGeometry(Popup), QRect(QPoint(room.right() + 1 - 212, room.top() + 12), Popup));
    EXPECT_TRUE(room.contains(cornerGeometry({9000, 9000})));
}

TEST_F(PopupPlaceTest, ToldInPixelsOfTheScreen) {
    QWidget window(nullptr, Qt::FramelessWindowHint);
    window.setGeometry(at(50, 60));
    EXPECT_EQ(screenFrame(window), (Rectangle{{50 * ratio, 80 * ratio}, {200 * ratio, 100 * ratio}}));
}

}  // namespace
}  // namespace plume
