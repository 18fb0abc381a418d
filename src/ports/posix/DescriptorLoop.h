// A run loop that is also woken by what arrives at descriptors.
#pragma once

#include "Foundation/Subscription.h"
#include "platform/RunLoop.h"

namespace plume {

class DescriptorLoop : public RunLoop {
  public:
    // Calls `drain` when the descriptor can be read, perhaps also when it cannot; it must take all there is and never
    // wait. Until the subscription ends, which comes before the descriptor is closed. Only on the loop's own thread, or
    // before the loop runs.
    [[nodiscard]] virtual Subscription addSource(int descriptor, Call drain) = 0;
};

}  // namespace plume
