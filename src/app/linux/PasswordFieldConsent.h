// Asks the user whether programs may tell about their password fields.
//
// Some programs, browsers above all, tell nothing of their fields unless the desktop's accessibility is on, which costs
// them time and memory. So it is the user who switches it on, by a setting or by answering a notice.
#pragma once

#include <functional>
#include <string>
#include <utility>

#include "platform/Notices.h"
#include "platform/RunLoop.h"
#include "platform/UserDefaults.h"
#include "ports/atspi/AtspiAccessibility.h"

namespace plume {

// Belongs to the main thread.
class PasswordFieldConsent {
  public:
    // The setting: true switches accessibility on at every start, false asks no more. An answer becomes its value.
    static constexpr const char* Setting = "LetProgramsTellPasswordFields";

    struct Dependencies {
        AtspiAccessibility& accessibility;
        Notices& notices;
        RunLoop& mainLoop;
        const UserDefaults& settings;
        std::function<void(const std::string& sentence)> report;
        // Keeps the answer, so that the user is asked once; without it, the user has to.
        WritableUserDefaults* kept = nullptr;
    };

    // All of them outlive it; no notice is answered any more once it is gone.
    explicit PasswordFieldConsent(Dependencies dependencies) : around_(std::move(dependencies)) {}
    PasswordFieldConsent(const PasswordFieldConsent&) = delete;
    PasswordFieldConsent& operator=(const PasswordFieldConsent&) = delete;

    // Does what the setting says, as soon as it is known whether accessibility is off; asks when it says nothing.
    void begin();

  private:
    void ask();
    void answer(bool yes);
    std::string keep(bool yes) const;

    const Dependencies around_;
    Timer again_;
};

}  // namespace plume
