// Keys and clicks on X11: by XTEST, over the connection that the tap's own keys take.
//
// What is posted between begin() and end() is gathered and sent at once, without pauses. Characters are typed with the
// keys that the layout in force has for them; for others spare key codes are given symbols, all that a batch needs with
// one change of the server's keymap. A batch finds the keyboard at rest: keys that are down are released, Caps Lock
// and the like are unlocked; afterwards modifiers that the user holds are pressed and locks set again. What the user
// does meanwhile waits at the tap and follows.
//
// Belongs to the tap thread. Without effect while the connection is broken. A batch that needs more spare key codes
// than are free waits for them, two seconds at most, and leaves out what then still cannot be typed: canType() tells
// before.
#pragma once

#include <cstdint>
#include <functional>
#include <memory>
#include <span>
#include <string_view>
#include <vector>

#include "platform/EventPoster.h"
#include "platform/RunLoop.h"
#include "ports/x11/keyboard/SpareKeyWriter.h"
#include "ports/x11/keyboard/SpareKeycodes.h"
#include "ports/x11/keyboard/TapConnection.h"
#include "ports/x11/keyboard/X11KeyboardTap.h"
#include "ports/x11/keyboard/XkbKeyboard.h"

namespace plume {

class X11EventPoster final : public EventPoster {
  public:
    // All outlive the poster.
    X11EventPoster(const RunLoop& loop, TapConnection& connection, XkbKeyboard& keyboard, X11KeyboardTap& tap);
    // Takes the symbols off the spare key codes, which may take half a second.
    ~X11EventPoster() override;
    X11EventPoster(const X11EventPoster&) = delete;
    X11EventPoster& operator=(const X11EventPoster&) = delete;

    // Called at least every 100 ms while something is waited for.
    std::function<void()> heartbeat;

    void begin() override { ++depth_; }
    void end() override;
    void post(const SynthesisedKey& key, bool pastTap) override;
    bool canType(std::u16string_view text) const override;
    KeyCode keyCodeOfLetter(char16_t letter) const override;
    bool isKeyDown(KeyCode keyCode) const override;
    Point pointerLocation() const override;
    void click(Point location) override;
    void holdUserKeys() override { tap_.hold(); }
    void releaseUserKeys() override { tap_.release(); }
    void keepHoldingUserKeys() override { tap_.keepHolding(); }

  private:
    // One key up or down, or one character typed.
    struct Item {
        char32_t character = 0;
        xcb_keycode_t keycode = 0;
        std::uint8_t modifiers = 0;  // real modifiers that a key goes down with
        bool down = true;
        bool isKey = false;
    };

    void addText(std::u16string_view text);
    void send(std::span<Item> items);
    std::size_t findKeys(std::span<Item> items);
    bool findKey(Item& item);
    void sendItem(const Item& item);
    void setModifiers(std::uint8_t wanted);
    bool awaitSpare(double deadline) const;

    const RunLoop& loop_;
    TapConnection& connection_;
    XkbKeyboard& keyboard_;
    X11KeyboardTap& tap_;
    std::shared_ptr<const XkbKeymap> keymap_;  // that the spares belong to
    xkb_layout_index_t group_ = 0;
    SpareKeycodes spares_;
    SpareKeyWriter writer_;
    int depth_ = 0;
    std::vector<Item> items_;
    char16_t textEnd_ = 0;                // last unit of the text that was posted last, 0 when a key came since
    std::uint8_t modifiers_ = 0;          // pressed for the items that are being sent
    std::uint8_t explicitModifiers_ = 0;  // pressed as keys of their own
};

}  // namespace plume
