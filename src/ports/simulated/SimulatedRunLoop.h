// A run loop whose time stands still until somebody moves it: what takes seconds for a person takes no time in a test.
#pragma once

#include <cstdint>
#include <deque>
#include <map>
#include <mutex>
#include <optional>
#include <unordered_map>
#include <utility>

#include "platform/RunLoop.h"

namespace plume {

// Owned by one thread, which runs the calls from within the operations that say so; only perform() may be called from
// others. Calls may use every operation, also those that run further calls. Calls that have not run when the loop is
// destroyed are dropped.
//
// Operations that run calls throw std::runtime_error when calls keep asking for further ones without end at one moment.
class SimulatedRunLoop final : public RunLoop {
  public:
    double now() const override { return now_; }
    void perform(Call call) override;

    // Runs what was handed over and what is due, and all that these ask for at once; the time stays.
    void runReady();
    // Moves the time on by `seconds`, stopping at each moment at which a call is due to run it.
    void advance(double seconds);
    // Moves the time on without running anything: the calls that are due by then come late. Earlier times are ignored.
    void setNow(double seconds);

    // When the next delayed call is due; nothing when there is none. Calls handed over are not counted.
    std::optional<double> nextDue() const;

  private:
    using Moment = std::pair<double, CallId>;

    CallId schedule(double delay, Call call) override;
    void cancel(CallId id) override;

    // The next call to run now, taken from where it waits; empty when there is none.
    Call takeReadyCall();
    Call takeHandedOverCall();
    void advanceTo(double target);

    double now_ = 0;
    CallId lastId_ = 0;
    std::map<Moment, Call> delayed_;
    std::unordered_map<CallId, double> dueOf_;
    std::mutex mutex_;
    std::deque<Call> handedOver_;  // guarded by mutex_
};

}  // namespace plume
