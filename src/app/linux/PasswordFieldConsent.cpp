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
    const std::string setting = std::string("\"") + Setting + "\"";
    around_.notices.show(
        {"Password fields in browsers",
         "Browsers and Qt programs tell Plume which field takes a password only while the desktop's accessibility is "
         "on, which makes them a little slower; until then Plume hears passwords that are typed there. To switch it "
         "on at every start, set " +
             setting + " to true in the settings; false asks no more.",
         {{"Switch on", [this] { answer(true); }}, {"Not now", [this] { answer(false); }}}});
}

void PasswordFieldConsent::answer(bool yes) {
    if (yes) around_.accessibility.switchOn();
    around_.report(
        std::string(yes ? "Programs tell about their password fields now; Chromium has to be started again. " : "") +
        "To keep this answer, set \"" + Setting + "\" to " + (yes ? "true" : "false") + " in the settings file.");
}

}  // namespace plume
