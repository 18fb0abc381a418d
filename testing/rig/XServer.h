#pragma once

#include <filesystem>
#include <memory>
#include <string>

#include "testing/rig/ChildProcess.h"
#include "testing/rig/PrivateDirectory.h"

namespace plume::rig {

// A real X.Org server on a free display number, without a screen and without a kernel's input devices: the picture is
// drawn by the dummy driver, and keyboard and pointer are devices of the inputtest driver, which take their events from
// sockets. It opens no virtual terminal, so it runs in a container and next to a developer's own desktop.
class XServer {
  public:
    struct Options {
        std::string layout = "us";  // XKB names, as the server's configuration takes them
        std::string variant;
        int width = 1280;
        int height = 800;
        bool secondKeyboard = false;  // one more, to be unplugged and plugged in again
    };

    // Ready for clients when the constructor returns; throws RigError. `directory` outlives the server.
    XServer(const PrivateDirectory& directory, const Options& options, const Environment& environment);

    const std::string& display() const { return display_; }  // ":5"
    const std::filesystem::path& keyboardSocket() const { return keyboardSocket_; }
    const std::filesystem::path& secondKeyboardSocket() const { return secondKeyboardSocket_; }
    const std::filesystem::path& pointerSocket() const { return pointerSocket_; }
    bool isRunning() { return process_->isRunning(); }
    // Ends it as a crash would; every client loses its connection.
    void crash() { kill(process_->pid(), SIGKILL); }

  private:
    void writeConfiguration(const std::filesystem::path& file, const Options& options) const;

    std::filesystem::path keyboardSocket_;
    std::filesystem::path secondKeyboardSocket_;
    std::filesystem::path pointerSocket_;
    std::string display_;
    std::unique_ptr<ChildProcess> process_;
};

}  // namespace plume::rig
