#include "ports/simulated/SimulatedKeyboard.h"

#include <utility>

#include "ports/simulated/SimulatedModifiers.h"

namespace plume {

SimulatedKeyboard::SimulatedKeyboard(RunLoop& runLoop, const InputSources& inputSources, SimulatedKeyboardTap& tap,
                                     SimulatedSystemHotKeys& hotKeys, Deliver deliver)
    : runLoop_(runLoop), inputSources_(inputSources), tap_(tap), hotKeys_(hotKeys), deliver_(std::move(deliver)) {}

void SimulatedKeyboard::press(KeyCode keyCode) {
    const bool isModifier = !modifierFlagOf(keyCode).isEmpty();
    const bool isNew = down_.insert(keyCode).second;
    if (isModifier) {
        if (isNew) arrive({TapEvent::Type::FlagsChanged, keyCode, flags(), {}, true});
        return;
    }
    const std::u16string produced = inputSources_.translateKey(keyCode, flags()).value_or(std::u16string());
    arrive({TapEvent::Type::KeyDown, keyCode, flags(), produced, true});
}

void SimulatedKeyboard::release(KeyCode keyCode) {
    if (down_.erase(keyCode) == 0) return;
    if (!modifierFlagOf(keyCode).isEmpty()) {
        arrive({TapEvent::Type::FlagsChanged, keyCode, flags(), {}, false});
        return;
    }
    const std::u16string produced = inputSources_.translateKey(keyCode, flags()).value_or(std::u16string());
    arrive({TapEvent::Type::KeyUp, keyCode, flags(), produced, false});
}

void SimulatedKeyboard::pressCharacter(std::u16string_view character) {
    arrive({TapEvent::Type::KeyDown, UnmappedKeyCode, flags(), std::u16string(character), true});
}

void SimulatedKeyboard::releaseCharacter(std::u16string_view character) {
    arrive({TapEvent::Type::KeyUp, UnmappedKeyCode, flags(), std::u16string(character), false});
}

EventFlags SimulatedKeyboard::flags() const {
    EventFlags held;
    for (const KeyCode keyCode : down_) held |= modifierFlagOf(keyCode);
    return held;
}

void SimulatedKeyboard::hold() {
    if (!canHold_) return;
    holding_ = true;
    holdLimit_ = runLoop_.performAfterDelay(LongestHold, [this] { letGo(); });
}

void SimulatedKeyboard::letGo() {
    holdLimit_.cancel();
    holding_ = false;
    // A key that follows may make the rest wait again, or even let go once more.
    if (lettingGo_) return;
    lettingGo_ = true;
    while (!holding_ && !waiting_.empty()) {
        const Waiting next = std::move(waiting_.front());
        waiting_.pop_front();
        if (next.decided) {
            pass(next.key);
        } else {
            decide(next.key);
        }
    }
    lettingGo_ = false;
}

void SimulatedKeyboard::arrive(Key key) {
    if (holding_ || !waiting_.empty()) {
        waiting_.push_back({std::move(key), false});
    } else {
        decide(key);
    }
}

bool SimulatedKeyboard::goesToInputMethod(const Key& key) const {
    constexpr EventFlags Shortcuts = EventFlag::Control | EventFlag::Option | EventFlag::Command;
    const bool typesText = !key.string.empty() && key.string.front() >= u' ';
    return key.type == TapEvent::Type::KeyDown && inputMethod_.takesText() && !key.flags.containsAny(Shortcuts) &&
           (typesText || inputMethod_.isComposing());
}

// The program hears of it only what comes of it.
void SimulatedKeyboard::compose(const Key& key) {
    TapEvent event{key.type, key.keyCode, key.flags, {}};
    event.undecided = true;
    if (tap_.swallows(event)) return;
    const SimulatedInputMethod::Outcome outcome = inputMethod_.press(key.string.empty() ? u'\0' : key.string.front());
    if (!outcome.text.empty()) deliver_({key.type, UnmappedKeyCode, {}, outcome.text, true});
    std::u16string text = outcome.text;
    const bool typesText = !key.string.empty() && key.string.front() >= u' ';
    if (outcome.keyPasses) pass(key);
    if (outcome.keyPasses && typesText) text += key.string;
    if (!text.empty()) tellDelivered(KeyCode::None, text);
    if (outcome.keyPasses && !typesText) tellDelivered(key.keyCode, {});
}

void SimulatedKeyboard::tellDelivered(KeyCode keyCode, std::u16string_view text) {
    TapEvent event{TapEvent::Type::KeyDown, keyCode, {}, text};
    event.composing = inputMethod_.isComposing();
    event.delivered = true;
    tap_.swallows(event);
}

void SimulatedKeyboard::decide(const Key& key) {
    if (goesToInputMethod(key)) return compose(key);
    if (tap_.swallows({key.type, key.keyCode, key.flags, key.string})) return;
    if (holding_) {
        // Its own output goes first; keys that came during the decision stay behind it.
        waiting_.push_front({key, true});
    } else {
        pass(key);
    }
}

void SimulatedKeyboard::pass(const Key& key) {
    if (key.type == TapEvent::Type::KeyDown && hotKeys_.press(key.keyCode, modifiersFromFlags(key.flags))) {
        takenBySystem_.insert(key.keyCode);
        return;
    }
    if (key.type == TapEvent::Type::KeyUp && takenBySystem_.erase(key.keyCode) != 0) return;
    deliver_(key);
}

}  // namespace plume
