#include "input/SecureInputWatch.h"

#include <utility>

#include "input/BundleIdentifierResolver.h"

namespace plume {

namespace {
constexpr double CheckInterval = 3.0;  // seconds
}

SecureInputWatch::SecureInputWatch(const SecureInput& secureInput, const ProcessManager& processManager,
                                   RunLoop& tapLoop, RunLoop& mainLoop, std::function<void()> changed)
    : secureInput_(secureInput),
      processManager_(processManager),
      tapLoop_(tapLoop),
      mainLoop_(mainLoop),
      changed_(std::move(changed)) {}

void SecureInputWatch::startCheckingSecureInputTimer() {
    stop();
    check();
}

void SecureInputWatch::check() {
    checkSecureInput();
    nextCheck_ = mainLoop_.performAfterDelay(CheckInterval, [this] { check(); });
}

void SecureInputWatch::stop() {
    nextCheck_.cancel();
}

void SecureInputWatch::checkSecureInput() {
    const bool on = secureInput_.isSecureEventInputEnabled();
    if (on == state_) return;
    if (!on) return setState(false, std::nullopt);
    // Who is in front is known on the tap thread.
    tapLoop_.perform([this] {
        auto front = foregroundApplication(processManager_);
        auto name = front ? std::move(front->localizedName) : std::nullopt;
        mainLoop_.perform([this, name = std::move(name)]() mutable { setState(true, std::move(name)); });
    });
}

void SecureInputWatch::keysArrive() {
    if (!state_) return;
    mainLoop_.perform([this] { setState(false, std::nullopt); });
}

void SecureInputWatch::setState(bool on, std::optional<std::u16string> application) {
    if (on == state_) return;
    lastApp_ = std::move(application);
    state_ = on;
    changed_();
}

}  // namespace plume
