#include "ports/atspi/AtspiAccessibility.h"

#include "ports/atspi/AtspiElement.h"

namespace plume {

std::string_view sentenceOf(AccessibilityStatus status) {
    switch (status) {
        case AccessibilityStatus::Starting:
            return "The accessibility bus is being looked for.";
        case AccessibilityStatus::Working:
            return "Accessibility works.";
        case AccessibilityStatus::SwitchedOff:
            return "Accessibility is not switched on for this session: programs made with GTK 3 tell about their texts "
                   "and password fields, those made with Qt and browsers do not. To switch it on, set "
                   "\"LetProgramsTellPasswordFields\" to true in Plume's settings, or run \"gsettings set "
                   "org.gnome.desktop.interface toolkit-accessibility true\"; Chromium has to be started again then.";
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

AtspiAccessibility::AtspiAccessibility() : thread_(std::make_shared<AtspiSession>()) {}

AtspiAccessibility::~AtspiAccessibility() = default;

std::shared_ptr<UIElement> AtspiAccessibility::frontApplicationElement() const {
    return thread_->focus().isKnown() ? std::make_shared<AtspiApplicationElement>(thread_.session()) : nullptr;
}

void AtspiAccessibility::askForFocusedPlaces(std::function<void(const FocusedPlaces&)> told) const {
    thread_->askForPlaces(std::move(told));
}

void AtspiAccessibility::setFrontProcess(pid_t process) {
    thread_->tracker().setFrontProcess(process);
}

void AtspiAccessibility::focusMayHaveMoved() {
    thread_->tracker().focusMayHaveMoved();
}

void AtspiAccessibility::userTypes() {
    thread_->tracker().userTypes();
}

bool AtspiAccessibility::focusIsPassword() const {
    return thread_->focus().isPassword();
}

bool AtspiAccessibility::focusIsPasswordForKey() {
    thread_->tracker().awaitAnswers();
    return focusIsPassword();
}

void AtspiAccessibility::userMovesFocus(FocusMover mover) {
    thread_->tracker().userMovesFocus(mover);
}

bool AtspiAccessibility::takeOwnMove() {
    return thread_->tracker().takeOwnMove();
}

pid_t AtspiAccessibility::focusedProcess() const {
    return thread_->focus().process();
}

void AtspiAccessibility::switchOn() {
    thread_->switchOn();
}

AccessibilityStatus AtspiAccessibility::status() const {
    return thread_->status();
}

}  // namespace plume
