#include "ports/atspi/AccessibilityBus.h"

#include <unistd.h>

#include <cstdlib>
#include <memory>
#include <optional>

#include "ports/atspi/AtspiMessages.h"

namespace plume {

namespace {

constexpr int AnswerBoundMilliseconds = 3'000;

// Not libdbus's own search for it, which would start a bus where there is none. Empty when there is none.
std::string sessionAddress() {
    const char* address = std::getenv("DBUS_SESSION_BUS_ADDRESS");
    if (address != nullptr && *address != '\0') return address;
    const char* folder = std::getenv("XDG_RUNTIME_DIR");
    const std::string socket = std::string(folder != nullptr ? folder : "") + "/bus";
    if (folder == nullptr || access(socket.c_str(), F_OK) != 0) return {};
    const std::unique_ptr<char, void (*)(void*)> escaped(dbus_address_escape_value(socket.c_str()), dbus_free);
    return escaped ? std::string("unix:path=") + escaped.get() : std::string();
}

BusAnswer ask(DBusConnection& bus, const char* interface, const char* method,
              std::initializer_list<BusValue> arguments = {}) {
    const BusMessage call = newCall({"org.a11y.Bus", "/org/a11y/bus", interface}, method, arguments);
    return BusAnswer(
        BusMessage(dbus_connection_send_with_reply_and_block(&bus, call.get(), AnswerBoundMilliseconds, nullptr)));
}

bool isOn(DBusConnection& bus, const char* property) {
    const BusAnswer answer = ask(bus, DBUS_INTERFACE_PROPERTIES, "Get", {"org.a11y.Status", property});
    return answer.values().inside().boolean().value_or(false);
}

}  // namespace

AccessibilityBus findAccessibilityBus() {
    const std::string session = sessionAddress();
    const BusConnection bus = session.empty() ? nullptr : openBus(session);
    if (!bus) return {AccessibilityStatus::NoSession, {}};
    const auto address = ask(*bus, "org.a11y.Bus", "GetAddress").values().string();
    if (!address || address->empty()) return {AccessibilityStatus::NotInstalled, {}};
    // Toolkits look at either.
    const bool on = isOn(*bus, "IsEnabled") || isOn(*bus, "ScreenReaderEnabled");
    return {on ? AccessibilityStatus::Working : AccessibilityStatus::SwitchedOff, *address};
}

}  // namespace plume
