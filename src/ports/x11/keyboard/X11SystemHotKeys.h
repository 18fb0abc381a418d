// Hot keys as passive grabs: the server itself takes exactly these combinations out of the stream of keys.
//
// The grabs are of key codes and modifiers, so they are made anew whenever the keyboard's layout changes. One that
// another program has taken by then is tried again at the next change.
#pragma once

#include <functional>
#include <map>
#include <vector>

#include "platform/SystemHotKeys.h"
#include "ports/x11/X11Session.h"
#include "ports/x11/keyboard/XkbKeyboard.h"

namespace plume {

class X11SystemHotKeys final : public SystemHotKeys {
  public:
    // Both outlive the hot keys.
    X11SystemHotKeys(X11Session& session, XkbKeyboard& keyboard);
    ~X11SystemHotKeys() override;
    X11SystemHotKeys(const X11SystemHotKeys&) = delete;
    X11SystemHotKeys& operator=(const X11SystemHotKeys&) = delete;

    Result<void> registerHotKey(Id id, KeyCode keyCode, KeyModifiers modifiers, std::function<void()> handler) override;
    void unregisterHotKey(Id id) override;

  private:
    struct HotKey {
        KeyCode key = KeyCode::None;
        xcb_keycode_t keyCode = 0;    // 0 when the keyboard has no such key now
        std::uint16_t modifiers = 0;  // as X has them
        std::function<void()> handler;
    };

    void tellRepeatsApart() const;
    bool grab(const HotKey& hotKey) const;
    void ungrab(const HotKey& hotKey) const;
    bool isRegistered(const HotKey& hotKey) const;
    void keyboardChanged(const XkbKeyboard::Change& change);
    void pressed(const xcb_key_press_event_t& event);

    X11Session& session_;
    const XkbKeyboard& keyboard_;
    std::vector<std::uint16_t> lockVariants_;  // every combination of the modifiers that only lock
    std::map<Id, HotKey> hotKeys_;
    Subscription pressHandler_;
    Subscription releaseHandler_;
    Subscription keyboardChanged_;
    xcb_keycode_t heldKeyCode_ = 0;  // the hot key that is down
};

}  // namespace plume
