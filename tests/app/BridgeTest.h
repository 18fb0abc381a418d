// A window's bridge between two threads: the one that hears the keys, with a desk around it, and the windows' own.
#pragma once

#include <gtest/gtest.h>

#include <algorithm>

#include "tests/input/InputDesk.h"

namespace plume {

class BridgeTest : public testing::Test {
  protected:
    void settle() {
        constexpr int Rounds = 4;
        for (int round = 0; round < Rounds; ++round) {
            desk.loop.runReady();
            main.runReady();
        }
    }
    void pass(double seconds) {
        settle();
        desk.loop.advance(seconds);
        settle();
    }
    bool keysAreHeld() const {
        const auto& events = desk.poster.events;
        return std::ranges::count(events, "hold") > std::ranges::count(events, "release");
    }
    std::uint32_t ownWindow() const { return SimulatedProcessManager::windowOf(desk.processes.currentProcess()); }

    SimulatedRunLoop main;
    InputDesk desk;
    const ProcessSerialNumber editor = *desk.processes.frontProcess();
};

}  // namespace plume
