#include "ports/x11/watchdog/WatchdogSchedule.h"

#include <algorithm>

namespace plume {

void WatchdogSchedule::watch(bool on) {
    watching_ = on;
    listening_ = false;
    askedAt_.reset();
    // Keys may have gone down already, unheard: one question at once.
    askUntil_ = 0;
    askAt_ = on ? 0 : Never;
}

bool WatchdogSchedule::keyHeard(double now) {
    if (!watching_ || !listening_) return false;
    listening_ = false;
    askUntil_ = now + AskingTime;
    askAt_ = now;
    return true;
}

void WatchdogSchedule::answered(std::uint32_t question) {
    if (question == question_) askedAt_.reset();
}

WatchdogSchedule::Step WatchdogSchedule::next(double now) {
    if (askedAt_ && now >= *askedAt_ + AnswerTimeout) {
        watch(false);
        return Step::GiveUp;
    }
    if (askedAt_ || now < askAt_) return Step::Wait;
    ++question_;
    askedAt_ = now;
    listening_ = now >= askUntil_;
    askAt_ = listening_ ? Never : now + AskPeriod;
    return listening_ ? Step::ListenAndAsk : Step::Ask;
}

double WatchdogSchedule::nextMoment() const {
    return askedAt_ ? *askedAt_ + AnswerTimeout : askAt_;
}

}  // namespace plume
