// The core keyboard of the X server as it is now: its layout, which of its groups is in force, what is locked.
//
// Belongs to the tap thread, and asks over the session connection.
#pragma once

#include <xcb/xcb.h>
#include <xkbcommon/xkbcommon.h>

#include <array>
#include <cstdint>
#include <deque>
#include <memory>
#include <span>
#include <string>
#include <vector>

#include "Foundation/Result.h"
#include "Foundation/ZDEvent.h"
#include "ports/x11/X11Session.h"
#include "ports/x11/XcbConnection.h"
#include "ports/x11/keyboard/XkbKeymap.h"

namespace plume {

// What is in force besides held keys; masks of real modifiers.
struct XkbLocks {
    std::uint8_t latchedModifiers = 0;
    std::uint8_t lockedModifiers = 0;
    std::int16_t latchedGroup = 0;
    std::uint8_t lockedGroup = 0;

    bool operator==(const XkbLocks&) const = default;
};

class XkbKeyboard {
  public:
    enum class Change {
        Keymap,  // another layout, or a key that does something else
        Group,   // another group of the same layout, or another name for it
        Locks,   // modifiers or a group were locked or latched by a program, not by a key
    };

    // Waits for the server. The error says that the server lacks XKB. The connection outlives the keyboard.
    static Result<std::unique_ptr<XkbKeyboard>> open(XcbConnection& connection);
    XkbKeyboard(const XkbKeyboard&) = delete;
    XkbKeyboard& operator=(const XkbKeyboard&) = delete;

    // Never null.
    const std::shared_ptr<const XkbKeymap>& keymap() const { return keymap_; }
    xkb_layout_index_t group() const { return group_; }
    const XkbLocks& locks() const { return locks_; }
    // "us", "de(nodeadkeys)" as the server's layout rules name the group in force; without rules, the name in the
    // layout itself, or empty.
    const std::string& layoutName() const { return layoutName_; }

    // The layout of a single keyboard, nothing when it has none. Waits for the server.
    std::shared_ptr<const XkbKeymap> keymapOf(std::int32_t device) const;
    // Reads the layout now, before the server's events of its change are handled.
    void readAgain();

    // Raised after the change.
    ZDEvent<const Change> changedEvent;

    // Follows changes from now on, by the events of this session, whose connection it was opened with and which
    // outlives the keyboard.
    void listenTo(X11Session& session);

    // Whoever gives key codes symbols of Plume's own tells it before: `symbols[i]` comes to `first + i`, and
    // XKB_KEY_NoSymbol stands for a key code that is written as it is. The server's event of that change is then no
    // change of layout, and the symbols are no part of it.
    void willWrite(xcb_keycode_t first, std::span<const xkb_keysym_t> symbols);

  private:
    explicit XkbKeyboard(XcbConnection& connection) : connection_(connection) {}

    bool begin();
    void selectEvents() const;
    KeycodeSet foreignKeycodes(xkb_keymap* keymap) const;
    void readState();
    void readLayoutName();
    void handleEvent(const xcb_generic_event_t& event);
    void stateChanged(const xcb_generic_event_t& event);
    bool isOwnChange(xcb_keycode_t first, std::uint8_t count);

    struct Written {
        xcb_keycode_t first;
        std::size_t count;
    };

    XcbConnection& connection_;
    XkbOwned<xkb_context> context_;
    std::uint8_t firstEvent_ = 0;
    std::int32_t device_ = 0;
    std::shared_ptr<const XkbKeymap> keymap_;
    xkb_layout_index_t group_ = 0;
    XkbLocks locks_;
    std::string layoutName_;
    std::array<xkb_keysym_t, 256> ownSymbols_{};
    std::deque<Written> expected_;
    unsigned lastRead_ = 0;  // the request before the latest reading of the keymap
    X11Session::WindowEvents rootEvents_;
    std::vector<Subscription> handlers_;
};

}  // namespace plume
