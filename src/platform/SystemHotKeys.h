// Hot keys that the system itself recognises, also where the keyboard tap hears nothing.
#pragma once

#include <cstdint>
#include <functional>

#include "Foundation/KeyCode.h"
#include "Foundation/KeyModifiers.h"
#include "Foundation/Result.h"

namespace plume {

// Belongs to the tap thread, where the handlers are called.
class SystemHotKeys {
  public:
    using Id = std::uint32_t;

    virtual ~SystemHotKeys() = default;
    // In place of what was registered under this id. The error says who or what is in the way.
    virtual Result<void> registerHotKey(Id id, KeyCode keyCode, KeyModifiers modifiers,
                                        std::function<void()> handler) = 0;
    // Nothing registered under the id is no error.
    virtual void unregisterHotKey(Id id) = 0;
};

}  // namespace plume
