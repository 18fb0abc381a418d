#include "ports/dbus/FcitxConnection.h"

namespace plume {

namespace {

constexpr BusAddress Controller{FcitxConnection::Service, "/controller", "org.fcitx.Fcitx.Controller1"};

const std::vector<std::string>& rules() {
    static const std::vector<std::string> all = {
        "type='signal',interface='org.fcitx.Fcitx.InputContext1',member='CurrentIM'",
        "type='method_call',interface='org.fcitx.Fcitx.InputContext1',member='FocusOut'"};
    return all;
}

}  // namespace

FcitxConnection::FcitxConnection(PollRunLoop& loop, ServiceBus& session, ComposedKeys& keys)
    : session_(session), monitor_(loop), keys_(loop, session, keys) {
    monitor_.overheard = [this](DBusMessage& message) { overhear(message); };
    monitor_.lost = [this] { disconnect(); };
}

void FcitxConnection::connect(const std::string& address) {
    focus_.clear();
    address_ = address;
    if (!monitor_.connect(address)) return setEngine({});
    monitor_.monitor(rules(), [this](bool isAllowed) {
        // What was true once is worth nothing when changes are not heard.
        isAllowed ? askForEngine() : disconnect();
    });
}

void FcitxConnection::disconnect() {
    monitor_.disconnect();
    keys_.disconnect();
    setEngine({});
}

void FcitxConnection::askForEngine() {
    session_.call(newCall(Controller, "CurrentInputMethod"), [this](const BusAnswer& answer) {
        if (monitor_.isConnected() && focus_.empty()) setEngine(answer.values().string().value_or(""));
    });
}

void FcitxConnection::overhear(DBusMessage& message) {
    const char* const path = dbus_message_get_path(&message);
    if (path == nullptr) return;
    if (dbus_message_has_member(&message, "CurrentIM") != 0) {
        focus_ = path;
        BusReader values(&message);
        values.string();  // for people to read
        setEngine(values.string().value_or(""));
    } else if (focus_ == path) {
        setEngine({});
    }
}

void FcitxConnection::setEngine(const std::string& name) {
    // Engines of this kind leave the keys alone.
    const bool composes = !name.empty() && !name.starts_with("keyboard-");
    composes ? keys_.connect(address_) : keys_.end();
    engineChanged(composes ? name : std::string());
}

}  // namespace plume
