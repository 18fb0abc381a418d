#include "ports/posix/HiddenPrompts.h"

#include <algorithm>

#include "ports/posix/TerminalDevices.h"

namespace plume {

namespace {

using std::chrono::milliseconds;

constexpr milliseconds LongestWait{30};
constexpr milliseconds Pause{250};
// New tabs and windows bring new terminals.
constexpr milliseconds CollectingPause{2'000};
constexpr double MomentForAnswer = 0.5;  // seconds

}  // namespace

HiddenPrompts::HiddenPrompts() : thread_([this] { loop_.run(); }) {}

HiddenPrompts::~HiddenPrompts() {
    loop_.stop();
    thread_.join();
}

void HiddenPrompts::setFrontProcess(pid_t process) {
    if (front_.exchange(process) == process) return;
    waiting_ = false;
    hasTerminals_ = false;
    looked_.owe();
    loop_.perform([this] { look(true); });
}

void HiddenPrompts::promptMayHaveCome() {
    unsure_ = true;
    // The prompt that is known may be over: nobody types to find it out.
    if (waiting_) {
        loop_.perform([this] { laterLook_ = loop_.performAfterDelay(MomentForAnswer, [this] { look(false); }); });
    }
}

void HiddenPrompts::userTypes() {
    const Clock::rep now = Clock::now().time_since_epoch().count();
    Clock::rep next = nextLook_.load(std::memory_order_relaxed);
    if (now < next) return;
    const Clock::rep later = now + Clock::duration(Pause).count();
    if (!nextLook_.compare_exchange_strong(next, later, std::memory_order_relaxed)) return;
    loop_.perform([this] { look(false); });
}

bool HiddenPrompts::isWaitingForKey() {
    if (unsure_.exchange(false) && hasTerminals_) {
        looked_.owe();
        loop_.perform([this] { look(false); });
    }
    looked_.await(LongestWait);
    return waiting_;
}

void HiddenPrompts::look(bool anew) {
    const pid_t front = front_;
    const Clock::time_point now = Clock::now();
    const bool isKnown = front == process_;
    const auto waits = [this] { return std::ranges::any_of(devices_, hidesInput); };
    // Those that are known answer at once.
    if (isKnown && !anew) {
        waiting_ = waits();
        looked_.give();
    }
    if (isKnown && !anew && now - collectedAt_ < CollectingPause) return;
    process_ = front;
    collectedAt_ = now;
    devices_ = front != 0 ? terminalDevicesBelow(front) : std::vector<std::string>();
    const bool found = waits();
    if (front != front_) return;  // somebody looks again
    hasTerminals_ = !devices_.empty();
    waiting_ = found;
    looked_.give();
}

}  // namespace plume
