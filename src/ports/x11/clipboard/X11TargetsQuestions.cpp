#include "ports/x11/clipboard/X11TargetsQuestions.h"

#include <utility>

#include "ports/x11/clipboard/X11FrontPrograms.h"

namespace plume {

namespace {

// Seconds.
constexpr double LongestForStrangers = 0.03;
constexpr double LongestForThoseWhoAsk = 0.2;
constexpr std::size_t MostClients = 64;

}  // namespace

void X11TargetsQuestions::ownerChanged() {
    answered_.clear();
    changed_ = session_.runLoop().now();
    hasPasted_ = false;
}

void X11TargetsQuestions::wasAnswered(xcb_window_t requestor) {
    const xcb_window_t client = clientOf(session_, requestor);
    answered_.insert(client);
    const bool isForTheChange = session_.runLoop().now() - changed_ <= LongestForThoseWhoAsk;
    if (hasPasted_ || !isForTheChange) return;
    if (asks_.size() >= MostClients) asks_.clear();
    asks_[client] = true;
    // The answer has to be in front of the keystroke, which goes another way.
    if (paste_ && client == awaited_) waiting_ = session_.runLoop().performAfterDelay(0, [this] { proceed(); });
}

void X11TargetsQuestions::whenAnswered(std::function<void()> paste) {
    paste_ = std::move(paste);
    awaited_ = clientOf(session_, windowsInFront(session_).focus);
    const auto known = asks_.find(awaited_);
    if (answered_.contains(awaited_) || (known != asks_.end() && !known->second)) return proceed();
    const double longest = known == asks_.end() ? LongestForStrangers : LongestForThoseWhoAsk;
    waiting_ = session_.runLoop().performAfterDelay(longest, [this] { giveUp(); });
}

void X11TargetsQuestions::giveUp() {
    asks_[awaited_] = false;
    proceed();
}

void X11TargetsQuestions::proceed() {
    waiting_.cancel();
    hasPasted_ = true;
    session_.connection().sync();
    if (const auto paste = std::exchange(paste_, nullptr)) paste();
}

}  // namespace plume
