// Keeps the user's own keys back while it exists, but for no longer than it was made for.
//
// Made by the input service, which outlives it; belongs to the tap thread. Several may exist at a time, beside outputs
// that are on their way: the keys follow, in order, when the last of them has ended. A port that cannot keep keys back
// does nothing.
#pragma once

#include "input/delivery/OutputDelivery.h"
#include "platform/RunLoop.h"

namespace plume {

class UserKeysHold {
  public:
    UserKeysHold(OutputDelivery& delivery, RunLoop& loop, double seconds) : delivery_(delivery) {
        delivery_.holdUserKeys();
        limit_ = loop.performAfterDelay(seconds, [this] { end(); });
    }
    ~UserKeysHold() { end(); }
    UserKeysHold(const UserKeysHold&) = delete;
    UserKeysHold& operator=(const UserKeysHold&) = delete;

  private:
    void end() {
        if (ended_) return;
        ended_ = true;
        delivery_.releaseUserKeys();
    }

    OutputDelivery& delivery_;
    bool ended_ = false;
    Timer limit_;
};

}  // namespace plume
