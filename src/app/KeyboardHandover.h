// Gives the keyboard to a window of Plume's and back to the window that had it, and says whether it arrived there:
// nothing may be sent before that is sure.
//
// Belongs to the tap thread; what it works on outlives it. Nothing waits: who has the keyboard is asked again and
// again.
#pragma once

#include <cstdint>
#include <functional>

#include "platform/ProcessManager.h"
#include "platform/RunLoop.h"

namespace plume {

class KeyboardHandover {
  public:
    // Who has the keyboard.
    struct Owner {
        ProcessSerialNumber process;
        std::uint32_t window = 0;
    };
    // Called once, unless cancel(), another handover or the end of the object comes first.
    using Then = std::function<void(bool hasArrived)>;

    KeyboardHandover(ProcessManager& processManager, RunLoop& tapLoop)
        : processManager_(processManager), tapLoop_(tapLoop) {}

    Owner owner() const;
    bool hasKeyboard(std::uint32_t window) const { return window != 0 && processManager_.frontWindow() == window; }
    // Asks for the window to get the keyboard until keys arrive there, or a second has gone.
    void giveTo(std::uint32_t window, const Then& then);
    // The same, and its process has to be the same, too: numbers of windows are used again.
    void giveBackTo(const Owner& owner, const Then& then);
    void cancel() { moving_.cancel(); }

  private:
    void move(std::uint32_t window, const std::function<bool()>& arrived, const Then& then);
    void askAgain(int attempt, std::uint32_t window, const std::function<bool()>& arrived, const Then& then);

    ProcessManager& processManager_;
    RunLoop& tapLoop_;
    Timer moving_;
};

}  // namespace plume
