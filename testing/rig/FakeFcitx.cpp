#include "testing/rig/FakeFcitx.h"

#include <utility>

namespace plume::rig {

namespace {

constexpr BusAddress Field{"org.fcitx.Fcitx5", "/org/freedesktop/portal/inputcontext/1",
                           "org.fcitx.Fcitx.InputContext1"};

}  // namespace

FakeFcitx::FakeFcitx(std::string engine)
    : program_(openBus(sessionBusAddress())),
      engine_(std::move(engine)),
      service_(sessionBusAddress(), Field.name, [this](DBusMessage* call) { return answer(call); }) {}

void FakeFcitx::setEngine(const std::string& name) {
    const BusMessage signal(dbus_message_new_signal(Field.path, Field.interface, "CurrentIM"));
    dbus_message_set_destination(signal.get(), dbus_bus_get_unique_name(program_.get()));
    const char* const title = "An engine";
    const char* const text = name.c_str();
    const char* const language = "en";
    dbus_message_append_args(signal.get(), DBUS_TYPE_STRING, &title, DBUS_TYPE_STRING, &text, DBUS_TYPE_STRING,
                             &language, DBUS_TYPE_INVALID);
    service_.send(signal);
}

void FakeFcitx::loseFocus() {
    dbus_connection_send(program_.get(), newCall(Field, "FocusOut").get(), nullptr);
    dbus_connection_flush(program_.get());
}

BusMessage FakeFcitx::answer(DBusMessage* call) const {
    BusMessage reply(dbus_message_new_method_return(call));
    const char* const name = engine_.c_str();
    const bool asksForEngine = dbus_message_has_member(call, "CurrentInputMethod") != 0;
    if (asksForEngine) dbus_message_append_args(reply.get(), DBUS_TYPE_STRING, &name, DBUS_TYPE_INVALID);
    return reply;
}

}  // namespace plume::rig
