#include "ports/simulated/SimulatedRunLoop.h"

#include <algorithm>
#include <cstddef>
#include <stdexcept>

namespace plume {

namespace {

constexpr std::size_t MaxCallsAtOneMoment = 100'000;

}  // namespace

RunLoop::CallId SimulatedRunLoop::schedule(double delay, Call call) {
    const double due = delay > 0 ? now_ + delay : now_;
    const CallId id = ++lastId_;
    delayed_.emplace(Moment(due, id), std::move(call));
    dueOf_.emplace(id, due);
    return id;
}

void SimulatedRunLoop::cancel(CallId id) {
    const auto found = dueOf_.find(id);
    if (found == dueOf_.end()) return;
    // Kept until the bookkeeping is right: what the call holds may use the loop when it goes.
    const auto dropped = delayed_.extract(Moment(found->second, id));
    dueOf_.erase(found);
}

void SimulatedRunLoop::perform(Call call) {
    const std::lock_guard lock(mutex_);
    handedOver_.push_back(std::move(call));
}

RunLoop::Call SimulatedRunLoop::takeHandedOverCall() {
    const std::lock_guard lock(mutex_);
    if (handedOver_.empty()) return nullptr;
    Call call = std::move(handedOver_.front());
    handedOver_.pop_front();
    return call;
}

RunLoop::Call SimulatedRunLoop::takeReadyCall() {
    if (Call call = takeHandedOverCall()) return call;
    const auto first = delayed_.begin();
    if (first == delayed_.end() || first->first.first > now_) return nullptr;
    Call call = std::move(first->second);
    dueOf_.erase(first->first.second);
    delayed_.erase(first);
    return call;
}

void SimulatedRunLoop::runReady() {
    std::size_t count = 0;
    while (const Call call = takeReadyCall()) {
        if (++count > MaxCallsAtOneMoment) throw std::runtime_error("The calls of the simulated run loop never end.");
        call();
    }
}

void SimulatedRunLoop::advanceTo(double target) {
    runReady();
    for (auto due = nextDue(); due && *due <= target; due = nextDue()) {
        setNow(*due);
        runReady();
    }
    setNow(target);
}

void SimulatedRunLoop::advance(double seconds) {
    advanceTo(now_ + std::max(seconds, 0.0));
}

void SimulatedRunLoop::setNow(double seconds) {
    now_ = std::max(now_, seconds);
}

std::optional<double> SimulatedRunLoop::nextDue() const {
    if (delayed_.empty()) return std::nullopt;
    return delayed_.begin()->first.first;
}

}  // namespace plume
