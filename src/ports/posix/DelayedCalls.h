// The delayed calls that a run loop has been asked for, in the order in which they are due.
//
// Belongs to the loop's thread.
#pragma once

#include <map>
#include <optional>
#include <unordered_map>
#include <utility>

#include "platform/RunLoop.h"

namespace plume {

class DelayedCalls {
  public:
    using Call = RunLoop::Call;
    using CallId = RunLoop::CallId;

    // `due` is a moment of the loop's clock.
    CallId add(double due, Call call) {
        const CallId id = ++lastId_;
        delayed_.emplace(Moment(due, id), std::move(call));
        dueOf_.emplace(id, due);
        return id;
    }

    // One that has run, or is unknown, is no error.
    void cancel(CallId id) {
        const auto found = dueOf_.find(id);
        if (found == dueOf_.end()) return;
        // Kept until the bookkeeping is right: what the call holds may use the loop when it goes.
        const auto dropped = delayed_.extract(Moment(found->second, id));
        dueOf_.erase(found);
    }

    // Nothing when there is no call.
    std::optional<double> firstDue() const {
        return delayed_.empty() ? std::nullopt : std::optional(delayed_.begin()->first.first);
    }

    // The newest one: what a round of calls asks for comes in a later round, so that a call that repeats itself without
    // delay keeps nothing else waiting.
    CallId newest() const { return lastId_; }

    // The first call that is due at this moment and not newer than `newest`, no longer asked for; nothing when there is
    // none.
    std::optional<Call> takeDue(double moment, CallId newest) {
        if (delayed_.empty()) return std::nullopt;
        const auto first = delayed_.begin();
        if (first->first.first > moment || first->first.second > newest) return std::nullopt;
        auto due = delayed_.extract(first);
        dueOf_.erase(due.key().second);
        return std::move(due.mapped());
    }

  private:
    using Moment = std::pair<double, CallId>;

    CallId lastId_ = 0;
    std::map<Moment, Call> delayed_;
    std::unordered_map<CallId, double> dueOf_;
};

}  // namespace plume
