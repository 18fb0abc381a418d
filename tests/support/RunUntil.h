// Lets a real loop run until something has happened that only it makes happen.
#pragma once

#include <functional>

#include "ports/posix/PollRunLoop.h"

namespace plume::test {

// Whether it did, within ten seconds.
inline bool runUntil(PollRunLoop& loop, const std::function<bool()>& condition) {
    const double end = loop.now() + 10;
    while (!condition() && loop.now() < end) {
        const Timer pause = loop.performAfterDelay(0.002, [&loop] { loop.stop(); });
        loop.run();
    }
    return condition();
}

}  // namespace plume::test
