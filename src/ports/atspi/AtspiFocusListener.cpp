#include "ports/atspi/AtspiFocusListener.h"

#include <utility>

namespace plume {

namespace {

constexpr const char* EventInterface = "org.a11y.atspi.Event.Object";
constexpr std::chrono::milliseconds StartBound{450};

}  // namespace

void AtspiFocusListener::listenTo(const std::string& program, const std::string& address) {
    if (program_ == program) return;
    stop();
    if (!begin(program, address)) return bus_.disconnect();
    program_ = program;
    source_ = loop_.addSource(bus_.descriptor(), [this] { takeMessages(); });
}

void AtspiFocusListener::stop() {
    if (program_.empty()) return;
    source_.end();
    bus_.disconnect();
    program_.clear();
}

bool AtspiFocusListener::begin(const std::string& program, const std::string& address) {
    if (!bus_.connect(address)) return false;
    bus_.begin(StartBound);
    const std::string rule = std::string("type='signal',interface='") + EventInterface +
                             "',member='StateChanged',arg0='focused',sender='" + program + "'";
    const AtspiPart registry{"org.a11y.atspi.Registry", "/org/a11y/atspi/registry"};
    return bus_.callBus("AddMatch", {rule}) &&
           bus_.call(registry, "org.a11y.atspi.Registry", "RegisterEvent", {"object:state-changed:focused"});
}

void AtspiFocusListener::takeMessages() {
    while (const BusMessage message = bus_.takeMessage()) take(message.get());
    if (!bus_.isConnected()) stop();
}

void AtspiFocusListener::take(DBusMessage* message) const {
    if (dbus_message_is_signal(message, EventInterface, "StateChanged") == 0) return;
    BusReader values(message);
    const auto state = values.string();
    const auto gained = values.int32();
    const char* path = dbus_message_get_path(message);
    if (state == "focused" && gained == 1 && path != nullptr) heard_({program_, path});
}

}  // namespace plume
