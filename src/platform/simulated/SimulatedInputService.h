// An input service with nothing behind it but the simulated desktop: keys go straight to whoever listens.
//
// For trying out listeners without a tap, hot keys or delivery. Works on its caller's thread.
#pragma once

#include <string_view>

#include "input/InputService.h"
#include "platform/InputSources.h"

namespace plume {

class SimulatedInputService final : public InputService {
  public:
    // The key code of a character that is on no key.
    static constexpr std::uint16_t UnmappedKeyCode = 0x7F;

    // Nothing is owned; all of it outlives the service.
    SimulatedInputService(const ProcessManager& processManager, const InputSources& inputSources, RunLoop& runLoop);

    // Presses and releases a key while these modifiers are held; whether a listener swallowed it.
    bool pressKey(std::uint16_t keyCode, std::int32_t modifiers = 0);
    // A key that produces this text on whatever keyboard it stands on.
    bool pressKeyProducing(std::uint16_t keyCode, std::optional<std::u16string> text, std::int32_t modifiers = 0);
    // One key per character, with Shift where the character needs it. What was not swallowed.
    std::u16string typeText(std::u16string_view text);
    void click(double x, double y);

    std::int32_t keyModifier() const override { return keyModifier_; }
    bool isSameProcess() const override;
    ProcessSerialNumber lastProcessReceivedKeyEvent() const override { return lastProcess_; }
    std::optional<std::u16string> stringForKeyCode(std::uint16_t keyCode, std::uint64_t flags) const override;
    RunLoop& runLoop() override { return runLoop_; }

  private:
    void followFrontProcess();
    bool raiseUnregisteredHotKey(const ZDKeyEventArgs& key);

    const ProcessManager& processManager_;
    const InputSources& inputSources_;
    RunLoop& runLoop_;
    std::int32_t keyModifier_ = 0;
    bool receivedKey_ = false;
    ProcessSerialNumber lastProcess_;
};

}  // namespace plume
