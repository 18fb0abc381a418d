// Follows the user's keys: what each one produces, and which modifiers are held.
//
// Does for the tap what a program does for itself with the keys it gets, so that nobody has to be asked. Belongs to the
// tap thread; allocates only when a character was composed.
#pragma once

#include <xcb/xcb.h>
#include <xkbcommon/xkbcommon-compose.h>
#include <xkbcommon/xkbcommon.h>

#include <array>
#include <cstdint>
#include <memory>
#include <string_view>

#include "Foundation/KeyCode.h"
#include "Foundation/KeyModifiers.h"
#include "ports/x11/keyboard/KeyText.h"
#include "ports/x11/keyboard/XkbKeyboard.h"
#include "ports/x11/keyboard/XkbKeymap.h"

namespace plume {

class KeyDecoder {
  public:
    struct Key {
        KeyCode keyCode = KeyCode::None;  // virtual
        bool modifier = false;
        // A key that only chooses among the characters of other keys, like AltGr: nothing to tell anybody.
        bool silent = false;
        EventFlags flags;            // for a modifier, with this change
        std::u16string_view string;  // valid until the next call
        bool composing = false;      // one of a sequence that has produced nothing yet
    };

    KeyDecoder();

    // Another layout; `held` are the keys that are down.
    void setKeymap(std::shared_ptr<const XkbKeymap> keymap, const KeycodeSet& held, const XkbLocks& locks);
    // Somebody else locked or unlocked something.
    void adopt(const XkbLocks& locks);

    Key press(xcb_keycode_t keycode);
    Key release(xcb_keycode_t keycode);
    // The press did not reach any program, so what it locked is not locked.
    void undoLocks();

    EventFlags flags() const;

  private:
    struct Unref {
        void operator()(xkb_compose_table* table) const { xkb_compose_table_unref(table); }
        void operator()(xkb_compose_state* state) const { xkb_compose_state_unref(state); }
    };

    void loadCompose();
    bool isComposed(xkb_keysym_t symbol);
    XkbLocks locks() const;

    std::shared_ptr<const XkbKeymap> keymap_;
    XkbOwned<xkb_context> context_;
    XkbOwned<xkb_state> state_;
    std::unique_ptr<xkb_compose_table, Unref> composeTable_;
    std::unique_ptr<xkb_compose_state, Unref> composeState_;
    std::array<KeyCode, 256> keyCodes_{};  // that a key went down with
    XkbLocks locksBefore_;                 // the latest press
    KeyText text_;
};

}  // namespace plume
