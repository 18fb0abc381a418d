#pragma once

#include <filesystem>
#include <memory>

#include "testing/rig/DesktopSession.h"
#include "testing/rig/PrivateDirectory.h"
#include "testing/rig/TargetProgram.h"
#include "testing/rig/TestKeyboard.h"
#include "testing/rig/TestPointer.h"
#include "testing/rig/XClient.h"
#include "testing/rig/XServer.h"

namespace plume::rig {

// A whole desktop for one test program, brought up by the constructor and gone with the destructor: X server, D-Bus and
// accessibility, window manager, a keyboard and a mouse to use it with. Several can exist at once. Needs no display and
// no rights, and works as root, too. One thread, which must live as long as the rig does. Everything throws RigError.
class DesktopRig {
  public:
    explicit DesktopRig(const XServer::Options& options = {}, WindowManager manager = WindowManager::Openbox);

    XServer& server() { return server_; }
    DesktopSession& session() { return session_; }
    XClient& client() { return client_; }
    TestKeyboard& keyboard() { return keyboard_; }
    TestPointer& pointer() { return pointer_; }

    // For files of the test; removed with the rig.
    const std::filesystem::path& directory() const { return directory_.path(); }

    // Starts a program to type into. When this returns, it has the keyboard focus and an empty text: it has taken one
    // key and a Backspace already.
    std::unique_ptr<TargetProgram> startTarget(TargetKind kind);

    // Clicks at a place of the screen and waits until the click has been given to the program there: the window manager
    // looks at every click first, and keys typed at once would overtake it.
    void click(int x, int y, int button = 1);

  private:
    PrivateDirectory directory_;
    XServer server_;
    DesktopSession session_;
    XClient client_;
    TestKeyboard keyboard_;
    TestPointer pointer_;
    int targets_ = 0;
};

}  // namespace plume::rig
