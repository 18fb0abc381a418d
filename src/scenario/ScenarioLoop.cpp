#include "scenario/ScenarioLoop.h"

#include <algorithm>
#include <utility>

namespace plume {

namespace {

// Calls that ask for themselves after less time send something piece by piece; they end.
constexpr double ShortestPeriod = 0.1;  // seconds

}  // namespace

RunLoop::CallId ScenarioLoop::schedule(double delay, Call call) {
    const CallId id = ++lastId_;
    Timer timer = loop_.performAfterDelay(delay, [this, id, call = std::move(call)] { run(id, call); });
    pending_.emplace(id, Pending{std::move(timer), delay, false});
    scheduledByCall_.push_back(id);
    return id;
}

void ScenarioLoop::cancel(CallId id) {
    // Taken out first: what the call holds may use the loop when it goes.
    const auto dropped = pending_.extract(id);
}

void ScenarioLoop::run(CallId id, const Call& call) {
    const auto extracted = pending_.extract(id);
    const Pending& own = extracted.mapped();
    scheduledByCall_.clear();
    const std::uint64_t before = hooks_.visibleChanges();
    call();
    if (scheduledByCall_.size() != 1 || own.delay < ShortestPeriod) return;
    const auto next = pending_.find(scheduledByCall_.front());
    if (next == pending_.end() || next->second.delay != own.delay) return;
    next->second.repeats = own.repeats || hooks_.visibleChanges() == before;
}

void ScenarioLoop::perform(Call call) {
    if (std::this_thread::get_id() == thread_) return loop_.perform(std::move(call));
    const std::lock_guard lock(mutex_);
    scriptResults_.push_back(std::move(call));
}

bool ScenarioLoop::takeScriptResults() {
    std::vector<Call> results;
    {
        const std::lock_guard lock(mutex_);
        results.swap(scriptResults_);
    }
    for (Call& result : results) {
        if (scriptTime_ > 0) {
            schedule(scriptTime_, std::move(result));
        } else {
            loop_.perform(std::move(result));
        }
    }
    return !results.empty();
}

void ScenarioLoop::markPendingAsRepeating() {
    runReady();
    for (auto& [id, pending] : pending_) pending.repeats = true;
}

void ScenarioLoop::runReady() {
    loop_.runReady();
    hooks_.waitForScripts();
    // What a script has given may begin another one.
    while (takeScriptResults()) {
        loop_.runReady();
        hooks_.waitForScripts();
    }
}

bool ScenarioLoop::isIdle() const {
    return std::all_of(pending_.begin(), pending_.end(), [](const auto& entry) { return entry.second.repeats; });
}

void ScenarioLoop::runUntilIdle(double maximumSeconds) {
    const double end = loop_.now() + maximumSeconds;
    runReady();
    while (!isIdle()) {
        const std::optional<double> due = loop_.nextDue();
        if (!due || *due > end) return;
        loop_.setNow(*due);
        runReady();
    }
}

void ScenarioLoop::advanceTo(double moment) {
    runReady();
    for (auto due = loop_.nextDue(); due && *due <= moment; due = loop_.nextDue()) {
        loop_.setNow(*due);
        runReady();
    }
    loop_.setNow(moment);
}

}  // namespace plume
