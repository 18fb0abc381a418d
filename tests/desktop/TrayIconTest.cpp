#include "app/status/TrayIcon.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <QApplication>
#include <QDBusArgument>
#include <QDBusConnection>
#include <QDBusMessage>
#include <QDBusPendingCall>
#include <QDBusVariant>
#include <QTest>
#include <map>
#include <mutex>

#include "testing/rig/BusService.h"
#include "testing/rig/DesktopRig.h"
#include "tests/app/status/MenuServices.h"

namespace plume {
namespace {

// A panel that shows what it is told of over the bus. It answers on a thread of its own: Qt waits for it.
class Panel {
  public:
    Panel()
        : service_(sessionBusAddress(), "org.kde.StatusNotifierWatcher",
                   [this](DBusMessage* call) { return answer(call); }) {}

    // The bus name of the icon that was made known last.
    std::string icon() const {
        const std::scoped_lock lock(mutex_);
        return icon_;
    }

  private:
    BusMessage answer(DBusMessage* call) {
        BusMessage reply(dbus_message_new_method_return(call));
        const std::string method = dbus_message_get_member(call);
        if (method == "Get") {
            const dbus_bool_t yes = TRUE;
            DBusMessageIter values;
            DBusMessageIter variant;
            dbus_message_iter_init_append(reply.get(), &values);
            dbus_message_iter_open_container(&values, DBUS_TYPE_VARIANT, "b", &variant);
            dbus_message_iter_append_basic(&variant, DBUS_TYPE_BOOLEAN, &yes);
            dbus_message_iter_close_container(&values, &variant);
        } else if (method == "Introspect") {
            const char* description =
                R"(<node><interface name="org.kde.StatusNotifierWatcher">)"
                R"(<property name="IsStatusNotifierHostRegistered" type="b" access="read"/></interface></node>)";
            dbus_message_append_args(reply.get(), DBUS_TYPE_STRING, &description, DBUS_TYPE_INVALID);
        } else if (method == "RegisterStatusNotifierItem") {
            const std::scoped_lock lock(mutex_);
            icon_ = dbus_message_get_sender(call);
        }
        return reply;
    }

    mutable std::mutex mutex_;
    std::string icon_;  // guarded by mutex_
    rig::BusService service_;
};

class TrayIconTest : public testing::Test {
  protected:
    static void SetUpTestSuite() {
        rig_ = std::make_unique<rig::DesktopRig>();
        rig_->session().join();
        static int count = 1;
        static char name[] = "tray_icon_test";
        static char* arguments[] = {name, nullptr};
        application_ = std::make_unique<QApplication>(count, arguments);
    }

    static void TearDownTestSuite() {
        application_.reset();
        rig_.reset();
    }

    static QDBusMessage ask(const Panel& panel, const QString& method, const QVariantList& arguments) {
        QDBusMessage call =
            QDBusMessage::createMethodCall(QString::fromStdString(panel.icon()), QStringLiteral("/MenuBar"),
                                           QStringLiteral("com.canonical.dbusmenu"), method);
        call.setArguments(arguments);
        const QDBusPendingCall answer = QDBusConnection::sessionBus().asyncCall(call);
        EXPECT_TRUE(QTest::qWaitFor([&] { return answer.isFinished(); }));
        EXPECT_FALSE(answer.isError()) << answer.error().message().toStdString();
        return answer.reply();
    }

    // The rows right inside one, their numbers by their labels.
    static std::map<std::string, int> rowsOf(const Panel& panel, int parent) {
        ask(panel, QStringLiteral("AboutToShow"), {parent});
        const QDBusMessage reply = ask(panel, QStringLiteral("GetLayout"), {parent, 1, QStringList()});
        std::map<std::string, int> rows;
        const auto layout = reply.arguments().at(1).value<QDBusArgument>();
        int number = 0;
        QVariantMap properties;
        layout.beginStructure();
        layout >> number >> properties;
        layout.beginArray();
        while (!layout.atEnd()) {
            QDBusVariant child;
            layout >> child;
            const auto row = child.variant().value<QDBusArgument>();
            row.beginStructure();
            row >> number >> properties;
            rows[properties.value(QStringLiteral("label")).toString().toStdString()] = number;
        }
        return rows;
    }

    static inline std::unique_ptr<rig::DesktopRig> rig_;
    static inline std::unique_ptr<QApplication> application_;
    MenuServices services_;
};

TEST_F(TrayIconTest, ComesAndGoesWithThePanel) {
    TrayIcon icon(services_.services());
    QTest::qWait(50);
    EXPECT_FALSE(icon.isVisible());
    for (int i = 0; i < 2; ++i) {
        const Panel panel;
        EXPECT_TRUE(QTest::qWaitFor([&] { return icon.isVisible() && !panel.icon().empty(); }));
    }
    EXPECT_TRUE(QTest::qWaitFor([&] { return !icon.isVisible(); }));
}

TEST_F(TrayIconTest, ARowThatAPanelShowsSendsItsSnippet) {
    services_.addGroup(u"A_B", 3);
    const Panel panel;
    TrayIcon icon(services_.services());
    ASSERT_TRUE(QTest::qWaitFor([&] { return !panel.icon().empty(); }));
    const int group = rowsOf(panel, 0).at("A__B");
    const auto rows = rowsOf(panel, group);
    ASSERT_EQ(rows.size(), 3U);
    // What has not changed keeps its number: a click names the row by it.
    EXPECT_EQ(rowsOf(panel, 0).at("A__B"), group);
    EXPECT_EQ(rowsOf(panel, group), rows);
    ask(panel, QStringLiteral("Event"),
        {rows.at("s1 — content 1"), QStringLiteral("clicked"), QVariant::fromValue(QDBusVariant(0)), 0U});
    EXPECT_TRUE(QTest::qWaitFor([&] { return !services_.sent.empty(); }));
    EXPECT_THAT(services_.sent, testing::ElementsAre("s1"));
}

}  // namespace
}  // namespace plume
