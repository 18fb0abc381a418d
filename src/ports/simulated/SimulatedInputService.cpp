#include "ports/simulated/SimulatedInputService.h"

#include <utility>

#include "input/BundleIdentifierResolver.h"
#include "ports/simulated/SimulatedInputSources.h"

namespace plume {

SimulatedInputService::SimulatedInputService(const ProcessManager& processManager, const InputSources& inputSources,
                                             RunLoop& runLoop)
    : processManager_(processManager), inputSources_(inputSources), runLoop_(runLoop) {}

bool SimulatedInputService::pressKey(KeyCode keyCode, KeyModifiers modifiers) {
    return pressKeyProducing(keyCode, inputSources_.translateKey(keyCode, flagsFromModifiers(modifiers)), modifiers);
}

bool SimulatedInputService::pressKeyProducing(KeyCode keyCode, std::optional<std::u16string> text,
                                              KeyModifiers modifiers) {
    keyModifier_ = modifiers;
    followFrontProcess();

    ZDKeyEventArgs event;
    event.key = keyCode;
    event.s = std::move(text);
    if (event.s && !event.s->empty()) event.c = event.s->front();
    lastKeyString_ = event.s;

    const bool shortcut = modifiers.containsAny(KeyModifier::Control | KeyModifier::Command);
    const bool backspaceOfWord = modifiers.contains(KeyModifier::Option) && event.c == u'\b';
    if (shortcut || backspaceOfWord) {
        event.cancel = raiseUnregisteredHotKey(event);
    } else {
        keyDownEvent.raise(event);
    }
    keyModifier_ = {};
    return event.cancel;
}

std::u16string SimulatedInputService::typeText(std::u16string_view text) {
    std::u16string passed;
    for (std::size_t i = 0; i < text.size();) {
        const bool pair = i + 1 < text.size() && (text[i] & 0xFC00) == 0xD800 && (text[i + 1] & 0xFC00) == 0xDC00;
        const std::u16string_view character = text.substr(i, pair ? 2 : 1);
        i += character.size();

        const auto stroke = SimulatedInputSources::strokeFor(character.front());
        const bool swallowed =
            stroke ? pressKey(stroke->keyCode, stroke->shift ? KeyModifiers(KeyModifier::Shift) : KeyModifiers())
                   : pressKeyProducing(UnmappedKeyCode, std::u16string(character));
        if (!swallowed) passed += character;
    }
    return passed;
}

void SimulatedInputService::click(double x, double y) {
    ZDMouseEventArgs event;
    event.x = x;
    event.y = y;
    mouseDownEvent.raise(event);
}

bool SimulatedInputService::isSameProcess() const {
    return lastProcess_ == processManager_.currentProcess();
}

std::optional<std::u16string> SimulatedInputService::stringForKeyCode(KeyCode keyCode, EventFlags flags) const {
    return inputSources_.translateKey(keyCode, flags);
}

std::shared_ptr<const ContextInputSetting> SimulatedInputService::refreshContextInputSetting() {
    const auto front = foregroundApplication(processManager_);
    contextBundleIdentifier_ = front ? front->bundleIdentifier : std::nullopt;
    return setting_.copy();
}

// The keyboard's new owner is noticed at its first key.
void SimulatedInputService::followFrontProcess() {
    const ProcessSerialNumber front = processManager_.frontProcess().value_or(ProcessSerialNumber{});
    const bool changed = receivedKey_ && front != lastProcess_;
    receivedKey_ = true;
    lastProcess_ = front;
    if (!changed) return;
    InputContextChange change;
    inputContextChangedEvent.raise(change);
}

bool SimulatedInputService::raiseUnregisteredHotKey(const ZDKeyEventArgs& key) {
    ZDUnregisteredHotKeyPressedEventArgs event;
    event.key = key.key;
    event.c = key.c;
    event.hotKey.modifiers = keyModifier_;
    event.hotKey.keyCode = key.key;
    unregisteredHotKeyPressedEvent.raise(event);
    if (event.cancel) return true;
    InputContextChange change;
    inputContextChangedEvent.raise(change);
    return false;
}

}  // namespace plume
