// Whether some program keeps what is typed to itself, and which one started it.
//
// Owned by the input service. The state belongs to the main thread, where it is asked for every 3 seconds; keysArrive()
// and state() may be called from the tap thread too.
#pragma once

#include <atomic>
#include <functional>
#include <optional>
#include <string>

#include "platform/ProcessManager.h"
#include "platform/RunLoop.h"
#include "platform/SecureInput.h"

namespace plume {

class SecureInputWatch {
  public:
    // `changed` is called on the main thread. Nothing is owned; all of it outlives the watch, and no call of either
    // loop runs once the watch is gone.
    SecureInputWatch(const SecureInput& secureInput, const ProcessManager& processManager, RunLoop& tapLoop,
                     RunLoop& mainLoop, std::function<void()> changed);

    // Main thread: asks now and every 3 seconds from now on, until stop().
    void startCheckingSecureInputTimer();
    void stop();
    void checkSecureInput();

    // Tap thread: a key came through, so nobody holds the keyboard.
    void keysArrive();

    bool state() const { return state_; }
    // Main thread: the localized name of the application in front when the state turned on; nothing while it is off.
    const std::optional<std::u16string>& lastAppEnabledSecureInput() const { return lastApp_; }

  private:
    void setState(bool on, std::optional<std::u16string> application);
    void check();

    const SecureInput& secureInput_;
    const ProcessManager& processManager_;
    RunLoop& tapLoop_;
    RunLoop& mainLoop_;
    std::function<void()> changed_;
    std::atomic<bool> state_ = false;
    std::optional<std::u16string> lastApp_;
    Timer nextCheck_;
};

}  // namespace plume
