#include "input/delivery/KeySender.h"

#include "input/AXUtils.h"
#include "input/KeyCodes.h"
#include "input/delivery/OutputFragments.h"

namespace plume {

namespace {

// Modifiers as keys of their own.
constexpr std::uint16_t CommandKey = 55;
constexpr std::uint16_t ShiftKey = 56;
constexpr std::uint16_t ControlKey = 59;
// Carries typed text; which key it is does not matter.
constexpr std::uint16_t TextKey = 0;

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

void KeySender::post(std::uint16_t keyCode, std::uint64_t flags, bool down, std::u16string_view text) {
    const bool pastTap = setting_ && setting_->has(InputFlag::PostToSessionEventTap);
    poster_.post({keyCode, flags, down, text}, pastTap);
}

void KeySender::press(std::uint16_t keyCode, std::uint64_t flags) {
    post(keyCode, flags, true);
    post(keyCode, flags, false);
}

void KeySender::sendPlainText(std::u16string_view text) {
    const Sending sending(*this);
    for (const auto& chunk : fragmentsForPlainText(text, setting_ ? *setting_ : ContextInputSetting{})) {
        post(TextKey, 0, true, chunk);
        post(TextKey, 0, false, chunk);
    }
}

void KeySender::sendKey(std::uint16_t keyCode, std::uint64_t flags, std::uint64_t count) {
    const Sending sending(*this);
    for (std::uint64_t i = 0; i < count; ++i) press(keyCode, flags);
}

void KeySender::sendBackspaces(std::uint64_t count) {
    if (count == 0) return;
    const Sending sending(*this);
    if (AXUtils::getSelectedTextLength(accessibility_) != 0) press(KeyCode::ForwardDelete, 0);
    for (std::uint64_t i = 0; i < count; ++i) press(KeyCode::Delete, 0);
}

void KeySender::sendLeftArrowKeys(std::uint64_t count) {
    sendKey(KeyCode::Left, 0, count);
}

void KeySender::sendShiftTab() {
    sendKey(KeyCode::Tab, EventFlag::Shift);
}

void KeySender::sendCopyCommand(bool withControl) {
    const Sending sending(*this);
    if (const auto own = poster_.copyKeystroke()) return press(own->keyCode, own->flags);
    post(commandKeys_.c, withControl ? EventFlag::Control : EventFlag::Command, true);
    post(commandKeys_.c, 0, false);
}

void KeySender::sendPasteCommand(const ContextInputSetting& setting) {
    const Sending sending(*this);
    if (const auto own = poster_.pasteKeystroke()) return press(own->keyCode, own->flags);
    const std::uint64_t modifier = setting.has(InputFlag::UseControlKey) ? EventFlag::Control : EventFlag::Command;
    // A V that the user still holds would make our press of it no press at all.
    if (poster_.isKeyDown(commandKeys_.v)) post(commandKeys_.v, 0, false);
    if (setting.has(InputFlag::AlternativePasting)) return sendAlternativePaste(setting, modifier);
    post(commandKeys_.v, modifier, true);
    post(commandKeys_.v, 0, false);
}

void KeySender::sendAlternativePaste(const ContextInputSetting& setting, std::uint64_t modifier) {
    const std::uint16_t modifierKey = setting.has(InputFlag::UseControlKey) ? ControlKey : CommandKey;
    const std::uint64_t flags = setting.has(InputFlag::DoNotSetModifier) ? 0 : modifier;
    if (poster_.isKeyDown(ShiftKey)) post(ShiftKey, 0, false);
    post(modifierKey, 0, true);
    press(commandKeys_.v, flags);
    post(modifierKey, 0, false);
}

}  // namespace plume
