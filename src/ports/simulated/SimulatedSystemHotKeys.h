// The hot keys that the simulated system recognises by itself.
#pragma once

#include <map>

#include "platform/SystemHotKeys.h"

namespace plume {

class SimulatedSystemHotKeys final : public SystemHotKeys {
  public:
    Result<void> registerHotKey(Id id, KeyCode keyCode, KeyModifiers modifiers, std::function<void()> handler) override;
    void unregisterHotKey(Id id) override { hotKeys_.erase(id); }

    // Runs the handlers of this combination; false when there is none.
    bool press(KeyCode keyCode, KeyModifiers modifiers);

  private:
    struct HotKey {
        KeyCode keyCode;
        KeyModifiers modifiers;
        std::function<void()> handler;
    };
    std::map<Id, HotKey> hotKeys_;
};

}  // namespace plume
