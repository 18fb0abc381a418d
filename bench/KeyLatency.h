// How long keys take from their press to their letter in a text.
#pragma once

#include <poll.h>

#include <chrono>
#include <functional>
#include <vector>

#include "testing/rig/DesktopRig.h"

namespace plume::bench {

// Microseconds for each key typed, as long as `goesOn` says so of the number of keys typed before; `pause` milliseconds
// lie between them.
inline std::vector<double> keyLatencies(rig::DesktopRig& rig, rig::TargetProgram& target, int pause,
                                        const std::function<bool(int typed)>& goesOn) {
    std::vector<double> times;
    const int keycode = rig.keyboard().keycodeOf(U'a');
    for (int typed = 0; goesOn(typed); ++typed) {
        if (typed % 100 == 0) target.clear();
        const auto pressed = std::chrono::steady_clock::now();
        rig.keyboard().press(keycode);
        const auto change = target.takeChange(rig::Milliseconds(2'000));
        rig.keyboard().release(keycode);
        rig.keyboard().sync();
        if (change) times.push_back(std::chrono::duration<double, std::micro>(change->time - pressed).count());
        if (pause > 0) poll(nullptr, 0, pause);
    }
    return times;
}

inline void append(std::vector<double>& all, const std::vector<double>& more) {
    all.insert(all.end(), more.begin(), more.end());
}

}  // namespace plume::bench
