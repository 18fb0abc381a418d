#include "ports/simulated/SimulatedDesktop.h"

#include <array>
#include <utility>

#include "ports/simulated/SimulatedModifiers.h"

namespace plume {

namespace {

struct ModifierKey {
    KeyModifier modifier;
    KeyCode keyCode;
};

constexpr auto ModifierKeys = std::to_array<ModifierKey>({
    {KeyModifier::Shift, KeyCode::Shift},
    {KeyModifier::Control, KeyCode::Control},
    {KeyModifier::Option, KeyCode::Option},
    {KeyModifier::Command, KeyCode::Command},
});

}  // namespace

SimulatedDesktop::SimulatedDesktop()
    : keyboard_(runLoop_, inputSources_, keyboardTap_, systemHotKeys_,
                [this](const SimulatedKeyboard::Key& key) { deliverUserKey(key); }),
      poster_(keyboard_, [this](const SynthesisedKey& key) { deliverPlumeKey(key); }) {
    accessibility_.setFrontApplicationSource([this]() -> std::shared_ptr<UIElement> {
        const SimulatedApplication* application = front();
        return application ? application->element() : nullptr;
    });
}

SimulatedApplication& SimulatedDesktop::application(const std::u16string& bundleIdentifier) {
    std::unique_ptr<SimulatedApplication>& application = applications_[bundleIdentifier];
    if (!application) {
        const ProcessSerialNumber process = processManager_.launch(bundleIdentifier, bundleIdentifier);
        application = std::make_unique<SimulatedApplication>(bundleIdentifier, process, pasteboard_);
    }
    return *application;
}

SimulatedApplication& SimulatedDesktop::activate(const std::u16string& bundleIdentifier) {
    SimulatedApplication& activated = application(bundleIdentifier);
    processManager_.setFrontProcess(activated.process());
    return activated;
}

SimulatedApplication* SimulatedDesktop::front() {
    const auto process = processManager_.frontProcess();
    for (const auto& [identifier, application] : applications_) {
        if (application->process() == process) return application.get();
    }
    return nullptr;
}

void SimulatedDesktop::pressAndRelease(KeyCode keyCode, KeyModifiers modifiers) {
    pressCombination(modifiers, keyCode);
}

void SimulatedDesktop::pressCombination(KeyModifiers modifiers, std::optional<KeyCode> keyCode) {
    for (const ModifierKey& key : ModifierKeys) {
        if (modifiers.contains(key.modifier)) keyboard_.press(key.keyCode);
    }
    if (keyCode) {
        keyboard_.press(*keyCode);
        keyboard_.release(*keyCode);
    }
    for (auto key = ModifierKeys.rbegin(); key != ModifierKeys.rend(); ++key) {
        if (modifiers.contains(key->modifier)) keyboard_.release(key->keyCode);
    }
}

void SimulatedDesktop::typeCharacter(std::u16string_view character) {
    if (character.size() == 1) {
        if (const auto stroke = SimulatedInputSources::strokeFor(character.front())) {
            return pressAndRelease(stroke->keyCode, stroke->shift ? KeyModifiers(KeyModifier::Shift) : KeyModifiers());
        }
    }
    keyboard_.pressCharacter(character);
    keyboard_.releaseCharacter(character);
}

void SimulatedDesktop::deliver(SimulatedKeyEvent event) {
    SimulatedApplication* receiver = front();
    if (!receiver) return;
    event.time = runLoop_.now();
    receiver->handle(std::move(event));
}

void SimulatedDesktop::deliverUserKey(const SimulatedKeyboard::Key& key) {
    const bool isKey = key.keyCode != SimulatedKeyboard::UnmappedKeyCode;
    deliver({0, SimulatedKeyEvent::Origin::User, isKey ? std::optional(key.keyCode) : std::nullopt, key.flags,
             key.isDown, key.string});
}

void SimulatedDesktop::deliverPlumeKey(const SynthesisedKey& key) {
    SimulatedKeyEvent event{0, SimulatedKeyEvent::Origin::Plume, std::nullopt, key.flags, key.down, {}};
    if (key.text.empty()) {
        event.keyCode = key.keyCode;
        event.string = inputSources_.translateKey(key.keyCode, key.flags).value_or(std::u16string());
    } else {
        event.string = key.text;
    }
    deliver(std::move(event));
}

}  // namespace plume
