// A key of which it is not clear yet whether it ends a window of Plume's: what follows it may be for the program behind
// that window, and is kept back until it is clear.
//
// Belongs to the tap thread; the loop outlives it.
#pragma once

#include <functional>

#include "platform/RunLoop.h"

namespace plume {

class KeyInDoubt {
  public:
    // `hold` keeps back what comes from then on; called once for a key in doubt.
    KeyInDoubt(RunLoop& tapLoop, std::function<void()> hold);

    // Within the callback of every key. The first that may end the window goes to it.
    void keyPressed(bool mayEnd);
    // It is clear, or nobody asks any more. This may be before anything is held.
    void end();

  private:
    void hold();

    RunLoop& tapLoop_;
    const std::function<void()> hold_;
    bool isOpen_ = false;  // a key is in doubt, and nothing is held yet
    Timer holding_;
};

}  // namespace plume
