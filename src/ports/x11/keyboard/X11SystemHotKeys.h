// Hot keys as passive grabs: the server itself takes exactly these combinations out of the stream of keys.
#pragma once

#include <functional>
#include <map>
#include <optional>
#include <vector>

#include "platform/SystemHotKeys.h"
#include "ports/x11/X11Session.h"

namespace plume {

class X11SystemHotKeys final : public SystemHotKeys {
  public:
    // The X key code of a virtual key code, if the keyboard has that key.
    using KeyCodeOf = std::function<std::optional<xcb_keycode_t>(KeyCode)>;

    // The session outlives the hot keys.
    X11SystemHotKeys(X11Session& session, KeyCodeOf keyCodeOf);
    ~X11SystemHotKeys() override;
    X11SystemHotKeys(const X11SystemHotKeys&) = delete;
    X11SystemHotKeys& operator=(const X11SystemHotKeys&) = delete;

    Result<void> registerHotKey(Id id, KeyCode keyCode, KeyModifiers modifiers, std::function<void()> handler) override;
    void unregisterHotKey(Id id) override;

  private:
    struct HotKey {
        xcb_keycode_t keyCode = 0;
        std::uint16_t modifiers = 0;  // as X has them
        std::function<void()> handler;
    };

    void tellRepeatsApart() const;
    bool grab(const HotKey& hotKey) const;
    void ungrab(const HotKey& hotKey) const;
    bool isRegistered(const HotKey& hotKey) const;
    std::vector<std::uint16_t> lockVariants() const;
    void pressed(const xcb_key_press_event_t& event);

    X11Session& session_;
    const KeyCodeOf keyCodeOf_;
    const std::uint16_t numLock_;  // the modifier that Num Lock sets, or none
    std::map<Id, HotKey> hotKeys_;
    Subscription pressHandler_;
    Subscription releaseHandler_;
    xcb_keycode_t heldKeyCode_ = 0;  // the hot key that is down
};

}  // namespace plume
