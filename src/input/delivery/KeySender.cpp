#include "input/delivery/KeySender.h"

#include <unicode/utf16.h>

#include <utility>

#include "Foundation/KeyCode.h"
#include "Foundation/KeyModifiers.h"
#include "input/AXUtils.h"
#include "input/delivery/OutputFragments.h"

namespace plume {

namespace {

// Carries typed text; which key it is does not matter.
constexpr KeyCode TextKey = KeyCode::A;
// Does nothing by itself.
constexpr KeyCode Separator = KeyCode::Control;
// A letter that no word is likely to go on with.
constexpr std::u16string_view Overtyping = u"x";

}  // namespace

KeySender::Sending::Sending(KeySender& sender) : sender_(sender) {
    sender_.sending_ = true;
    sender_.poster_.begin();
}

KeySender::Sending::~Sending() {
    sender_.poster_.end();
    sender_.sending_ = false;
}

KeySender::KeySender(EventPoster& poster, const Accessibility& accessibility)
    : poster_(poster), accessibility_(accessibility) {}

void KeySender::post(KeyCode keyCode, EventFlags flags, bool down, std::u16string_view text) {
    const bool pastTap = setting_ && setting_->has(InputFlag::PostToSessionEventTap);
    poster_.post({keyCode, flags, down, text}, pastTap);
}

void KeySender::press(KeyCode keyCode, EventFlags flags) {
    lastCharacter_.clear();
    if (std::exchange(lastKey_, keyCode) == keyCode && losesRepeatedKeys()) tap(Separator, {});
    tap(keyCode, flags);
}

void KeySender::tap(KeyCode keyCode, EventFlags flags, std::u16string_view text) {
    post(keyCode, flags, true, text);
    post(keyCode, flags, false, text);
}

void KeySender::type(std::u16string_view text) {
    lastKey_ = KeyCode::None;
    std::size_t start = 0;
    if (losesRepeatedKeys()) {
        for (std::size_t at = 0, next = 0; at < text.size(); at = next) {
            U16_FWD_1(text, next, text.size());
            const auto character = text.substr(at, next - at);
            const bool isRepeated = character == lastCharacter_;
            lastCharacter_ = character;
            if (!isRepeated) continue;
            if (at > start) tap(TextKey, {}, text.substr(start, at - start));
            tap(Separator, {});
            start = at;
        }
    }
    tap(TextKey, {}, text.substr(start));
}

void KeySender::press(const Keystrokes& keys) {
    for (const Keystroke& key : keys) {
        if (key.letter == 0) {
            press(key.keyCode, key.flags);
        } else if (key.flags.isEmpty()) {
            type({&key.letter, 1});
        } else {
            press(poster_.keyCodeOfLetter(key.letter), key.flags);
        }
    }
}

void KeySender::sendPlainText(std::u16string_view text) {
    const Sending sending(*this);
    for (const auto& chunk : fragmentsForPlainText(text, setting_ ? *setting_ : ContextInputSetting{})) type(chunk);
}

void KeySender::sendKey(KeyCode keyCode, EventFlags flags, std::uint64_t count) {
    const Sending sending(*this);
    for (std::uint64_t i = 0; i < count; ++i) press(keyCode, flags);
}

void KeySender::sendBackspaces(std::uint64_t count) {
    if (count == 0) return;
    const Sending sending(*this);
    // A proposal that was overwritten may still be told as selected.
    const bool mayBeSelected = !setting_ || !setting_->overtypesCompletion;
    if (mayBeSelected && AXUtils::getSelectedTextLength(accessibility_) != 0) press(KeyCode::ForwardDelete, {});
    for (std::uint64_t i = 0; i < count; ++i) press(KeyCode::Delete, {});
}

void KeySender::sendLeftArrowKeys(std::uint64_t count) {
    sendKey(KeyCode::Left, {}, count);
}

void KeySender::sendShiftTab() {
    sendKey(KeyCode::Tab, EventFlag::Shift);
}

void KeySender::overtypeCompletion() {
    const Sending sending(*this);
    type(Overtyping);
    press(KeyCode::Delete, {});
}

void KeySender::sendCopyCommand(const ContextInputSetting& setting, bool withControl) {
    const Sending sending(*this);
    if (setting.copyKeys) return press(*setting.copyKeys);
    post(commandKeys_.c, withControl ? EventFlag::Control : EventFlag::Command, true);
    post(commandKeys_.c, {}, false);
}

void KeySender::sendPasteCommand(const ContextInputSetting& setting) {
    const Sending sending(*this);
    if (setting.pasteKeys && !setting.has(InputFlag::AlternativePasting)) return press(*setting.pasteKeys);
    const EventFlag modifier = setting.has(InputFlag::UseControlKey) ? EventFlag::Control : EventFlag::Command;
    // A V that the user still holds would make our press of it no press at all.
    if (poster_.isKeyDown(commandKeys_.v)) post(commandKeys_.v, {}, false);
    if (setting.has(InputFlag::AlternativePasting)) return sendAlternativePaste(setting, modifier);
    post(commandKeys_.v, modifier, true);
    post(commandKeys_.v, {}, false);
}

void KeySender::sendAlternativePaste(const ContextInputSetting& setting, EventFlag modifier) {
    const KeyCode modifierKey = setting.has(InputFlag::UseControlKey) ? KeyCode::Control : KeyCode::Command;
    const EventFlags flags = setting.has(InputFlag::DoNotSetModifier) ? EventFlags() : modifier;
    if (poster_.isKeyDown(KeyCode::Shift)) post(KeyCode::Shift, {}, false);
    post(modifierKey, {}, true);
    press(commandKeys_.v, flags);
    post(modifierKey, {}, false);
}

}  // namespace plume
