// Content on its way to other programs: written into properties of their windows, piece by piece where it is long.
//
// Belongs to the tap thread. What goes to a requestor that has stopped reading is kept for half a minute.
#pragma once

#include <xcb/xcb.h>

#include <cstdint>
#include <functional>
#include <map>
#include <memory>
#include <string>
#include <utility>

#include "ports/x11/X11Session.h"

namespace plume {

// A value as X keeps it in a property.
struct X11SelectionValue {
    xcb_atom_t type = XCB_ATOM_NONE;
    std::uint8_t format = 8;  // bits of one unit
    std::shared_ptr<const std::string> bytes;
};

class X11SelectionTransfers {
  public:
    X11SelectionTransfers(X11Session& session);
    X11SelectionTransfers(const X11SelectionTransfers&) = delete;
    X11SelectionTransfers& operator=(const X11SelectionTransfers&) = delete;

    // Writes the value, in place of what was under way to the same property. `taken` is called when the requestor has
    // removed the last of it, or asks for something else there; for a requestor that removes nothing, 0.3 s after it
    // was written. A value in pieces has to be removed.
    void send(xcb_window_t requestor, xcb_atom_t property, X11SelectionValue value, std::function<void()> taken);

  private:
    using Key = std::pair<xcb_window_t, xcb_atom_t>;
    struct Transfer {
        X11Session::WindowEvents requestorEvents;
        X11SelectionValue value;
        std::function<void()> taken;
        std::uint32_t written = 0;  // the request that wrote last, by its sequence number
        bool isIncremental = false;
        bool isComplete = false;  // the last piece is there
        std::size_t sent = 0;     // bytes
        double lastMoved = 0;
        Timer presumedTaken = {};
    };

    void begin(const Key& key, Transfer& transfer);
    void sendPiece(const Key& key, Transfer& transfer);
    void propertyWasRemoved(const Key& key, std::uint32_t sequence);
    void presumeTaken(const Key& key);
    void forgetWindow(xcb_window_t window);
    void forgetIdle();
    void write(const Key& key, Transfer& transfer, std::size_t from, std::size_t count) const;

    X11Session& session_;
    const std::size_t longestPiece_;  // bytes
    std::map<Key, Transfer> transfers_;
    Timer nextSweep_;  // of idle transfers, while there are any transfers
    Subscription propertyHandler_;
    Subscription destroyHandler_;
    Subscription errorHandler_;
};

}  // namespace plume
