// The keyboard layout in force.
#pragma once

#include <functional>
#include <optional>
#include <string>

#include "Foundation/KeyCode.h"
#include "Foundation/KeyModifiers.h"

namespace plume {

class InputSources {
  public:
    virtual ~InputSources() = default;
    // Identifier of the current keyboard input source; nothing when there is none. Valid until the next change.
    virtual const std::optional<std::u16string>& currentInputSourceIdentifier() const = 0;
    // What a virtual key code produces with these modifiers, without regard to dead keys pressed before; nothing when
    // it produces nothing.
    virtual std::optional<std::u16string> translateKey(KeyCode keyCode, EventFlags flags) const = 0;
    // Called on the tap thread after every change of the layout, until another listener or an empty one is set.
    virtual void setChangeListener(std::function<void()> listener) = 0;
};

}  // namespace plume
