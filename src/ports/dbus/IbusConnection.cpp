#include "ports/dbus/IbusConnection.h"

namespace plume {

namespace {

constexpr const char* Service = "org.freedesktop.IBus";
constexpr BusAddress Properties{Service, "/org/freedesktop/IBus", "org.freedesktop.DBus.Properties"};
constexpr const char* EngineChanged = "GlobalEngineChanged";

// IBus sends its objects as structures in variants: the class, attachments, then the fields. An engine's first field is
// its name.
std::string engineNameIn(BusReader values) {
    BusReader engine = values.inside().inside().inside();
    engine.string();
    engine.inside();
    return engine.string().value_or("");
}

}  // namespace

IbusConnection::IbusConnection(PollRunLoop& loop) : bus_(loop) {
    bus_.heard = [this](DBusMessage& message) { hear(message); };
    bus_.lost = [this] { engineChanged({}); };
}

void IbusConnection::connect(const std::string& address) {
    if (!bus_.connect(address)) return engineChanged({});
    bus_.listen(std::string("type='signal',interface='") + Service + "',member='" + EngineChanged + "'");
    askForEngine();
}

void IbusConnection::askForEngine() {
    const BusMessage call = newCall(Properties, "Get", {std::string(Service), std::string("GlobalEngine")});
    bus_.call(call, [this](const BusAnswer& answer) { engineChanged(engineNameIn(answer.values())); });
}

void IbusConnection::hear(DBusMessage& message) const {
    if (dbus_message_is_signal(&message, Service, EngineChanged) != 0) {
        engineChanged(BusReader(&message).string().value_or(""));
    }
}

}  // namespace plume
