#include "ports/atspi/AtspiSession.h"

#include "ports/atspi/AccessibilityBus.h"

namespace plume {

namespace {

constexpr std::chrono::seconds TimeBetweenTries{30};

}  // namespace

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
