// The keymap of each keyboard that the tap has, and which of them the XTEST keyboard has now.
//
// Every keyboard may have a layout of its own, and programs read keys by the layout of the keyboard that was typed on
// last. Keys that pass are pressed on the XTEST keyboard, so it is given the layout of the keyboard that they come
// from, whenever somebody goes on typing on another one. The keyboards' own layouts are only changed where the X server
// would have done it: by a change of the layout of all of them. Belongs to the tap thread, and waits for the server.
#pragma once

#include <xcb/xcb.h>

#include <cstdint>
#include <map>
#include <memory>

#include "ports/x11/keyboard/TapConnection.h"
#include "ports/x11/keyboard/XkbKeyboard.h"

namespace plume {

class DeviceKeymaps {
  public:
    // Both outlive it.
    DeviceKeymaps(const TapConnection& connection, XkbKeyboard& keyboard);
    DeviceKeymaps(const DeviceKeymaps&) = delete;
    DeviceKeymaps& operator=(const DeviceKeymaps&) = delete;

    // A keyboard that the tap has from now on, or no longer.
    void add(std::uint16_t device);
    void remove(std::uint16_t device);
    // To be told of every event of the connection: one of these keyboards may have got another layout by itself.
    void hear(const xcb_generic_event_t& event);

    // Whether the XTEST keyboard has the layout of this one for sure; costs nothing.
    bool isInUse(std::uint16_t device) const { return device == used_ && !changed_; }
    // Gives the XTEST keyboard the layout of this one, if it has another. False when the server refuses.
    bool use(std::uint16_t device);
    // The layout of the XTEST keyboard. Never null.
    const std::shared_ptr<const XkbKeymap>& current() const { return current_; }

    // The layout of the core keyboard has changed. Where not by use(), somebody has given all keyboards another layout,
    // and these get it, too.
    void coreChanged();

  private:
    struct Keymap {
        std::shared_ptr<const XkbKeymap> keymap;
        bool changed = false;  // to be read again
    };

    void listen(std::uint16_t device) const;
    bool give(std::uint16_t device);

    const TapConnection& connection_;
    XkbKeyboard& keyboard_;
    std::map<std::uint16_t, Keymap> keymaps_;
    std::uint16_t used_ = 0;  // whose layout the XTEST keyboard has
    std::shared_ptr<const XkbKeymap> current_;
    std::uint64_t core_ = 0;  // the fingerprint of the core keyboard's layout as it was left
    bool changed_ = false;    // of any of them
    bool giving_ = false;
    std::uint8_t firstEvent_ = 0;
};

}  // namespace plume
