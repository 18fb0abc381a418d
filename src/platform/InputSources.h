// The keyboard layout in force.
#pragma once

#include <cstdint>
#include <functional>
#include <optional>
#include <string>

namespace plume {

class InputSources {
  public:
    virtual ~InputSources() = default;
    // Identifier of the current keyboard input source; nothing when there is none. Valid until the next change.
    virtual const std::optional<std::u16string>& currentInputSourceIdentifier() const = 0;
    // What a virtual key code produces with the modifiers of an event's flag bits (0x20000 Shift, 0x40000 Control,
    // 0x80000 Option, 0x100000 Command), without regard to dead keys pressed before; nothing when it produces nothing.
    virtual std::optional<std::u16string> translateKey(std::uint16_t keyCode, std::uint64_t flags) const = 0;
    // Called on the tap thread after every change of the layout, until another listener or an empty one is set.
    virtual void setChangeListener(std::function<void()> listener) = 0;
};

}  // namespace plume
