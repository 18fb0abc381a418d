#include "ports/simulated/SimulatedKeyboardTap.h"

namespace plume {

Result<void> SimulatedKeyboardTap::create(KeyboardTapListener& listener, bool annotatedSession) {
    if (missing_) return Error{*missing_};
    listener_ = &listener;
    annotatedSession_ = annotatedSession;
    enabled_ = true;
    return {};
}

void SimulatedKeyboardTap::remove() {
    listener_ = nullptr;
    enabled_ = false;
}

Result<void> SimulatedKeyboardTap::check() const {
    if (missing_) return Error{*missing_};
    return {};
}

void SimulatedKeyboardTap::disableByTimeout() {
    if (!exists()) return;
    enabled_ = false;
    listener_->tapDisabledByTimeout();
}

bool SimulatedKeyboardTap::swallows(const TapEvent& event) {
    return enabled_ && listener_->keyboardEvent(event);
}

}  // namespace plume
