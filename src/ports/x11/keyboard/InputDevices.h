// The keyboards and pointers of the X server.
#pragma once

#include <xcb/xinput.h>

#include <cstdint>
#include <string>
#include <vector>

#include "ports/x11/XcbConnection.h"
#include "ports/x11/keyboard/XkbKeymap.h"

namespace plume {

struct InputDevice {
    std::uint16_t id = 0;
    std::uint16_t type = 0;        // XCB_INPUT_DEVICE_TYPE_…
    std::uint16_t attachment = 0;  // of a slave its master, of a master the one it is paired with
    std::uint16_t keySource = 0;   // whose keys the device reports now; 0 when it has none
    bool enabled = false;
    std::string name;

    bool isTestKeyboard() const;
};

// Waits for the server; empty when it does not answer.
std::vector<InputDevice> inputDevices(const XcbConnection& connection);

// From now on these events of the device (XCB_INPUT_XI_EVENT_MASK_…), and no others, are told to the connection.
void selectDeviceEvents(const XcbConnection& connection, std::uint16_t device, std::uint32_t events);

// What is down on a device. Waits for the server.
KeycodeSet keysDownOn(const XcbConnection& connection, std::uint16_t device);

}  // namespace plume
