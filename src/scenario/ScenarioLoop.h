// The scenario's clock: the simulated run loop, with the difference kept between calls that somebody waits for and
// timers that repeat for good.
//
// A call repeats for good when all it does is ask for itself again after the same time; such a call runs when time
// passes, but time does not pass for its sake.
#pragma once

#include <functional>
#include <map>
#include <memory>
#include <string>
#include <vector>

#include "ports/simulated/SimulatedRunLoop.h"

namespace plume {

class ScenarioLoop final : public RunLoop {
  public:
    struct World {
        // Differs when something has happened that can be seen.
        std::function<std::uint64_t()> stamp;
        // Blocks until what runs outside of the loop has handed its results over.
        std::function<void()> awaitOthers;
    };

    // The loop is not owned and outlives this one.
    ScenarioLoop(SimulatedRunLoop& loop, World world) : loop_(loop), world_(std::move(world)) {}

    double now() const override { return loop_.now(); }
    CallId schedule(double delay, Call call) override;
    void cancel(CallId id) override;
    void perform(Call call) override { loop_.perform(std::move(call)); }

    // From now on the calls that wait count as timers that repeat for good.
    void waitForNoneOfThese();
    // Runs what is due, then what is due next, until nothing that counts is left or this many seconds have passed.
    void runUntilIdle(double maximumSeconds);
    // Lets this time pass, or until this moment.
    void advance(double seconds) { advanceTo(loop_.now() + seconds); }
    void advanceTo(double moment);

  private:
    struct Pending {
        double delay = 0;
        bool repeats = false;
    };

    void run(CallId id, const Call& call);
    void runReady();
    bool isIdle() const;

    SimulatedRunLoop& loop_;
    const World world_;
    std::map<CallId, Pending> pending_;
    std::vector<CallId> askedFor_;  // by the call that runs
};

}  // namespace plume
