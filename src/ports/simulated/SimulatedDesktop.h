// A whole desktop in memory: a keyboard and a mouse, programs to type into, a clipboard, and a clock that stands still
// until somebody moves it.
//
// A port like any other, without a screen: what is done to it twice comes out the same twice. Everything happens on the
// thread of its caller.
#pragma once

#include <map>
#include <memory>
#include <optional>
#include <string>
#include <string_view>

#include "ports/simulated/SimulatedAccessibility.h"
#include "ports/simulated/SimulatedApplication.h"
#include "ports/simulated/SimulatedEventPoster.h"
#include "ports/simulated/SimulatedInputSources.h"
#include "ports/simulated/SimulatedKeyboard.h"
#include "ports/simulated/SimulatedKeyboardTap.h"
#include "ports/simulated/SimulatedMouseTap.h"
#include "ports/simulated/SimulatedNotices.h"
#include "ports/simulated/SimulatedPasteboard.h"
#include "ports/simulated/SimulatedProcessManager.h"
#include "ports/simulated/SimulatedRunLoop.h"
#include "ports/simulated/SimulatedSecureInput.h"
#include "ports/simulated/SimulatedSounds.h"
#include "ports/simulated/SimulatedSystemHotKeys.h"

namespace plume {

class SimulatedDesktop {
  public:
    // No program is in front.
    SimulatedDesktop();
    SimulatedDesktop(const SimulatedDesktop&) = delete;
    SimulatedDesktop& operator=(const SimulatedDesktop&) = delete;

    SimulatedRunLoop& runLoop() { return runLoop_; }
    SimulatedPasteboard& pasteboard() { return pasteboard_; }
    SimulatedProcessManager& processManager() { return processManager_; }
    SimulatedInputSources& inputSources() { return inputSources_; }
    SimulatedAccessibility& accessibility() { return accessibility_; }
    SimulatedKeyboardTap& keyboardTap() { return keyboardTap_; }
    SimulatedMouseTap& mouseTap() { return mouseTap_; }
    SimulatedKeyboard& keyboard() { return keyboard_; }
    SimulatedEventPoster& poster() { return poster_; }
    SimulatedSecureInput& secureInput() { return secureInput_; }
    SimulatedSystemHotKeys& systemHotKeys() { return systemHotKeys_; }
    SimulatedSounds& sounds() { return sounds_; }
    SimulatedNotices& notices() { return notices_; }

    // The program with this bundle identifier, which is started when it does not run yet. Good as long as the desktop.
    SimulatedApplication& application(const std::u16string& bundleIdentifier);
    // Brings it to the front, as the user does.
    SimulatedApplication& activate(const std::u16string& bundleIdentifier);
    // The program that gets the keys; null when it is Plume itself or none.
    SimulatedApplication* front();

    // The user presses and releases a key while these modifiers are held, which takes no time.
    void pressAndRelease(KeyCode keyCode, KeyModifiers modifiers = {});
    // The same, also for modifiers alone.
    void pressCombination(KeyModifiers modifiers, std::optional<KeyCode> keyCode);
    // The user types one character: its key, with Shift where it needs it, or a key of its own.
    void typeCharacter(std::u16string_view character);
    // The user clicks where the pointer is.
    void click() { mouseTap_.press(poster_.pointerLocation()); }

  private:
    void deliver(SimulatedKeyEvent event);
    void deliverUserKey(const SimulatedKeyboard::Key& key);
    void deliverPlumeKey(const SynthesisedKey& key);

    SimulatedRunLoop runLoop_;
    SimulatedPasteboard pasteboard_;
    SimulatedProcessManager processManager_;
    SimulatedInputSources inputSources_;
    SimulatedAccessibility accessibility_;
    SimulatedKeyboardTap keyboardTap_;
    SimulatedMouseTap mouseTap_;
    SimulatedSystemHotKeys systemHotKeys_;
    SimulatedKeyboard keyboard_;
    SimulatedEventPoster poster_;
    SimulatedSecureInput secureInput_;
    SimulatedSounds sounds_;
    SimulatedNotices notices_;
    std::map<std::u16string, std::unique_ptr<SimulatedApplication>> applications_;
};

}  // namespace plume
