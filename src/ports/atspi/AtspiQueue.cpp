#include "ports/atspi/AtspiQueue.h"

namespace plume {

using std::chrono::steady_clock;

void AtspiQueue::end() {
    ended_ = true;
    loop_.stop();
}

bool AtspiQueue::answersAreExpected() const {
    return open_ && !ended_ && steady_clock::now().time_since_epoch().count() >= pausedUntil_;
}

void AtspiQueue::expectNoAnswers() {
    pausedUntil_ = (steady_clock::now() + Pause).time_since_epoch().count();
}

}  // namespace plume
