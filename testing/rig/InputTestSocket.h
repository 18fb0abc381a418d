#pragma once

#include <cstddef>
#include <filesystem>

#include "testing/rig/FileDescriptor.h"

namespace plume::rig {

// A connection to one device of the X server's inputtest driver. The driver takes a single connection in the server's
// life, so one process opens it and keeps it. Every call throws RigError when the server has gone.
class InputTestSocket {
  public:
    explicit InputTestSocket(const std::filesystem::path& path);  // connects and agrees on the protocol's version

    // Events are handed to the server in the order of the calls; none of these waits for it.
    void sendKey(int keycode, bool press);
    void sendButton(int button, bool press);
    void sendPosition(double x, double y);

    // Returns once the server has processed all events sent so far.
    void sync();

  private:
    void sendBytes(const void* bytes, std::size_t length);
    void receive(int expectedType, std::size_t expectedLength);

    FileDescriptor socket_;
};

}  // namespace plume::rig
