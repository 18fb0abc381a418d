#pragma once

#include "testing/rig/XClient.h"

namespace plume::rig {

// Sees the keys that programs get, whoever they go to and whether or not that program reads them.
class KeyWitness {
  public:
    // Sees what comes from now on. One thread; the display outlives the witness. Throws RigError.
    explicit KeyWitness(const std::string& display);

    // Waits until the key has gone down since the last call; throws RigError when it does not in time.
    void awaitPress(int keycode, Milliseconds bound);

  private:
    bool takePress(int keycode);

    XClient client_;
    std::uint8_t extensionOpcode_;
};

}  // namespace plume::rig
