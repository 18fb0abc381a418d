// The registered hot keys, and the modifiers held now: recognises hot keys of modifiers alone at their release.
//
// Owned by the input service; belongs to the tap thread.
#pragma once

#include <cstdint>
#include <vector>

#include "Foundation/ZDEvent.h"
#include "input/EventArgs.h"
#include "input/GeneralHotKey.h"

namespace plume {

class HotKeyTable {
  public:
    // The event is raised with the hot keys that match, in the order of their registration; it is not owned.
    explicit HotKeyTable(ZDEvent<ZDHotKeysPressedEventArgs>& hotKeysPressed) : hotKeysPressed_(hotKeysPressed) {}

    void registerHotKey(const GeneralHotKey& hotKey) { hotKeys_.push_back(hotKey); }
    // The first one equal to this; none is no error.
    void unregisterHotKey(const GeneralHotKey& hotKey);

    // A key went down; whether a hot key swallows it.
    bool keyDown(KeyCode keyCode);
    // The held modifiers are these from now on; whether a hot key swallows the change.
    bool modifiersChanged(KeyModifiers modifiers);
    // The modifiers held now have served their purpose: their release is no hot key.
    void ignoreNextHotKey() { dontCheckHotKeysOnKeyUp_ = true; }
    // Whether to swallow the key; KeyCode::None asks for the held modifiers alone.
    bool checkHotKeys(KeyCode keyCode);

    KeyModifiers keyModifier() const { return keyModifier_; }

  private:
    ZDEvent<ZDHotKeysPressedEventArgs>& hotKeysPressed_;
    std::vector<GeneralHotKey> hotKeys_;
    KeyModifiers keyModifier_;
    bool dontCheckHotKeysOnKeyUp_ = false;
};

}  // namespace plume
