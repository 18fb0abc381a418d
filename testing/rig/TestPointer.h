#pragma once

#include <filesystem>

#include "testing/rig/InputTestSocket.h"
#include "testing/rig/XServer.h"

namespace plume::rig {

// The mouse a test clicks with, another device of the inputtest driver. Coordinates are pixels of the screen.
class TestPointer {
  public:
    TestPointer(const std::filesystem::path& socket, const XServer::Options& screen)  // throws RigError
        : socket_(socket), xScale_(Range / screen.width), yScale_(Range / screen.height) {}

    void moveTo(int x, int y) { socket_.sendPosition((x + 0.5) * xScale_, (y + 0.5) * yScale_); }
    void press(int button = 1) { socket_.sendButton(button, true); }
    void release(int button = 1) { socket_.sendButton(button, false); }

    // Returns once the server has taken all of it; see DesktopRig::click for when programs have.
    void sync() { socket_.sync(); }

  private:
    static constexpr double Range = 65536;  // the device's positions from one edge of the screen to the other

    InputTestSocket socket_;
    double xScale_;
    double yScale_;
};

}  // namespace plume::rig
