// Writes the symbols of assigned spare key codes into the server's keymap, and removes them again.
//
// A change is written to the main keyboard and what is attached to it, the XTEST keyboard included, with one request
// over all key codes from the first to the last that change; those in between are written as they are. That takes XKB:
// the core protocol's request would take the third group and more from them. What is there is noted in a property of
// the root window, so that the next Plume can remove what one that was killed has left. Tap thread; waits for the
// server.
#pragma once

#include <xcb/xcb.h>

#include <map>

#include "ports/x11/keyboard/SpareKeycodes.h"
#include "ports/x11/keyboard/TapConnection.h"
#include "ports/x11/keyboard/XkbKeyboard.h"

namespace plume {

class SpareKeyWriter {
  public:
    // Both outlive it.
    SpareKeyWriter(TapConnection& connection, XkbKeyboard& keyboard) : connection_(connection), keyboard_(keyboard) {}

    // Takes away what an earlier Plume has left.
    void clearLeftovers();

    // Whatever was used at `since` or later and is no longer in the keymap becomes unwritten: another program, or the
    // tap when it takes a keyboard, may have given the XTEST keyboard another keymap.
    void verify(SpareKeycodes& spares, double since) const;
    // Writes what is not written yet.
    void write(SpareKeycodes& spares);

  private:
    using Symbols = std::map<xcb_keycode_t, xkb_keysym_t>;

    // False when the server does not answer. With `only`, where a key code has the symbol given there, and no other.
    bool change(const Symbols& symbols, const Symbols* only);
    void note(const SpareKeycodes& spares) const;

    TapConnection& connection_;
    XkbKeyboard& keyboard_;
};

}  // namespace plume
