// The clock of a scenario: the simulated run loop, which also knows which calls somebody waits for and which belong to
// timers that repeat for good.
//
// A call repeats for good when all it does is ask for itself again after the same time. Such a call runs when time
// passes, but the scenario does not wait for it.
#pragma once

#include <functional>
#include <map>
#include <mutex>
#include <thread>
#include <vector>

#include "ports/simulated/SimulatedRunLoop.h"

namespace plume {

class ScenarioLoop final : public RunLoop {
  public:
    struct Hooks {
        // Grows with everything that happens on the desktop and can be seen there.
        std::function<std::uint64_t()> visibleChanges;
        // Blocks until every script that runs has handed its result over.
        std::function<void()> waitForScripts;
    };

    // The loop is not owned and outlives this one. What scripts have given comes `scriptTime` seconds after they began.
    ScenarioLoop(SimulatedRunLoop& loop, double scriptTime, Hooks hooks)
        : loop_(loop), scriptTime_(scriptTime), hooks_(std::move(hooks)) {}

    double now() const override { return loop_.now(); }
    // Other threads hand over what scripts have given.
    void perform(Call call) override;

    // The calls that wait now count as timers that repeat for good.
    void markPendingAsRepeating();
    // Runs what is due, then what is due next, until only repeating calls are left or this many seconds have passed.
    void runUntilIdle(double maximumSeconds);
    // Lets this time pass, or until this moment.
    void advance(double seconds) { advanceTo(loop_.now() + seconds); }
    void advanceTo(double moment);

  private:
    struct Pending {
        Timer timer;
        double delay = 0;
        bool repeats = false;
    };

    CallId schedule(double delay, Call call) override;
    void cancel(CallId id) override;

    void run(CallId id, const Call& call);
    void runReady();
    bool takeScriptResults();
    bool isIdle() const;

    SimulatedRunLoop& loop_;
    const double scriptTime_;
    const Hooks hooks_;
    const std::thread::id thread_ = std::this_thread::get_id();
    std::mutex mutex_;
    std::vector<Call> scriptResults_;  // guarded by mutex_
    CallId lastId_ = 0;
    std::map<CallId, Pending> pending_;
    std::vector<CallId> scheduledByCall_;  // what the call that runs has asked for
};

}  // namespace plume
