#include "scenario/ScenarioLoop.h"

#include <algorithm>
#include <utility>

namespace plume {

namespace {

// What asks for itself after less time paces something.
constexpr double ShortestPeriod = 0.1;

}  // namespace

RunLoop::CallId ScenarioLoop::schedule(double delay, Call call) {
    const auto id = std::make_shared<CallId>(0);
    *id = loop_.schedule(delay, [this, id, call = std::move(call)] { run(*id, call); });
    pending_[*id].delay = delay;
    askedFor_.push_back(*id);
    return *id;
}

void ScenarioLoop::cancel(CallId id) {
    loop_.cancel(id);
    pending_.erase(id);
}

void ScenarioLoop::run(CallId id, const Call& call) {
    const Pending own = pending_[id];
    pending_.erase(id);
    askedFor_.clear();
    const std::uint64_t before = world_.stamp();
    call();
    if (askedFor_.size() != 1 || own.delay < ShortestPeriod) return;
    const auto next = pending_.find(askedFor_.front());
    if (next == pending_.end() || next->second.delay != own.delay) return;
    next->second.repeats = own.repeats || world_.stamp() == before;
}

void ScenarioLoop::waitForNoneOfThese() {
    runReady();
    for (auto& [id, pending] : pending_) pending.repeats = true;
}

void ScenarioLoop::runReady() {
    loop_.runReady();
    world_.awaitOthers();
    loop_.runReady();
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
