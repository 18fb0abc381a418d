#include "testing/rig/BusMonitor.h"

#include "testing/rig/RigError.h"

namespace plume::rig {

namespace {

void appendRules(DBusMessage* call, const std::vector<std::string>& methods) {
    DBusMessageIter arguments;
    DBusMessageIter rules;
    dbus_message_iter_init_append(call, &arguments);
    dbus_message_iter_open_container(&arguments, DBUS_TYPE_ARRAY, "s", &rules);
    for (const std::string& method : methods) {
        const std::string rule = "type='method_call',member='" + method + "'";
        const char* text = rule.c_str();
        dbus_message_iter_append_basic(&rules, DBUS_TYPE_STRING, static_cast<const void*>(&text));
    }
    dbus_message_iter_close_container(&arguments, &rules);
    const dbus_uint32_t flags = 0;
    dbus_message_iter_append_basic(&arguments, DBUS_TYPE_UINT32, &flags);
}

}  // namespace

BusMonitor::BusMonitor(const std::string& address, const std::vector<std::string>& methods)
    : connection_(openBus(address)) {
    if (!connection_) throw RigError("no bus at " + address);
    const BusMessage call =
        newCall({DBUS_SERVICE_DBUS, DBUS_PATH_DBUS, "org.freedesktop.DBus.Monitoring"}, "BecomeMonitor");
    appendRules(call.get(), methods);
    const BusMessage reply(dbus_connection_send_with_reply_and_block(connection_.get(), call.get(), 10'000, nullptr));
    if (!reply) throw RigError("the bus lets nobody watch it");
}

int BusMonitor::count() {
    dbus_connection_read_write(connection_.get(), 0);
    while (const BusMessage message{dbus_connection_pop_message(connection_.get())}) {
        if (dbus_message_get_type(message.get()) == DBUS_MESSAGE_TYPE_METHOD_CALL) ++count_;
    }
    return count_;
}

}  // namespace plume::rig
