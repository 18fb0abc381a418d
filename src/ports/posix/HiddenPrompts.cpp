#include "ports/posix/HiddenPrompts.h"

#include <algorithm>
#include <array>
#include <utility>

#include "ports/posix/TerminalDevices.h"

namespace plume {

namespace {

using std::chrono::milliseconds;

constexpr milliseconds LongestWait{30};
constexpr milliseconds Pause{250};
// New tabs and windows bring new terminals; a program has none yet when its first window comes.
constexpr milliseconds CollectingPause{2'000};
constexpr milliseconds New{2'000};
constexpr std::array TimesBetweenLooks = {0.25, 0.75};

}  // namespace

HiddenPrompts::HiddenPrompts() : thread_([this] { loop_.run(); }) {}

HiddenPrompts::~HiddenPrompts() {
    loop_.stop();
    thread_.join();
}

void HiddenPrompts::setFrontProcess(pid_t process) {
    if (front_.exchange(process) == process) return;
    inFrontSince_ = Clock::now().time_since_epoch().count();
    hasTerminals_ = false;
    waiting_ = false;
    collected_.owe();
    loop_.perform([this] {
        collect();
        collectAfter(0);
    });
}

void HiddenPrompts::promptMayHaveCome() {
    unsure_ = true;
    // A prompt that is known may be over, and nobody types to find it out.
    loop_.perform([this] { collectAfter(0); });
}

void HiddenPrompts::userTypes() {
    const Clock::rep now = Clock::now().time_since_epoch().count();
    Clock::rep next = nextLook_.load(std::memory_order_relaxed);
    if (now < next) return;
    const Clock::rep later = now + Clock::duration(Pause).count();
    if (!nextLook_.compare_exchange_strong(next, later, std::memory_order_relaxed)) return;
    loop_.perform([this] {
        if (Clock::now() - collectedAt_ >= CollectingPause) return collect();
        waiting_ = hides();
    });
}

bool HiddenPrompts::isWaitingForKey() {
    if (unsure_.exchange(false)) {
        const Clock::duration inFront = Clock::now().time_since_epoch() - Clock::duration(inFrontSince_);
        if (hasTerminals_) {
            waiting_ = hides();
        } else if (inFront < New) {
            collected_.owe();
            loop_.perform([this] { collect(); });
        }
    }
    collected_.await(LongestWait);
    return waiting_;
}

void HiddenPrompts::collectAfter(std::size_t step) {
    nextOfSeries_ = loop_.performAfterDelay(TimesBetweenLooks.at(step), [this, step] {
        if (step + 1 < TimesBetweenLooks.size()) collectAfter(step + 1);
        collect();
    });
}

void HiddenPrompts::collect() {
    const pid_t front = front_;
    std::vector<std::string> devices = front != 0 ? terminalDevicesBelow(front) : std::vector<std::string>();
    if (front != front_) return;  // somebody collects again
    collectedAt_ = Clock::now();
    hasTerminals_ = !devices.empty();
    {
        const std::scoped_lock lock(mutex_);
        devices_ = std::move(devices);
    }
    waiting_ = hides();
    collected_.give();
}

bool HiddenPrompts::hides() const {
    const std::scoped_lock lock(mutex_);
    return std::ranges::any_of(devices_, hidesInput);
}

}  // namespace plume
