// The engine's view of the input service: the events it hears, and what it asks about the last one.
//
// Owned by the composition root and outlives the engine. Everything here belongs to the thread that delivers the key
// events; the key events are raised synchronously, inside the callback that decides whether the key is swallowed.
#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <string>

#include "Foundation/ZDEvent.h"
#include "content/PLOutput.h"
#include "input/EventArgs.h"
#include "input/delivery/ContextInputSetting.h"
#include "platform/ProcessManager.h"
#include "platform/RunLoop.h"

namespace plume {

// The keyboard went to another program, or a shortcut may have changed the text.
struct InputContextChange {};

class InputService {
  public:
    ZDEvent<ZDKeyEventArgs> keyDownEvent;
    ZDEvent<InputContextChange> inputContextChangedEvent;
    ZDEvent<ZDMouseEventArgs> mouseDownEvent;
    ZDEvent<ZDUnregisteredHotKeyPressedEventArgs> unregisteredHotKeyPressedEvent;

    virtual ~InputService() = default;

    // The modifiers held now.
    virtual KeyModifiers keyModifier() const = 0;
    // The last key went to Plume itself.
    virtual bool isSameProcess() const = 0;
    virtual ProcessSerialNumber lastProcessReceivedKeyEvent() const = 0;
    // What a key code produces with the modifiers of these event flags.
    virtual std::optional<std::u16string> stringForKeyCode(KeyCode keyCode, EventFlags flags) const = 0;
    // What the last key produced; nothing when it produced nothing.
    virtual const std::optional<std::u16string>& lastKeyString() const = 0;

    // The application in front when its setting was last resolved, and resolving it anew; the setting is never null.
    virtual const std::optional<std::u16string>& contextBundleIdentifier() const = 0;
    virtual std::shared_ptr<const ContextInputSetting> refreshContextInputSetting() = 0;
    // Erases and delivers. From any thread: at once on the one that delivers the key events, where `cancelTrigger` and
    // the content's suffix are decided when it returns, otherwise as soon as that one can.
    virtual void sendOutput(std::shared_ptr<PLOutput> output) = 0;
    virtual void bringLastProcessToFront() = 0;

    // The loop of the thread that delivers the key events.
    virtual RunLoop& runLoop() = 0;
};

}  // namespace plume
