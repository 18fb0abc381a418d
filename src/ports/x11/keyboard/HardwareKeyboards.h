// The keyboards that people type on: grabbing them, so that their keys come to the tap alone.
//
// Belongs to the tap thread, and waits for the server.
#pragma once

#include <cstdint>
#include <vector>

#include "Foundation/Result.h"
#include "ports/x11/keyboard/InputDevices.h"
#include "ports/x11/keyboard/TapConnection.h"

namespace plume {

class HardwareKeyboards {
  public:
    explicit HardwareKeyboards(TapConnection& connection) : connection_(connection) {}
    HardwareKeyboards(const HardwareKeyboards&) = delete;
    HardwareKeyboards& operator=(const HardwareKeyboards&) = delete;

    // What there is to grab: every keyboard of the main keyboard but the XTEST one.
    static std::vector<InputDevice> list(const TapConnection& connection);

    // Whether there is any, grabbed or not; the error says that there is none.
    static Result<void> check(const TapConnection& connection);

    // All of them. One that another program has grabbed is left to it; the error is that none could be grabbed.
    Result<void> grab();
    // Those that have come since.
    void grabNew();
    void ungrab();
    // The server no longer has this one.
    void forget(std::uint16_t device);

    const std::vector<std::uint16_t>& grabbed() const { return grabbed_; }
    KeycodeSet keysDown() const;

  private:
    bool grab(std::uint16_t device);

    TapConnection& connection_;
    std::vector<std::uint16_t> grabbed_;
};

}  // namespace plume
