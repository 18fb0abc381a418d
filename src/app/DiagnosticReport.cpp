#include "app/DiagnosticReport.h"

#include "Foundation/Strings.h"

namespace plume {

namespace {

std::u16string enabledStatus(bool isEnabled) {
    std::u16string text = u"Plume is ";
    text += isEnabled ? u"enabled" : u"disabled";
    text += u".\n";
    if (!isEnabled) text += u"Click Plume icon on menu bar and select \"Enabled\".\n";
    return text;
}

std::u16string secureInputAdvice(const std::optional<std::u16string>& application) {
    return secureInputStatus(true, application) +
           u".\n"
           u"Try quit this app to release Secure Input.\n"
           u"If it is unidentified, try quit your running apps.";
}

std::u16string conflicts(const std::vector<RunningApplication>& processes) {
    std::u16string text = u"Processes created event tap and may conflict with Plume:\n";
    for (const RunningApplication& process : processes) {
        text += u"\t PID: " + fromUtf8(std::to_string(process.processIdentifier));
        text += u", Name: " + process.localizedName.value_or(u"");
        text += u", Identifier: " + process.bundleIdentifier.value_or(u"");
        text += u", URL: " + process.executableURL.value_or(u"") + u"\n";
    }
    return text + u"Try quit these processes.\n";
}

}  // namespace

std::u16string diagnosticReport(const DiagnosticFindings& findings) {
    std::u16string text = u"Plume version: " + findings.version + u"\n";
    text += u"System version: " + findings.systemVersion + u"\n\n";
    text += enabledStatus(findings.isEnabled) + u"\n";
    if (!findings.hasEventTap) {
        text += u"Plume is not working. Plume can not create event tap. Try restart your computer.\n";
    }
    const auto& program = findings.foregroundProgram;
    text += u"Foreground program: " + (program ? program->localizedName.value_or(u"") : u"") + u"\n\n";
    if (findings.secureInputIsOn) text += secureInputAdvice(findings.secureInputApplication);
    text += u"\n";
    if (!findings.otherEventTaps.empty()) text += conflicts(findings.otherEventTaps);
    return text;
}

std::u16string secureInputStatus(bool isOn, const std::optional<std::u16string>& application) {
    if (!isOn) return u"Secure Input is not enabled";
    // Plume itself never turns it on: whoever did is not known then either.
    const bool isKnown = application && !application->empty() && application != u"Plume";
    return u"Secure Input is enabled (by " + (isKnown ? *application : u"unidentified application") + u")";
}

}  // namespace plume
