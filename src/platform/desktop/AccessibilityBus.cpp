#include "platform/desktop/AccessibilityBus.h"

#include <dbus/dbus.h>
#include <unistd.h>

#include <cstdlib>
#include <memory>
#include <optional>
#include <string>

namespace plume {

namespace {

constexpr int AnswerBoundMilliseconds = 3'000;

struct MessageUnref {
    void operator()(DBusMessage* message) const { dbus_message_unref(message); }
};
using Message = std::unique_ptr<DBusMessage, MessageUnref>;

struct ConnectionUnref {
    void operator()(DBusConnection* connection) const { dbus_connection_unref(connection); }
};
using Connection = std::unique_ptr<DBusConnection, ConnectionUnref>;

// Without an address libdbus would start a bus of its own.
bool hasSessionBus() {
    const char* address = std::getenv("DBUS_SESSION_BUS_ADDRESS");
    if (address != nullptr && *address != '\0') return true;
    const char* folder = std::getenv("XDG_RUNTIME_DIR");
    return folder != nullptr && access((std::string(folder) + "/bus").c_str(), F_OK) == 0;
}

// This connection is libatspi's, too.
Connection sessionBus() {
    if (!hasSessionBus()) return nullptr;
    Connection bus(dbus_bus_get(DBUS_BUS_SESSION, nullptr));
    if (bus) dbus_connection_set_exit_on_disconnect(bus.get(), FALSE);
    return bus;
}

Message callTo(const char* interface, const char* method) {
    return Message(dbus_message_new_method_call("org.a11y.Bus", "/org/a11y/bus", interface, method));
}

Message send(DBusConnection& bus, const Message& call) {
    return Message(dbus_connection_send_with_reply_and_block(&bus, call.get(), AnswerBoundMilliseconds, nullptr));
}

bool isOn(DBusConnection& bus, const char* property) {
    const char* interface = "org.a11y.Status";
    const Message call = callTo(DBUS_INTERFACE_PROPERTIES, "Get");
    dbus_message_append_args(call.get(), DBUS_TYPE_STRING, &interface, DBUS_TYPE_STRING, &property, DBUS_TYPE_INVALID);
    const Message reply = send(bus, call);
    DBusMessageIter variant;
    if (!reply || !dbus_message_iter_init(reply.get(), &variant)) return false;
    if (dbus_message_iter_get_arg_type(&variant) != DBUS_TYPE_VARIANT) return false;
    DBusMessageIter value;
    dbus_message_iter_recurse(&variant, &value);
    if (dbus_message_iter_get_arg_type(&value) != DBUS_TYPE_BOOLEAN) return false;
    dbus_bool_t on = FALSE;
    dbus_message_iter_get_basic(&value, &on);
    return on != 0;
}

}  // namespace

AccessibilityStatus findAccessibilityBus() {
    const Connection bus = sessionBus();
    if (!bus) return AccessibilityStatus::NoSession;
    if (!send(*bus, callTo("org.a11y.Bus", "GetAddress"))) return AccessibilityStatus::NotInstalled;
    // Toolkits look at either.
    const bool on = isOn(*bus, "IsEnabled") || isOn(*bus, "ScreenReaderEnabled");
    return on ? AccessibilityStatus::Working : AccessibilityStatus::SwitchedOff;
}

}  // namespace plume
