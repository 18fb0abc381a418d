#pragma once

#include <xcb/xcb.h>

#include <functional>
#include <string>

#include "testing/rig/XClient.h"

namespace plume::real {

// Sees every time that somebody takes the clipboard, also when it was the same program's before.
class CopyWatch {
  public:
    explicit CopyWatch(const std::string& display);  // throws RigError

    // What was seen so far does not count.
    void forget();
    // Waits for an owner that is accepted; false when none came within the bound.
    bool awaitOwner(rig::Milliseconds bound, const std::function<bool(xcb_window_t)>& isAccepted);

  private:
    rig::XClient client_;
    std::uint8_t firstEvent_ = 0;
};

}  // namespace plume::real
