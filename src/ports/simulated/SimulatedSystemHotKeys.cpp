#include "ports/simulated/SimulatedSystemHotKeys.h"

#include <utility>

namespace plume {

Result<void> SimulatedSystemHotKeys::registerHotKey(Id id, KeyCode keyCode, KeyModifiers modifiers,
                                                    std::function<void()> handler) {
    for (const auto& [otherId, other] : hotKeys_) {
        if (otherId != id && other.keyCode == keyCode && other.modifiers == modifiers) {
            return Error{"This key combination is taken by another hot key; choose a different one."};
        }
    }
    hotKeys_.insert_or_assign(id, HotKey{keyCode, modifiers, std::move(handler)});
    return {};
}

bool SimulatedSystemHotKeys::press(KeyCode keyCode, KeyModifiers modifiers) {
    for (const auto& [id, hotKey] : hotKeys_) {
        if (hotKey.keyCode != keyCode || hotKey.modifiers != modifiers) continue;
        // The handler may register the hot key anew.
        const auto handler = hotKey.handler;
        handler();
        return true;
    }
    return false;
}

}  // namespace plume
