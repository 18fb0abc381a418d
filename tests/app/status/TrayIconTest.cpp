#include "app/status/TrayIcon.h"

#include <gtest/gtest.h>

#include <QTest>

#include "app/qt/ColorScheme.h"
#include "tests/app/status/MenuServices.h"

namespace plume {
namespace {

// No session bus, no X server: any complaint fails the test.
TEST(TrayIcon, WithoutAPlaceForItTheIconIsNotVisible) {
    MenuServices services;
    services.addGroup(u"Letters", 3);
    TrayIcon icon(services.services());
    EXPECT_FALSE(icon.isVisible());
    icon.setStatus({.isEnabled = false});
    setColorScheme(true);
    setColorScheme(false);
    QTest::qWait(10);
    EXPECT_FALSE(icon.isVisible());
}

}  // namespace
}  // namespace plume
