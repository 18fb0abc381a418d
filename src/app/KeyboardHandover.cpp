#include "app/KeyboardHandover.h"

namespace plume {

namespace {

// Seconds.
constexpr double LongestMove = 1;
constexpr double MovePoll = 0.003;
constexpr int MovePolls = static_cast<int>(LongestMove / MovePoll);
// A window manager that is busy may have passed the first request over.
constexpr int PollsUntilAskedAgain = 30;

}  // namespace

KeyboardHandover::Owner KeyboardHandover::owner() const {
    return {processManager_.frontProcess().value_or(ProcessSerialNumber{}), processManager_.frontWindow()};
}

void KeyboardHandover::giveTo(std::uint32_t window, const Then& then) {
    move(
        window, [this, window] { return processManager_.keysArriveIn(window); }, then);
}

void KeyboardHandover::giveBackTo(const Owner& owner, const Then& then) {
    const auto isBack = [this, owner] {
        return processManager_.keysArriveIn(owner.window) && processManager_.frontProcess() == owner.process;
    };
    move(owner.window, isBack, then);
}

void KeyboardHandover::move(std::uint32_t window, const std::function<bool()>& arrived, const Then& then) {
    moving_.cancel();
    if (window == 0) return then(false);
    processManager_.activateWindow(window);
    askAgain(1, window, arrived, then);
}

void KeyboardHandover::askAgain(int attempt, std::uint32_t window, const std::function<bool()>& arrived,
                                const Then& then) {
    moving_ = tapLoop_.performAfterDelay(MovePoll, [this, attempt, window, arrived, then] {
        moving_.cancel();
        const bool hasArrived = arrived();
        if (hasArrived || attempt == MovePolls) return then(hasArrived);
        if (attempt % PollsUntilAskedAgain == 0) processManager_.activateWindow(window);
        askAgain(attempt + 1, window, arrived, then);
    });
}

}  // namespace plume
