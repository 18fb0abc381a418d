#include "app/qt/WindowPlaces.h"

#include <gtest/gtest.h>

#include <QWidget>

#include "library/MemoryUserDefaults.h"

namespace plume {
namespace {

TEST(WindowPlaces, AWindowComesBackWhereItWasClosed) {
    MemoryUserDefaults settings;
    QRect place;
    {
        QWidget window;
        rememberPlace(window, settings, "Test");
        window.show();
        window.setGeometry(40, 50, 320, 240);
        place = window.geometry();
        window.close();
    }
    QWidget other;
    rememberPlace(other, settings, "Other");
    other.show();
    EXPECT_NE(other.size(), place.size());
    QWidget again;
    rememberPlace(again, settings, "Test");
    again.show();
    EXPECT_EQ(again.geometry(), place);
}

}  // namespace
}  // namespace plume
