#include "ports/posix/PollRunLoop.h"

#include <sys/eventfd.h>
#include <unistd.h>

#include <algorithm>
#include <chrono>
#include <cmath>
#include <ctime>
#include <limits>
#include <system_error>

namespace plume {

namespace {

int makeWakeUp() {
    const int descriptor = eventfd(0, EFD_CLOEXEC | EFD_NONBLOCK);
    if (descriptor < 0) throw std::system_error(errno, std::generic_category(), "eventfd");
    return descriptor;
}

constexpr double Forever = std::numeric_limits<double>::infinity();
// poll() takes no longer ones; waking up once a day harms nobody.
constexpr double LongestWait = 86400;

}  // namespace

PollRunLoop::PollRunLoop() : wakeUp_(makeWakeUp()) {}

PollRunLoop::~PollRunLoop() {
    close(wakeUp_);
}

double PollRunLoop::now() const {
    return std::chrono::duration<double>(std::chrono::steady_clock::now().time_since_epoch()).count();
}

RunLoop::CallId PollRunLoop::schedule(double delay, Call call) {
    return delayed_.add(now() + std::max(delay, 0.0), std::move(call));
}

void PollRunLoop::cancel(CallId id) {
    delayed_.cancel(id);
}

void PollRunLoop::perform(Call call) {
    {
        const std::lock_guard lock(mutex_);
        handedOver_.push_back(std::move(call));
    }
    eventfd_write(wakeUp_, 1);
}

void PollRunLoop::stop() {
    stopped_ = true;
    eventfd_write(wakeUp_, 1);
}

Subscription PollRunLoop::addSource(int descriptor, Call drain) {
    auto source = std::make_shared<Source>(Source{.drain = std::move(drain)});
    sources_.insert_or_assign(descriptor, source);
    return Subscription(std::shared_ptr<bool>(source, &source->ended));
}

void PollRunLoop::setSourcePaused(int descriptor, bool paused) {
    const auto found = sources_.find(descriptor);
    if (found != sources_.end()) found->second->paused = paused;
}

void PollRunLoop::run() {
    while (!stopped_) {
        runHandedOver();
        runDue();
        // Last: a call that waits for an answer may have made a library read more than that answer.
        drainSources();
        if (!stopped_) wait();
    }
    stopped_ = false;
}

void PollRunLoop::drainSources() {
    // By key, not by iterator: a source may add sources.
    for (auto next = sources_.begin(); next != sources_.end() && !stopped_;) {
        const auto [descriptor, source] = *next;
        if (source->ended) {
            sources_.erase(next);
        } else if (!source->paused) {
            source->drain();
        }
        next = sources_.upper_bound(descriptor);
    }
}

void PollRunLoop::runHandedOver() {
    std::deque<Call> calls;
    {
        const std::lock_guard lock(mutex_);
        calls.swap(handedOver_);
    }
    for (const Call& call : calls) call();
}

void PollRunLoop::runDue() {
    const CallId newest = delayed_.newest();
    const double moment = delayed_.firstDue() ? now() : 0;
    while (!stopped_) {
        const auto call = delayed_.takeDue(moment, newest);
        if (!call) return;
        (*call)();
    }
}

double PollRunLoop::secondsToWait() const {
    const auto due = delayed_.firstDue();
    return due ? std::clamp(*due - now(), 0.0, LongestWait) : Forever;
}

void PollRunLoop::wait() {
    polled_.clear();
    polled_.push_back({wakeUp_, POLLIN, 0});
    for (const auto& [descriptor, source] : sources_) {
        if (!source->paused && !source->ended) polled_.push_back({descriptor, POLLIN, 0});
    }
    const double seconds = secondsToWait();
    timespec limit{};
    if (seconds != Forever) {
        limit.tv_sec = static_cast<time_t>(seconds);
        limit.tv_nsec = static_cast<long>((seconds - std::floor(seconds)) * 1e9);
    }
    ppoll(polled_.data(), polled_.size(), seconds == Forever ? nullptr : &limit, nullptr);
    if (polled_.front().revents != 0) {
        eventfd_t count = 0;
        eventfd_read(wakeUp_, &count);
    }
}

}  // namespace plume
