#include "ports/atspi/AtspiSession.h"

#include <unistd.h>

#include <cstdlib>

namespace plume {

namespace {

using std::chrono::steady_clock;

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

constexpr std::chrono::seconds TimeBetweenTries{30};

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

void AtspiQueue::end() {
    ended_ = true;
    loop_.stop();
}

bool AtspiQueue::answersAreExpected() const {
    return open_ && !ended_ && steady_clock::now().time_since_epoch().count() >= pausedUntil_;
}

void AtspiQueue::expectNoAnswers() {
    pausedUntil_ = (steady_clock::now() + Pause).time_since_epoch().count();
}

AtspiSession::AtspiSession() : tracker_(queue_.loop(), bus_, [this] { return connectedAddress(); }) {}

std::optional<AtspiPart> AtspiSession::askForFocus() {
    return queue_.ask<AtspiPart>([this] { return std::optional(tracker_.focusedNow()); });
}

void AtspiSession::run() {
    dbus_threads_init_default();  // another session's thread may still be leaving
    connect();
    queue_.run();
}

const std::string* AtspiSession::connectedAddress() {
    if (!bus_.isConnected() && Clock::now() - connectedAt_ >= TimeBetweenTries) connect();
    if (bus_.isConnected()) return &address_;
    if (queue_.isOpen()) status_ = AccessibilityStatus::Failed;
    queue_.setOpen(false);
    return nullptr;
}

void AtspiSession::connect() {
    AccessibilityBus found = findAccessibilityBus();
    address_ = std::move(found.address);
    if (!address_.empty() && !bus_.connect(address_)) found.status = AccessibilityStatus::Failed;
    queue_.setOpen(bus_.isConnected());
    status_ = found.status;
    connectedAt_ = Clock::now();
}

}  // namespace plume
