#include "input/delivery/KeySender.h"

#include "Foundation/KeyCode.h"
#include "Foundation/KeyModifiers.h"
#include "input/AXUtils.h"
#include "input/delivery/OutputFragments.h"

namespace plume {

namespace {

// Carries typed text; which key it is does not matter.
constexpr KeyCode TextKey = KeyCode::A;

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
    post(keyCode, flags, true);
    post(keyCode, flags, false);
}

void KeySender::sendPlainText(std::u16string_view text) {
    const Sending sending(*this);
    for (const auto& chunk : fragmentsForPlainText(text, setting_ ? *setting_ : ContextInputSetting{})) {
        post(TextKey, {}, true, chunk);
        post(TextKey, {}, false, chunk);
    }
}

void KeySender::sendKey(KeyCode keyCode, EventFlags flags, std::uint64_t count) {
    const Sending sending(*this);
    for (std::uint64_t i = 0; i < count; ++i) press(keyCode, flags);
}

void KeySender::sendBackspaces(std::uint64_t count) {
    if (count == 0) return;
    const Sending sending(*this);
    if (AXUtils::getSelectedTextLength(accessibility_) != 0) press(KeyCode::ForwardDelete, {});
    for (std::uint64_t i = 0; i < count; ++i) press(KeyCode::Delete, {});
}

void KeySender::sendLeftArrowKeys(std::uint64_t count) {
    sendKey(KeyCode::Left, {}, count);
}

void KeySender::sendShiftTab() {
    sendKey(KeyCode::Tab, EventFlag::Shift);
}

void KeySender::sendCopyCommand(bool withControl) {
    const Sending sending(*this);
    if (const auto own = poster_.copyKeystroke()) return press(own->keyCode, own->flags);
    post(commandKeys_.c, withControl ? EventFlag::Control : EventFlag::Command, true);
    post(commandKeys_.c, {}, false);
}

void KeySender::sendPasteCommand(const ContextInputSetting& setting) {
    const Sending sending(*this);
    if (const auto own = poster_.pasteKeystroke()) return press(own->keyCode, own->flags);
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
