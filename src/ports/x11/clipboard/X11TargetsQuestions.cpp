#include "ports/x11/clipboard/X11TargetsQuestions.h"

#include <utility>

namespace plume {

namespace {

// Seconds.
constexpr double LongestForStrangers = 0.03;
constexpr double LongestForThoseWhoAsk = 0.2;
constexpr double LongestForFormerOwners = 1.0;  // one that is busy would paste what it had
constexpr std::size_t MostClients = 64;

}  // namespace

X11TargetsQuestions::X11TargetsQuestions(X11Session& session)
    : session_(session), ping_(session, [this](bool) { proceed(); }) {}

void X11TargetsQuestions::ownerChanged(xcb_window_t owner) {
    former_ = std::exchange(owner_, clientOf(session_, owner));
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
    if (client != former_) asks_[client] = true;
    // The answer has to be in front of the keystroke, which goes another way.
    if (paste_ && client == awaited_) waiting_ = session_.runLoop().performAfterDelay(0, [this] { proceed(); });
}

void X11TargetsQuestions::whenAnswered(Paste paste) {
    paste_ = std::move(paste);
    const X11FrontWindows front = windowsInFront(session_);
    awaited_ = clientOf(session_, front.focus);
    const double longest = answered_.contains(awaited_) ? 0 : longestWait(front.active);
    if (longest == 0) return proceed(front);
    waiting_ = session_.runLoop().performAfterDelay(longest, [this] { giveUp(); });
}

// In seconds.
double X11TargetsQuestions::longestWait(xcb_window_t active) {
    const bool hadClipboard = awaited_ == former_ && clientOf(session_, active) == former_;
    if (hadClipboard && ping_.send(active)) return LongestForFormerOwners;
    const auto known = asks_.find(awaited_);
    if (known == asks_.end()) return LongestForStrangers;
    return known->second ? LongestForThoseWhoAsk : 0;
}

void X11TargetsQuestions::giveUp() {
    if (!ping_.wasSent()) asks_[awaited_] = false;
    proceed();
}

void X11TargetsQuestions::proceed() {
    proceed(windowsInFront(session_));
}

// The server has answered who is in front, so it has got everything that the keystroke, which goes another way, must
// not overtake.
void X11TargetsQuestions::proceed(const X11FrontWindows& front) {
    waiting_.cancel();
    ping_.end();
    hasPasted_ = true;
    if (const auto paste = std::exchange(paste_, nullptr)) paste(front);
}

}  // namespace plume
