#include "ports/atspi/AtspiSession.h"

#include "ports/atspi/AtspiParts.h"
#include "ports/atspi/AtspiPlaces.h"

namespace plume {

namespace {

using std::chrono::steady_clock;

constexpr int AnswerBoundMilliseconds = 3'000;

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
    const std::string session = sessionBusAddress();
    const BusConnection bus = session.empty() ? nullptr : openBus(session);
    if (!bus) return {AccessibilityStatus::NoSession, {}};
    const auto address = ask(*bus, "org.a11y.Bus", "GetAddress").values().string();
    if (!address || address->empty()) return {AccessibilityStatus::NotInstalled, {}};
    // Toolkits look at either.
    const bool on = isOn(*bus, "IsEnabled") || isOn(*bus, "ScreenReaderEnabled");
    return {on ? AccessibilityStatus::Working : AccessibilityStatus::SwitchedOff, *address};
}

std::set<pid_t> processesOnBus(const AccessibilityBus& bus) {
    std::set<pid_t> processes;
    AtspiBus connection;
    if (bus.address.empty() || !connection.connect(bus.address)) return processes;
    constexpr std::chrono::seconds Bound{1};
    constexpr int MostPrograms = 1'000;
    connection.begin(Bound);
    const AtspiPart desktop{"org.a11y.atspi.Registry", "/org/a11y/atspi/accessible/root"};
    for (const AtspiPart& program : childrenOf(connection, desktop, MostPrograms)) {
        const auto process = connection.callBus("GetConnectionUnixProcessID", {program.program}).values().uint32();
        if (process) processes.insert(static_cast<pid_t>(*process));
    }
    return processes;
}

void switchAccessibilityOn() {
    const std::string session = sessionBusAddress();
    const BusConnection bus = session.empty() ? nullptr : openBus(session);
    // Not "ScreenReaderEnabled", which makes desktops start one.
    if (bus) ask(*bus, DBUS_INTERFACE_PROPERTIES, "Set", {"org.a11y.Status", "IsEnabled", BusFlag{true}});
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

std::optional<AtspiFocused> AtspiSession::askForFocus() {
    if (auto told = focus().justTold()) return told;
    return queue_.ask<AtspiFocused>([this] { return std::optional(tracker_.focusedNow()); });
}

void AtspiSession::askForPlaces(std::function<void(const FocusedPlaces&)> told) {
    queue_.loop().perform([this, told = std::move(told)] {
        if (!queue_.isOpen()) return told({});
        bus_.begin(QuestionBound);
        const AtspiFocused focused = tracker_.focusedNow();
        bus_.begin(QuestionBound);
        FocusedPlaces places = placesOf(bus_, focused);
        places.isMoving = tracker_.isMoveExpected();
        // A thread that was left behind has nobody to tell any more.
        if (!queue_.hasEnded()) told(places);
    });
}

void AtspiSession::switchOn() {
    queue_.loop().perform([this] {
        switchAccessibilityOn();
        connect();
    });
}

void AtspiSession::run() {
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
