#include "app/linux/PasswordFieldConsent.h"

namespace plume {

namespace {

constexpr double TimeBetweenLooks = 0.5;  // seconds

}  // namespace

void PasswordFieldConsent::begin() {
    const AccessibilityStatus status = around_.accessibility.status();
    if (status == AccessibilityStatus::Starting) {
        again_ = around_.mainLoop.performAfterDelay(TimeBetweenLooks, [this] { begin(); });
    } else if (status == AccessibilityStatus::SwitchedOff) {
        if (!around_.settings.hasKey(Setting)) return ask();
        if (around_.settings.boolForKey(Setting)) around_.accessibility.switchOn();
    }
}

void PasswordFieldConsent::ask() {
    const std::string later = around_.kept
                                  ? std::string("Your answer is kept; \"plume settings ") + Setting + "\" shows it."
                                  : std::string("To switch it on at every start, set \"") + Setting +
                                        "\" to true in the settings; false asks no more.";
    around_.notices.show(
        {"Password fields in browsers",
         "Browsers and Qt programs tell Plume which field takes a password only while the desktop's accessibility is "
         "on, which makes them a little slower; until then Plume hears passwords that are typed there. " +
             later,
         {{"Switch on", [this] { answer(true); }}, {"Not now", [this] { answer(false); }}}});
}

void PasswordFieldConsent::answer(bool yes) {
    if (yes) around_.accessibility.switchOn();
    around_.report(
        std::string(yes ? "Programs tell about their password fields now; Chromium has to be started again. " : "") +
        keep(yes));
}

std::string PasswordFieldConsent::keep(bool yes) const {
    const std::string value = yes ? "true" : "false";
    if (!around_.kept)
        return "To keep this answer, set \"" + std::string(Setting) + "\" to " + value + " in the settings file.";
    const Result<void> kept = around_.kept->setObject(Setting, yes);
    return kept ? std::string(Setting) + " is " + value + " from now on."
                : "The answer is not kept: " + kept.error().message;
}

}  // namespace plume
