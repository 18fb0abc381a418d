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
        if (seconds > LongestUnnoticed) holdOn(loop);
        limit_ = loop.performAfterDelay(seconds, [this] { end(); });
    }
    ~UserKeysHold() { end(); }
    UserKeysHold(const UserKeysHold&) = delete;
    UserKeysHold& operator=(const UserKeysHold&) = delete;

  private:
    // Seconds for which a key that is down may seem to stay so without repeating.
    static constexpr double LongestUnnoticed = 0.3;
    static constexpr double BetweenReminders = 1;

    void holdOn(RunLoop& loop) {
        delivery_.keepHoldingUserKeys();
        reminder_ = loop.performAfterDelay(BetweenReminders, [this, &loop] { holdOn(loop); });
    }
    void end() {
        if (ended_) return;
        ended_ = true;
        reminder_.cancel();
        delivery_.releaseUserKeys();
    }

    OutputDelivery& delivery_;
    bool ended_ = false;
    Timer limit_;
    Timer reminder_;
};

}  // namespace plume
