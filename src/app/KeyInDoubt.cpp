#include "app/KeyInDoubt.h"

#include <utility>

namespace plume {

KeyInDoubt::KeyInDoubt(RunLoop& tapLoop, std::function<void()> hold) : tapLoop_(tapLoop), hold_(std::move(hold)) {}

void KeyInDoubt::keyPressed(bool mayEnd) {
    // The key behind it may be here before the loop has come to the hold.
    if (isOpen_) return hold();
    if (!mayEnd) return;
    isOpen_ = true;
    holding_ = tapLoop_.performAfterDelay(0, [this] { hold(); });
}

void KeyInDoubt::end() {
    isOpen_ = false;
    holding_.cancel();
}

void KeyInDoubt::hold() {
    end();
    hold_();
}

}  // namespace plume
