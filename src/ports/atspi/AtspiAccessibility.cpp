#include "ports/atspi/AtspiAccessibility.h"

#include <chrono>
#include <utility>

#include "ports/atspi/AtspiElement.h"

namespace plume {

namespace {

constexpr std::chrono::milliseconds LongestGoodbye{50};

}  // namespace

std::string_view sentenceOf(AccessibilityStatus status) {
    switch (status) {
        case AccessibilityStatus::Starting:
            return "The accessibility bus is being looked for.";
        case AccessibilityStatus::Working:
            return "Accessibility works.";
        case AccessibilityStatus::SwitchedOff:
            return "Accessibility is not switched on for this session: programs made with GTK 3 tell about their "
                   "texts, "
                   "those made with Qt and browsers do not. To switch it on, run \"gsettings set "
                   "org.gnome.desktop.interface toolkit-accessibility true\" and start those programs again.";
        case AccessibilityStatus::NotInstalled:
            return "The accessibility bus cannot be started: install the package at-spi2-core.";
        case AccessibilityStatus::NoSession:
            return "There is no D-Bus session, so programs cannot tell about their texts: start Plume inside the "
                   "desktop "
                   "session.";
        case AccessibilityStatus::Failed:
            return "The accessibility bus does not accept Plume: log out and in again.";
    }
    return "";
}

AtspiAccessibility::AtspiAccessibility() : session_(std::make_shared<AtspiSession>()) {
    std::promise<void> ended;
    ended_ = ended.get_future();
    thread_ = std::thread([session = session_, ended = std::move(ended)]() mutable {
        session->run();
        ended.set_value();
    });
}

AtspiAccessibility::~AtspiAccessibility() {
    session_->end();
    if (ended_.wait_for(LongestGoodbye) == std::future_status::ready) {
        thread_.join();
    } else {
        thread_.detach();
    }
}

std::shared_ptr<UIElement> AtspiAccessibility::frontApplicationElement() const {
    return session_->focus().isKnown() ? std::make_shared<AtspiApplicationElement>(session_) : nullptr;
}

void AtspiAccessibility::setFrontProcess(pid_t process) {
    session_->tracker().setFrontProcess(process);
}

void AtspiAccessibility::focusMayHaveMoved() {
    session_->tracker().focusMayHaveMoved();
}

void AtspiAccessibility::userTypes() {
    session_->tracker().userTypes();
}

bool AtspiAccessibility::focusIsPassword() const {
    return session_->focus().isPassword();
}

pid_t AtspiAccessibility::focusedProcess() const {
    return session_->focus().process();
}

AccessibilityStatus AtspiAccessibility::status() const {
    return session_->status();
}

}  // namespace plume
