#include "input/HotKeyTable.h"

#include <algorithm>
#include <iterator>

namespace plume {

void HotKeyTable::unregisterHotKey(const GeneralHotKey& hotKey) {
    const auto found = std::find(hotKeys_.begin(), hotKeys_.end(), hotKey);
    if (found != hotKeys_.end()) hotKeys_.erase(found);
}

bool HotKeyTable::keyDown(KeyCode keyCode) {
    const bool swallow = checkHotKeys(keyCode);
    if (!keyModifier_.isEmpty()) dontCheckHotKeysOnKeyUp_ = true;
    return swallow;
}

bool HotKeyTable::modifiersChanged(KeyModifiers modifiers) {
    // The sets are compared as numbers: changing a lower modifier for a higher one counts as one more.
    if (modifiers.bits() > keyModifier_.bits()) {
        keyModifier_ = modifiers;
        dontCheckHotKeysOnKeyUp_ = false;
        return false;
    }
    const bool swallow = !dontCheckHotKeysOnKeyUp_ && checkHotKeys(KeyCode::None);
    keyModifier_ = modifiers;
    dontCheckHotKeysOnKeyUp_ = !modifiers.isEmpty();
    return swallow;
}

bool HotKeyTable::checkHotKeys(KeyCode keyCode) {
    if (keyCode == KeyCode::None && keyModifier_.isEmpty()) return false;
    const GeneralHotKey pressed{keyModifier_, keyCode};
    ZDHotKeysPressedEventArgs event;
    std::copy_if(hotKeys_.begin(), hotKeys_.end(), std::back_inserter(event.hotKeys),
                 [&](const GeneralHotKey& hotKey) { return hotKey == pressed; });
    if (event.hotKeys.empty()) return false;
    if (!keyModifier_.isEmpty()) dontCheckHotKeysOnKeyUp_ = true;
    hotKeysPressed_.raise(event);
    return event.cancel;
}

}  // namespace plume
