// An input service with nothing behind it but the simulated desktop: keys go straight to whoever listens.
//
// For trying out listeners without a tap, hot keys or delivery. Works on its caller's thread.
#pragma once

#include <memory>
#include <string_view>
#include <vector>

#include "input/InputService.h"
#include "platform/InputSources.h"

namespace plume {

class SimulatedInputService final : public InputService {
  public:
    // The key code of a character that is on no key.
    static constexpr KeyCode UnmappedKeyCode{0x7F};

    // Nothing is owned; all of it outlives the service.
    SimulatedInputService(const ProcessManager& processManager, const InputSources& inputSources, RunLoop& runLoop);

    // Presses and releases a key while these modifiers are held; whether a listener swallowed it.
    bool pressKey(KeyCode keyCode, KeyModifiers modifiers = {});
    // A key that produces this text on whatever keyboard it stands on.
    bool pressKeyProducing(KeyCode keyCode, std::optional<std::u16string> text, KeyModifiers modifiers = {});
    // One key per character, with Shift where the character needs it. What was not swallowed.
    std::u16string typeText(std::u16string_view text);
    void click(double x, double y);

    KeyModifiers keyModifier() const override { return keyModifier_; }
    bool isSameProcess() const override;
    ProcessSerialNumber lastProcessReceivedKeyEvent() const override { return lastProcess_; }
    std::optional<std::u16string> stringForKeyCode(KeyCode keyCode, EventFlags flags) const override;
    const std::optional<std::u16string>& lastKeyString() const override { return lastKeyString_; }
    const std::optional<std::u16string>& contextBundleIdentifier() const override { return contextBundleIdentifier_; }
    std::shared_ptr<const ContextInputSetting> refreshContextInputSetting() override;
    void sendOutput(std::shared_ptr<PLOutput> output) override { outputs_.push_back(std::move(output)); }
    void bringLastProcessToFront() override { ++broughtToFront_; }
    RunLoop& runLoop() override { return runLoop_; }

    // What was ordered, in order; nothing is delivered.
    const std::vector<std::shared_ptr<PLOutput>>& outputs() const { return outputs_; }
    int broughtToFront() const { return broughtToFront_; }
    // What the next resolution finds.
    void setContextInputSetting(ContextInputSetting setting) { setting_ = std::move(setting); }

  private:
    void followFrontProcess();
    bool raiseUnregisteredHotKey(const ZDKeyEventArgs& key);

    const ProcessManager& processManager_;
    const InputSources& inputSources_;
    RunLoop& runLoop_;
    KeyModifiers keyModifier_;
    bool receivedKey_ = false;
    ProcessSerialNumber lastProcess_;
    std::optional<std::u16string> lastKeyString_;
    std::optional<std::u16string> contextBundleIdentifier_;
    ContextInputSetting setting_;
    std::vector<std::shared_ptr<PLOutput>> outputs_;
    int broughtToFront_ = 0;
};

}  // namespace plume
