#include "ports/x11/watchdog/Vigil.h"

#include <algorithm>

namespace plume {

void Vigil::watch(bool on) {
    watching_ = on;
    listening_ = false;
    askedAt_.reset();
    // Keys may have gone down already, unheard: one question at once.
    restAt_ = 0;
    askAt_ = on ? 0 : Never;
}

bool Vigil::keyHeard(double now) {
    if (!watching_ || !listening_) return false;
    listening_ = false;
    restAt_ = now + WakefulTime;
    askAt_ = now;
    return true;
}

void Vigil::answered(std::uint32_t question) {
    if (question == question_) askedAt_.reset();
}

Vigil::Step Vigil::next(double now) {
    if (askedAt_ && now >= *askedAt_ + Patience) {
        watch(false);
        return Step::GiveUp;
    }
    if (askedAt_ || now < askAt_) return Step::Wait;
    ++question_;
    askedAt_ = now;
    listening_ = now >= restAt_;
    askAt_ = listening_ ? Never : now + Period;
    return listening_ ? Step::ListenAndAsk : Step::Ask;
}

double Vigil::nextMoment() const {
    return askedAt_ ? *askedAt_ + Patience : askAt_;
}

}  // namespace plume
