// What the input service does with each key and click.
#include "input/MacInputService.h"

#include <utility>

namespace plume {

bool MacInputService::keyboardEvent(const TapEvent& event) {
    if (!active_ || delivery_.letsEverythingPass()) return false;
    forgetLastKey();
    if (hotKeyRecorder_ && !event.delivered) return record(event);
    if (event.type == TapEvent::Type::FlagsChanged) return hotKeys_.modifiersChanged(modifiersFromFlags(event.flags));
    secureInputWatch_.keysArrive();
    followFrontProcess();

    lastKeyDelivered_ = event.delivered;
    if (event.delivered) {
        keyDelivered(event);
        return false;
    }

    ZDKeyEventArgs key;
    readKey(event, key);
    lastKeyString_ = key.s;
    lastKeyCode_ = key.key;
    return event.type == TapEvent::Type::KeyUp ? keyUp(key) : keyDown(key, event);
}

void MacInputService::setHotKeyRecorder(std::function<void(const GeneralHotKey&)> recorder) {
    recordedModifiers_ = {};
    hotKeyRecorder_ = std::move(recorder);
}

// Modifiers reach the programs, which would otherwise take them for held for ever; keys do not.
bool MacInputService::record(const TapEvent& event) {
    if (event.type == TapEvent::Type::FlagsChanged) {
        const KeyModifiers held = modifiersFromFlags(event.flags);
        const bool wasLetGo = held.bits() < recordedModifiers_.bits();
        const KeyModifiers before = std::exchange(recordedModifiers_, wasLetGo ? KeyModifiers{} : held);
        // Their release ends no hot key that was registered meanwhile.
        static_cast<void>(hotKeys_.modifiersChanged(held));
        hotKeys_.ignoreNextHotKey();
        if (wasLetGo) hotKeyRecorder_({before, KeyCode::None});
        return false;
    }
    if (event.type == TapEvent::Type::KeyUp) {
        if (canceledKeyCode_ != event.keyCode) return false;
        canceledKeyCode_ = KeyCode::None;
        return true;
    }
    canceledKeyCode_ = event.keyCode;
    recordedModifiers_ = {};
    hotKeyRecorder_({hotKeys_.keyModifier(), event.keyCode});
    return true;
}

void MacInputService::keyDelivered(const TapEvent& event) {
    ZDKeyEventArgs key;
    key.key = event.keyCode;
    key.delivered = true;
    key.composing = event.composing;
    if (!event.string.empty()) {
        key.s.emplace(event.string);
        // What comes behind an expansion is what came last.
        key.c = event.string.back();
        lastKeyString_.emplace(1, key.c);
    }
    keyDownEvent.raise(key);
}

void MacInputService::mouseDown(Point location) {
    if (delivery_.letsEverythingPass()) return;
    forgetLastKey();
    ZDMouseEventArgs click;
    click.x = location.x;
    click.y = location.y;
    mouseDownEvent.raise(click);
}

void MacInputService::typingInterrupted() {
    if (active_) raiseInputContextChanged();
}

void MacInputService::forgetLastKey() {
    if (!lastKeyString_) return;
    lastKeyString_.reset();
    lastKeyCode_.reset();
}

// The keyboard's new owner is noticed at its first key.
void MacInputService::followFrontProcess() {
    const ProcessSerialNumber front = around_.processManager.frontProcess().value_or(ProcessSerialNumber{});
    const std::uint32_t window = around_.processManager.frontWindow();
    const bool changed = !isLastProcessReceivedKeyEventNull_ &&
                         (front != lastProcessReceivedKeyEvent_ || window != lastWindowReceivedKeyEvent_);
    isLastProcessReceivedKeyEventNull_ = false;
    lastProcessReceivedKeyEvent_ = front;
    lastWindowReceivedKeyEvent_ = window;
    if (changed) raiseInputContextChanged();
}

void MacInputService::raiseInputContextChanged() {
    InputContextChange change;
    inputContextChangedEvent.raise(change);
}

void MacInputService::readKey(const TapEvent& event, ZDKeyEventArgs& key) const {
    key.key = event.keyCode;
    if (!event.string.empty()) {
        key.s.emplace(event.string);
    } else if (!event.composing && !event.undecided) {
        key.s = stringForKeyCode(event.keyCode, event.flags);
    }
    if (key.s && !key.s->empty()) {
        key.c = key.s->front();
    } else if (event.command) {
        // It is told by the character on its key.
        const auto name = stringForKeyCode(event.keyCode, {});
        if (name && !name->empty()) key.c = name->front();
    }
}

bool MacInputService::keyUp(const ZDKeyEventArgs& key) {
    if (canceledKeyCode_ != KeyCode::None && canceledKeyCode_ == key.key) {
        canceledKeyCode_ = KeyCode::None;
        return true;
    }
    if (keyUpObserved_) around_.mainLoop.perform([this, copy = key]() mutable { keyUpEvent.raise(copy); });
    return false;
}

bool MacInputService::keyDown(ZDKeyEventArgs& key, const TapEvent& event) {
    bool swallow = hotKeys_.keyDown(key.key);
    if (!swallow) {
        const KeyModifiers held = keyModifier();
        const bool isShortcut = event.command || held.containsAny(KeyModifier::Control | KeyModifier::Command);
        const bool deletesWord = held.contains(KeyModifier::Option) && key.c == u'\b';
        if (isShortcut || deletesWord) {
            swallow = unregisteredHotKey(key);
        } else {
            // It is no key of the program's yet, but what can be undone until the next key no longer can.
            if (event.undecided) key.key = KeyCode::None;
            keyDownEvent.raise(key);
            swallow = key.cancel;
        }
    }
    if (swallow) canceledKeyCode_ = event.keyCode;
    return swallow;
}

bool MacInputService::unregisteredHotKey(const ZDKeyEventArgs& key) {
    ZDUnregisteredHotKeyPressedEventArgs event;
    event.hotKey = {keyModifier(), key.key};
    event.c = key.c;
    event.key = key.key;
    unregisteredHotKeyPressedEvent.raise(event);
    if (event.cancel) {
        ignoreNextHotKey();
    } else {
        raiseInputContextChanged();
    }
    return event.cancel;
}

}  // namespace plume
