#include "ports/simulated/SimulatedKeyboardTap.h"

namespace plume {

Result<void> SimulatedKeyboardTap::create(KeyboardTapListener& listener, bool annotatedSession) {
    if (missing_) return Error{*missing_};
    listener_ = &listener;
    annotatedSession_ = annotatedSession;
    return {};
}

void SimulatedKeyboardTap::remove() {
    listener_ = nullptr;
}

Result<void> SimulatedKeyboardTap::check() const {
    if (missing_) return Error{*missing_};
    return {};
}

bool SimulatedKeyboardTap::swallows(const TapEvent& event) {
    return exists() && listener_->keyboardEvent(event);
}

}  // namespace plume
