// What is written about the state of Plume for who helps a user, and about secure input.
//
// Pure functions, from any thread. They are given what was found out about the system; no text of the library comes
// into a report. What is missing is written as nothing.
#pragma once

#include <optional>
#include <string>
#include <vector>

#include "platform/ProcessManager.h"

namespace plume {

struct DiagnosticFindings {
    std::u16string version;
    std::u16string systemVersion;
    bool isEnabled = false;
    bool hasEventTap = false;  // keys are heard
    std::optional<RunningApplication> foregroundProgram = {};
    bool secureInputIsOn = false;
    std::optional<std::u16string> secureInputApplication = {};
    std::vector<RunningApplication> otherEventTaps = {};  // who else listens to the keyboard
};

std::u16string diagnosticReport(const DiagnosticFindings& findings);

// In one sentence without its full stop. `application` is the one that has turned it on, nothing when unknown.
std::u16string secureInputStatus(bool isOn, const std::optional<std::u16string>& application);

}  // namespace plume
